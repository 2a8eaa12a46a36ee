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
    EXPECT_EQ(queue.label(), "org.example.serialQ.queue");
    for (int number = 0; number < 1000; ++number)
      queue.async([&ran, number] { ran.push_back(number); });
    queue.async([&] { queue.async([&] { ran.push_back(-1); }); });
  }
  ASSERT_EQ(ran.size(), 1001U);
  for (int number = 0; number < 1000; ++number)
    ASSERT_EQ(ran[static_cast<std::size_t>(number)], number);
  EXPECT_EQ(ran.back(), -1);
}

TEST(WorkQueue, RunsWorkOnTheThreadThatWaitsForItBehindWhatWasThereAndBesideNothing) {
  constexpr int kThreads = 4;
  constexpr int kEach = 1000;
  WorkQueue queue("");
  std::vector<int> ran;
  for (int number = 0; number < kEach; ++number)
    queue.async([&ran, number] { ran.push_back(number); });
  const auto caller = std::this_thread::get_id();
  queue.sync([&] {
    EXPECT_EQ(std::this_thread::get_id(), caller);
    EXPECT_EQ(ran.size(), kEach);
    EXPECT_TRUE(std::is_sorted(ran.begin(), ran.end()));
  });
  // Not atomic: two at once would lose some.
  int count = 0;
  {
    std::vector<std::jthread> threads;
    for (int thread = 0; thread < kThreads; ++thread) {
      threads.emplace_back([&] {
        for (int number = 0; number < kEach; ++number) {
          queue.async([&count] { ++count; });
          queue.sync([&count] { ++count; });
        }
      });
    }
  }
  queue.sync([&] { EXPECT_EQ(count, 2 * kThreads * kEach); });
}

TEST(MainQueue, RunsABatchInOrderAndLeavesWhatItsTasksSchedule) {
  MainQueue queue;
  std::vector<int> ran;
  queue.async([&] {
    ran.push_back(1);
    queue.async([&] { ran.push_back(3); });
  });
  queue.async([&] { ran.push_back(2); });
  EXPECT_EQ(queue.runBatch(), 2U);
  EXPECT_EQ(ran, (std::vector{1, 2}));
  EXPECT_EQ(queue.runBatch(), 1U);
  EXPECT_EQ(ran, (std::vector{1, 2, 3}));
  EXPECT_TRUE(queue.isEmpty());
}

TEST(MainQueue, KeepsItsOrderWhenATaskServesItToo) {
  MainQueue queue;
  std::vector<int> ran;
  queue.async([&] {
    queue.async([&] { ran.push_back(3); });
    EXPECT_EQ(queue.runBatch(), 1U);
    EXPECT_EQ(queue.runBatch(), 1U);
    ran.push_back(4);
  });
  queue.async([&] { ran.push_back(2); });
  EXPECT_EQ(queue.runBatch(), 2U);
  EXPECT_EQ(ran, (std::vector{2, 3, 4}));
  EXPECT_EQ(queue.runBatch(), 0U);
}

TEST(MainQueue, HoldsASourceThatIsAheadUntilTasksAreTakenOrItShallStop) {
  constexpr std::size_t kMost = 8;
  constexpr int kEvents = 1000;
  MainQueue queue;
  int ran = 0;
  std::jthread source([&](const std::stop_token& stop) {
    for (int event = 0; event < kEvents; ++event) {
      ASSERT_TRUE(queue.waitUntilFewerThan(kMost, stop));
      queue.async([&ran] { ++ran; });
    }
  });
  while (ran < kEvents)
    EXPECT_LE(queue.runBatch(), kMost);
  source.join();

  queue.async([] {});
  bool wasRoom = true;
  std::jthread stopped([&](const std::stop_token& stop) { wasRoom = queue.waitUntilFewerThan(1, stop); });
  stopped.request_stop();
  stopped.join();
  EXPECT_FALSE(wasRoom);
}

}  // namespace
}  // namespace vesk
