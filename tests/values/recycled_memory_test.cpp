#include "values/recycled_memory.h"

#include <cstring>
#include <gtest/gtest.h>
#include <set>
#include <thread>
#include <vector>

#include "support/allocations.h"

namespace vesk {
namespace {

TEST(RecycledMemory, GivesABlockAgainForASizeOfTheSameStepAlone) {
  if (kIsSanitized) GTEST_SKIP() << "every block comes from the heap";
  struct Case {
    std::size_t released;
    std::size_t asked;
    bool isSame;
  };
  const Case cases[] = {{1, 32, true}, {64, 33, true}, {32, 33, false}, {33, 32, false}, {1024, 993, true}};
  for (const auto& [released, asked, isSame] : cases) {
    void* const block = RecycledMemory::allocate(released);
    RecycledMemory::release(block, released);
    void* const next = RecycledMemory::allocate(asked);
    EXPECT_EQ(next == block, isSame) << released << ", then " << asked;
    RecycledMemory::release(next, asked);
  }
}

std::vector<void*> allocateMany(std::size_t size, std::size_t count) {
  std::vector<void*> blocks;
  blocks.reserve(count);
  for (std::size_t index = 0; index < count; ++index)
    blocks.push_back(RecycledMemory::allocate(size));
  return blocks;
}

void releaseAll(const std::vector<void*>& blocks, std::size_t size) {
  for (void* const block : blocks)
    RecycledMemory::release(block, size);
}

TEST(RecycledMemory, NoBlockHasTwoOwnersHoweverManyWereReleased) {
  for (const std::size_t size : {32U, 33U, 1024U, 1025U}) {
    for (int round = 0; round < 2; ++round) {
      const std::vector<void*> blocks = allocateMany(size, 500);
      for (void* const block : blocks)
        std::memset(block, round, size);
      EXPECT_EQ(std::set(blocks.begin(), blocks.end()).size(), blocks.size()) << size;
      releaseAll(blocks, size);
    }
  }
}

/// Made before the first use of its thread, it ends after what the thread keeps.
struct ReleasesAtTheVeryEnd {
  ~ReleasesAtTheVeryEnd() {
    releaseAll(blocks, 40);
    const std::uint64_t before = allocatedBytes();
    RecycledMemory::release(RecycledMemory::allocate(40), 40);
    EXPECT_GE(allocatedBytes() - before, 40U) << "nothing was kept";
  }
  std::vector<void*> blocks;
};

TEST(RecycledMemory, TakesBlocksOfOtherThreadsAfterTheThreadsEndToo) {
  const std::vector<void*> blocks = allocateMany(40, 50);
  std::thread([&] {
    static thread_local ReleasesAtTheVeryEnd atTheEnd;
    atTheEnd.blocks = blocks;
    RecycledMemory::release(RecycledMemory::allocate(40), 40);
  }).join();
}

}  // namespace
}  // namespace vesk
