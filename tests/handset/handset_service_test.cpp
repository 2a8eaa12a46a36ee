#include "handset/handset_service.h"

#include <gtest/gtest.h>
#include <vector>

#include "corvik/client.h"
#include "platform/main_queue.h"
#include "platform/run_loop.h"
#include "support/manual_clock.h"

namespace vesk::handset {
namespace {

using namespace std::chrono_literals;
namespace client = ::corvik::client;
using ::corvik::kCommandAddConfiguration;
using ::corvik::kCommandClearConfiguration;
using ::corvik::kCommandQueryMetric;
using Ids = std::vector<std::int64_t>;

const std::int64_t kSimFiles = kMetricId<metrics::KCellularSimCardFiles>;
const std::int64_t kFirst = kMetricId<metrics::KCellularMmCommonInfo>;

/// A client of a handset's service that has switched events on, and notes the ids of the metrics it gets.
class HandsetServiceTest : public testing::Test {
 protected:
  HandsetServiceTest() {
    ::corvik::installService(std::make_shared<HandsetService>(1, 0, clock_));
    manager_ = client::CreateManager("test", queue_);
    ::corvik::installService(nullptr);
    client::RegisterEventHandler(
        manager_, ::corvik::kEventMetric, [this](const InterProcessDictionary& event, const client::WorkGroup&) {
          MainQueue::shared().async([this, id = event.integer("kKeyMetricID").value_or(-1)] { take(id); });
        });
    client::EventsOn(manager_);
  }

  std::int32_t perform(const Text& command, const InterProcessDictionary& message) {
    InterProcessDictionary reply;
    return client::PerformCommand(manager_, command, message, reply).code;
  }
  std::int32_t configure(std::vector<std::uint8_t> content) {
    InterProcessDictionary message;
    message.setData(::corvik::kKeyPayload, Data::copy(content));
    return perform(kCommandAddConfiguration, message);
  }
  std::int32_t query(std::int64_t triggerId) {
    InterProcessDictionary message;
    message.setInteger(::corvik::kKeyTriggerRef, 9999);
    message.setInteger(::corvik::kKeyTriggerType, 0);
    message.setInteger(::corvik::kKeyTriggerID, triggerId);
    message.setInteger(::corvik::kKeyProfileID, 0);
    message.setInteger(::corvik::kKeyMetricID, 0);
    return perform(kCommandQueryMetric, message);
  }

  void take(std::int64_t id) {
    ids_.push_back(id);
    if (ids_.size() == stopAfter_) loop_.stop();
  }
  /// Runs until there are `count` metrics in all.
  const Ids& first(std::size_t count) {
    stopAfter_ = count;
    if (ids_.size() < count) loop_.run();
    return ids_;
  }

  ManualClock clock_;
  SteadyClock steadyClock_;
  RunLoop loop_{steadyClock_};
  WorkQueue queue_{"test"};
  Ids ids_;
  std::size_t stopAfter_ = 0;
  std::shared_ptr<client::Manager> manager_;
};

TEST_F(HandsetServiceTest, TellsNothingButTheAnswerToAQueryBeforeItIsConfigured) {
  EXPECT_EQ(query(0x7F0013), 0);
  EXPECT_EQ(first(1), Ids{kSimFiles});
  EXPECT_EQ(configure({1}), 0);
  EXPECT_EQ(first(2), (Ids{kSimFiles, kFirst}));
}

TEST_F(HandsetServiceTest, RefusesWhatItCannotDo) {
  EXPECT_NE(perform("kCommandReboot"_text, {}), 0);
  EXPECT_NE(configure({}), 0);
  EXPECT_NE(query(0x7F0014), 0);
  EXPECT_EQ(perform(kCommandClearConfiguration, {}), 0);
}

TEST_F(HandsetServiceTest, KeepsTheHandsetsTime) {
  configure({1});
  // The events of the first instant, then nothing for the rest of the first step.
  EXPECT_LE(clock_.waitForSleeper(), 100ms);
  first(1);
  EXPECT_LT(ids_.size(), 20U);
  for (int step = 0; step < 100; ++step)
    clock_.advance(clock_.waitForSleeper());
  first(50);
}

TEST_F(HandsetServiceTest, StandsStillWhileNobodyWantsMetrics) {
  configure({1});
  clock_.advance(clock_.waitForSleeper());
  first(2);
  EXPECT_EQ(perform(kCommandClearConfiguration, {}), 0);
  clock_.advance(1h);
  configure({1});
  // The hour is not made up for.
  clock_.advance(clock_.waitForSleeper());
  EXPECT_LT(first(3).size(), 20U);
}

TEST_F(HandsetServiceTest, TellsNothingWhileEventsAreOffAndEndsAtOnce) {
  client::EventsOff(manager_);
  configure({1});
  EXPECT_EQ(query(0x7F0013), 0);
  loop_.runDue();
  EXPECT_EQ(ids_, Ids{});
  client::EventsOn(manager_);
  EXPECT_EQ(first(1).front(), kSimFiles);
  // Waiting for a time that never comes, it is interrupted.
  manager_.reset();
}

}  // namespace
}  // namespace vesk::handset
