#include "corvik/client.h"

#include <gtest/gtest.h>
#include <string>
#include <thread>
#include <tuple>
#include <vector>

#include "system/main_queue.h"
#include "system/run_loop.h"

namespace corvik::client {
namespace {

using vesk::InterProcessDictionary;
using vesk::MainQueue;

const std::uint8_t kBytes[] = {0x08, 0x01};

/// Hands its stream to the test, and answers a query with the metric of the trigger's number.
class PlainService : public Service {
 public:
  EventStream* events = nullptr;

 private:
  void start(EventStream& stream) override { events = &stream; }
  void stop() override { events = nullptr; }
  Result answer(const MetricQuery& query, EventStream& stream) override {
    stream.raise(kEventMetric, makeMetricEvent(query.triggerId, kBytes));
    return {};
  }
};

class ClientTest : public testing::Test {
 protected:
  ClientTest() {
    installService(service_);
    manager_ = CreateManager("test", *queue_);
    installService(nullptr);
  }

  /// The main queue is the process's: no task may stay behind.
  void TearDown() override {
    manager_.reset();
    queue_.reset();
    loop_.runDue();
  }

  Result perform(const vesk::Text& command, const InterProcessDictionary& message) {
    InterProcessDictionary reply;
    return PerformCommand(manager_, command, message, reply);
  }
  Result configure() {
    InterProcessDictionary message;
    message.setData(kKeyPayload, vesk::Data::copy(kBytes));
    return perform(kCommandAddConfiguration, message);
  }
  /// Registers a handler for metrics that notes their ids.
  void note(std::vector<std::int64_t>& ids) {
    RegisterEventHandler(manager_, kEventMetric, [&ids](const InterProcessDictionary& event, const WorkGroup&) {
      ids.push_back(event.integer(kKeyMetricID).value_or(-1));
    });
  }
  void raise(std::int64_t id) { service_->events->raise(kEventMetric, makeMetricEvent(id, kBytes)); }
  /// Runs until everything raised before has been delivered.
  void deliverAll() {
    service_->events->afterDelivery([this] { loop_.stop(); });
    loop_.run();
  }

  vesk::SteadyClock clock_;
  vesk::RunLoop loop_{clock_};
  std::optional<vesk::WorkQueue> queue_{"test"};
  std::shared_ptr<PlainService> service_ = std::make_shared<PlainService>();
  std::shared_ptr<Manager> manager_;
};

TEST_F(ClientTest, RefusesWhatAServiceCannotExecuteAndSaysWhy) {
  InterProcessDictionary empty;
  empty.setData(kKeyPayload, vesk::Data());
  InterProcessDictionary incomplete;
  for (const vesk::Text& key : {kKeyTriggerRef, kKeyTriggerType, kKeyTriggerID, kKeyProfileID})
    incomplete.setInteger(key, 0);
  InterProcessDictionary complete = incomplete;
  complete.setInteger(kKeyMetricID, 0);
  const std::tuple<vesk::Text, InterProcessDictionary, std::int32_t, std::string> cases[] = {
      {kCommandAddConfiguration, empty, kStatusInvalidArgument, "empty configuration"},
      {kCommandAddConfiguration, complete, kStatusInvalidArgument, "configuration without a payload"},
      {kCommandQueryMetric, incomplete, kStatusInvalidArgument, "query without kKeyMetricID"},
      {kCommandQueryMetric, complete, 0, ""},
      {kCommandClearConfiguration, {}, 0, ""},
      {vesk::Text::copy("kCommandDance"), complete, kStatusUnknownCommand, "unknown command kCommandDance"},
  };
  for (const auto& [command, message, code, text] : cases) {
    const Result result = perform(command, message);
    EXPECT_EQ(result.code, code) << text;
    EXPECT_EQ(result.message, text);
  }
  EXPECT_EQ(configure().code, 0);
  service_->refuseAll(Result{-5, "modem is off"});
  EXPECT_EQ(configure().code, -5);
  manager_ = CreateManager("orphan", *queue_);
  EXPECT_EQ(configure().message, "no service for the client orphan");
}

TEST_F(ClientTest, DeliversInOrderOnItsQueueToTheHandlerRegisteredLastWhatWasRaisedWhileEventsWereOff) {
  std::vector<std::int64_t> first;
  std::vector<std::int64_t> second;
  note(first);
  note(second);
  std::thread::id handlersThread;
  std::thread::id queuesThread;
  queue_->post([&] { queuesThread = std::this_thread::get_id(); });
  RegisterEventHandler(manager_, kEventTrigger, [&](const InterProcessDictionary&, const WorkGroup&) {
    handlersThread = std::this_thread::get_id();
    second.push_back(0);
    EventsOff(manager_);
    MainQueue::shared().post([&] { loop_.stop(); });
  });
  raise(1);
  service_->events->raise(kEventTrigger, InterProcessDictionary());
  raise(2);
  EventsOn(manager_);
  loop_.run();
  EXPECT_EQ(second, (std::vector<std::int64_t>{1, 0})) << "the second event has switched them off";
  EventsOn(manager_);
  deliverAll();
  EXPECT_EQ(second, (std::vector<std::int64_t>{1, 0, 2}));
  EXPECT_TRUE(first.empty());
  EXPECT_EQ(handlersThread, queuesThread);
}

TEST_F(ClientTest, DeliversASourcesEventBeforeTheSourceGoesOnBehindThoseRaisedBefore) {
  std::vector<std::int64_t> ids;
  note(ids);
  const auto deliver = [&](std::int64_t id) { service_->events->deliver(kEventMetric, makeMetricEvent(id, kBytes)); };
  deliver(1);
  raise(2);
  EXPECT_TRUE(ids.empty()) << "they are off";
  EventsOn(manager_);
  deliver(3);
  EXPECT_EQ(ids, (std::vector<std::int64_t>{1, 2, 3}));
  EventsOff(manager_);
  deliver(4);
  EXPECT_EQ(ids.size(), 3U);
  EventsOn(manager_);
  raise(5);
  deliver(6);
  EXPECT_EQ(ids, (std::vector<std::int64_t>{1, 2, 3, 4, 5, 6}));
}

TEST_F(ClientTest, WantsMetricsOnceConfiguredAndOn) {
  std::atomic<bool> isWanted = false;
  const auto wait = [&](const std::stop_token& stop) {
    const bool isAnswered = service_->events->waitUntilWanted(stop);
    EXPECT_EQ(isAnswered, isWanted);
  };
  std::jthread(wait).request_stop();
  std::jthread source(wait);
  EventsOn(manager_);
  EventsOff(manager_);
  EXPECT_EQ(configure().code, 0);
  isWanted = true;
  EventsOn(manager_);
  source.join();
}

TEST_F(ClientTest, HoldsASourceBackThatIsAheadTheMoreTheLargerItsEventsAre) {
  constexpr int kEvents = 20000;
  EXPECT_EQ(configure().code, 0);
  EventsOn(manager_);
  for (const auto& [payload, mostAhead] : {std::pair<std::size_t, int>{2, 2100}, {1000, 20}}) {
    std::atomic<int> raised = 0;
    int received = 0;
    int ahead = 0;
    RegisterEventHandler(manager_, kEventMetric, [&](const InterProcessDictionary&, const WorkGroup&) {
      MainQueue::shared().post([&] { ahead = std::max(ahead, raised - ++received); });
    });
    std::jthread source([&, bytes = std::vector<std::uint8_t>(payload)](const std::stop_token& stop) {
      while (raised < kEvents && service_->events->waitUntilWanted(stop)) {
        ++raised;
        service_->events->deliver(kEventMetric, makeMetricEvent(1, bytes));
      }
    });
    while (received < kEvents)
      loop_.runDue();
    EXPECT_LT(ahead, mostAhead) << payload;
  }
}

TEST_F(ClientTest, KeepsTheOrderOfEachThreadOfAServiceThatRaisesFromSeveral) {
  constexpr std::int64_t kThreads = 4;
  constexpr std::int64_t kEventsEach = 5000;
  std::vector<std::int64_t> ids;
  note(ids);
  EventsOn(manager_);
  {
    std::vector<std::jthread> threads;
    for (std::int64_t thread = 0; thread < kThreads; ++thread) {
      threads.emplace_back([&, thread] {
        const auto hand = thread % 2 == 0 ? &EventStream::raise : &EventStream::deliver;
        for (std::int64_t event = 0; event < kEventsEach; ++event)
          (service_->events->*hand)(kEventMetric, makeMetricEvent(event * kThreads + thread, kBytes));
      });
    }
    // Switching them off and on meanwhile loses none either.
    for (int times = 0; times < 100; ++times) {
      EventsOff(manager_);
      EventsOn(manager_);
    }
  }
  deliverAll();
  ASSERT_EQ(ids.size(), static_cast<std::size_t>(kThreads * kEventsEach));
  std::vector<std::int64_t> next(kThreads);
  for (const std::int64_t id : ids)
    ASSERT_EQ(id / kThreads, next[static_cast<std::size_t>(id % kThreads)]++);
}

}  // namespace
}  // namespace corvik::client
