#include "handset/handset_service.h"

#include <condition_variable>
#include <gtest/gtest.h>
#include <mutex>
#include <vector>

#include "corvik/client.h"
#include "handset/driven_events.h"
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
    client::RegisterEventHandler(manager_, ::corvik::kEventMetric,
                                 [this](const InterProcessDictionary& event, const client::WorkGroup&) {
                                   take(event.integer("kKeyMetricID"_text).value_or(-1));
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

  /// On the client's queue.
  void take(std::int64_t id) {
    const std::lock_guard lock(mutex_);
    ids_.push_back(id);
    taken_.notify_all();
  }
  /// The metrics so far, once there are at least `count`.
  Ids atLeast(std::size_t count) {
    std::unique_lock lock(mutex_);
    taken_.wait(lock, [&] { return ids_.size() >= count; });
    return ids_;
  }

  ManualClock clock_;
  std::mutex mutex_;
  std::condition_variable taken_;
  Ids ids_;
  WorkQueue queue_{"test"};
  std::shared_ptr<client::Manager> manager_;
};

TEST_F(HandsetServiceTest, TellsNothingButTheAnswerToAQueryBeforeItIsConfigured) {
  EXPECT_EQ(query(0x7F0013), 0);
  EXPECT_EQ(atLeast(1), Ids{kSimFiles});
  EXPECT_EQ(configure({1}), 0);
  EXPECT_EQ(atLeast(2)[1], kFirst);

  EXPECT_NE(perform("kCommandReboot"_text, {}), 0);
  EXPECT_NE(configure({}), 0);
  EXPECT_NE(query(0x7F0014), 0);
}

TEST_F(HandsetServiceTest, KeepsTheHandsetsTime) {
  configure({1});
  EXPECT_EQ(atLeast(1), Ids{kFirst});
  const Clock::Instant start = clock_.now();
  for (int event = 0; event < 200; ++event)
    clock_.advance(clock_.waitForSleeper());
  atLeast(190);
  const std::vector<HandsetEvent> events = drivenEvents(1, 60);
  EXPECT_EQ(clock_.now() - start, std::chrono::milliseconds(events[200].atMs));
}

TEST_F(HandsetServiceTest, StandsStillWhileNobodyWantsMetrics) {
  configure({1});
  clock_.advance(clock_.waitForSleeper());
  atLeast(2);
  EXPECT_EQ(perform(kCommandClearConfiguration, {}), 0);
  clock_.advance(1h);
  configure({1});
  // The hour is not made up for.
  clock_.advance(clock_.waitForSleeper());
  EXPECT_LT(atLeast(3).size(), 20U);
}

TEST_F(HandsetServiceTest, TellsNothingWhileEventsAreOffAndEndsAtOnce) {
  client::EventsOff(manager_);
  configure({1});
  EXPECT_EQ(query(0x7F0013), 0);
  EXPECT_EQ(atLeast(0), Ids{});
  client::EventsOn(manager_);
  EXPECT_EQ(atLeast(1).front(), kSimFiles);
  // Waiting for a time that never comes, it is interrupted.
  manager_.reset();
}

}  // namespace
}  // namespace vesk::handset
