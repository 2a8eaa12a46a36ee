#include "platform/recycled_memory.h"

#include <cstring>
#include <gtest/gtest.h>
#include <set>
#include <thread>
#include <utility>
#include <vector>

namespace vesk {
namespace {

/// A thread's first release opens its lists, and keeps nothing itself.
void openLists() {
  RecycledMemory::release(RecycledMemory::allocate(1), 1);
}

TEST(RecycledMemory, GivesABlockAgainForASizeOfTheSameStepAlone) {
  if (kIsSanitized) GTEST_SKIP() << "every block comes from the heap";
  openLists();
  struct Case {
    std::size_t released;
    std::size_t asked;
    bool isSame;
  };
  const Case cases[] = {{1, 32, true},   {33, 64, true},    {64, 33, true},      {32, 33, false},
                        {33, 32, false}, {1024, 993, true}, {1025, 1025, false}, {500, 500, true}};
  for (const auto& [released, asked, isSame] : cases) {
    // Of each list nothing is left, so that what it gives next was released here.
    std::vector<std::pair<void*, std::size_t>> taken;
    for (const std::size_t size : {released, asked}) {
      for (int count = 0; count < 70; ++count)
        taken.emplace_back(RecycledMemory::allocate(size), size);
    }
    void* const block = RecycledMemory::allocate(released);
    RecycledMemory::release(block, released);
    void* const next = RecycledMemory::allocate(asked);
    if (released <= 1024) {
      EXPECT_EQ(next == block, isSame) << released << ", then " << asked;
    }
    RecycledMemory::release(next, asked);
    for (const auto& [memory, size] : taken)
      RecycledMemory::release(memory, size);
  }
}

TEST(RecycledMemory, NoBlockHasTwoOwnersHoweverManyWereReleased) {
  openLists();
  for (const std::size_t size : {1U, 32U, 33U, 1024U, 1025U, 100'000U}) {
    for (int round = 0; round < 2; ++round) {
      std::set<void*> blocks;
      for (int count = 0; count < 200; ++count) {
        void* const block = RecycledMemory::allocate(size);
        std::memset(block, count, size);
        blocks.insert(block);
      }
      EXPECT_EQ(blocks.size(), 200U) << size;
      for (void* const block : blocks)
        RecycledMemory::release(block, size);
    }
  }
}

/// Made before the first release of its thread, it ends after the thread's lists.
struct ReleasesAtTheVeryEnd {
  ~ReleasesAtTheVeryEnd() {
    for (void* const block : blocks)
      RecycledMemory::release(block, 40);
    RecycledMemory::release(RecycledMemory::allocate(40), 40);
  }
  std::vector<void*> blocks;
};

TEST(RecycledMemory, TakesBlocksOfOtherThreadsAndAfterTheThreadsEnd) {
  std::vector<void*> blocks;
  for (int count = 0; count < 100; ++count)
    blocks.push_back(RecycledMemory::allocate(40));
  std::thread([&] {
    static thread_local ReleasesAtTheVeryEnd atTheEnd;
    atTheEnd.blocks.assign(blocks.begin(), blocks.begin() + 50);
    for (auto block = blocks.begin() + 50; block != blocks.end(); ++block)
      RecycledMemory::release(*block, 40);
  }).join();
}

}  // namespace
}  // namespace vesk
