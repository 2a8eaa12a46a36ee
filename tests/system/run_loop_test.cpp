#include "system/run_loop.h"

#include <gtest/gtest.h>
#include <string>

#include "support/input.h"
#include "support/manual_clock.h"

namespace vesk {
namespace {

using namespace std::chrono_literals;

class RunLoopTest : public testing::Test {
 protected:
  ManualClock clock_;
  MainQueue queue_;
  RunLoop loop_{clock_, queue_};
};

TEST_F(RunLoopTest, TicksInARhythmAndAfterADelayOnlyOnce) {
  int ticks = 0;
  Timer timer(loop_, 5s, RunLoopMode::defaultMode, [&] { ++ticks; });
  const auto ticksAfter = [&](Clock::Duration by) {
    clock_.advance(by);
    loop_.runDue();
    return std::exchange(ticks, 0);
  };
  EXPECT_EQ(ticksAfter(0s), 0);
  EXPECT_EQ(ticksAfter(5s - 1ns), 0);
  EXPECT_EQ(ticksAfter(1ns), 1);
  EXPECT_EQ(ticksAfter(17s), 1) << "at 22 s: the ticks of 10, 15 and 20 s as one";
  EXPECT_EQ(ticksAfter(2s), 0);
  EXPECT_EQ(ticksAfter(1s), 1) << "at 25 s";
  timer.stop();
  EXPECT_EQ(ticksAfter(50s), 0);
}

TEST_F(RunLoopTest, HoldsATimerBackWhileAnotherModeRuns) {
  std::string ticks;
  const Timer normal(loop_, 5s, RunLoopMode::defaultMode, [&] { ticks += 'd'; });
  const Timer dragging(loop_, 5s, RunLoopMode::tracking, [&] { ticks += 't'; });
  loop_.setMode(RunLoopMode::tracking);
  clock_.advance(20s);
  loop_.runDue();
  EXPECT_EQ(ticks, "t");
  loop_.setMode(RunLoopMode::defaultMode);
  loop_.runDue();
  EXPECT_EQ(ticks, "td");
}

TEST_F(RunLoopTest, LetsATimerGoFromItsOwnAndFromAnothersAction) {
  std::string ticks;
  std::optional<Timer> first;
  std::optional<Timer> second;
  first.emplace(loop_, 1s, RunLoopMode::defaultMode, [&ticks, &first, &second, kept = std::string("1")] {
    first.reset();
    second.reset();
    ticks += kept;
  });
  second.emplace(loop_, 1s, RunLoopMode::defaultMode, [&] { ticks += '2'; });
  clock_.advance(3s);
  loop_.runDue();
  EXPECT_EQ(ticks, "1");
}

TEST_F(RunLoopTest, ServesInputsAndTimersWhileTasksKeepComing) {
  Pipe keys;
  std::string served;
  std::function<void()> again = [&] {
    if (served.size() < 2) queue_.post([&] { again(); });
  };
  again();
  writeAll(keys.writing, "k");
  const Timer timer(loop_, 1s, RunLoopMode::defaultMode, [&] { served += 't'; });
  loop_.addInput(keys.reading.get(), [&] {
    char key = 0;
    ASSERT_EQ(read(keys.reading.get(), &key, 1), 1);
    served += key;
  });
  clock_.advance(1s);
  loop_.runDue();
  EXPECT_EQ(served, "tk");
}

}  // namespace
}  // namespace vesk
