#include <algorithm>
#include <array>
#include <gtest/gtest.h>
#include <memory>
#include <stop_token>
#include <thread>
#include <vector>

#include "system/main_queue.h"
#include "system/task.h"
#include "system/work_queue.h"

namespace vesk {
namespace {

TEST(Task, FreesWhatItHoldsOnceWhereverThatLies) {
  const auto held = std::make_shared<int>(0);
  const std::array<std::byte, 2 * Task::kRoom> large{};
  for (const bool isLarge : {false, true}) {
    Task task = isLarge ? Task([held, large] { *held += static_cast<int>(large.size()); }) : Task([held] { ++*held; });
    Task moved(std::move(task));
    task = std::move(moved);
    task();
    EXPECT_EQ(held.use_count(), 2);
    task = Task();
    EXPECT_EQ(held.use_count(), 1);
  }
  EXPECT_EQ(*held, 1 + static_cast<int>(large.size()));
}

TEST(WorkQueue, RunsInOrderAndFinishesWhatItHasBeforeItEnds) {
  std::vector<int> ran;
  {
    WorkQueue queue("org.example.serialQ.queue");
    for (int number = 0; number < 1000; ++number)
      queue.post([&ran, number] { ran.push_back(number); });
    queue.post([&] { queue.post([&] { ran.push_back(1000); }); });
  }
  EXPECT_EQ(ran.size(), 1001U);
  EXPECT_TRUE(std::is_sorted(ran.begin(), ran.end()));
}

TEST(WorkQueue, RunsWorkOnTheThreadThatWaitsForItBehindWhatWasThereAndBesideNothing) {
  constexpr int kThreads = 4;
  constexpr int kEach = 1000;
  WorkQueue queue("");
  // Not atomic: two at once would lose some.
  int count = 0;
  {
    std::vector<std::jthread> threads;
    threads.reserve(kThreads);
    for (int thread = 0; thread < kThreads; ++thread) {
      threads.emplace_back([&] {
        for (int number = 0; number < kEach; ++number) {
          bool isBehind = false;
          queue.post([&] {
            ++count;
            isBehind = true;
          });
          queue.sync([&, caller = std::this_thread::get_id()] {
            ++count;
            ASSERT_TRUE(isBehind && std::this_thread::get_id() == caller);
          });
        }
      });
    }
  }
  EXPECT_EQ(count, 2 * kThreads * kEach);
}

TEST(MainQueue, RunsABatchInOrderAndLeavesWhatItsTasksSchedule) {
  MainQueue queue;
  std::vector<int> ran;
  queue.post([&] {
    ran.push_back(1);
    queue.post([&] { ran.push_back(3); });
  });
  queue.post([&] { ran.push_back(2); });
  EXPECT_EQ(queue.runBatch(), 2U);
  EXPECT_EQ(ran, (std::vector{1, 2}));
  EXPECT_EQ(queue.runBatch(), 1U);
  EXPECT_EQ(ran, (std::vector{1, 2, 3}));
  EXPECT_TRUE(queue.isEmpty());
}

}  // namespace
}  // namespace vesk
