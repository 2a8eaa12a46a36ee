#include "link/corvik_wrapper.h"

#include <fstream>
#include <future>
#include <gtest/gtest.h>
#include <limits>
#include <string>
#include <thread>
#include <vector>

#include "support/recorded_log.h"
#include "system/main_queue.h"
#include "system/run_loop.h"
#include "values/text_form.h"

namespace vesk {
namespace {

using Lines = std::vector<std::string>;

/// Notes what it is told, and lets the test raise events.
class NotingService : public corvik::Service {
 public:
  corvik::Result perform(const Text& command, const InterProcessDictionary& message) override {
    told.push_back(std::string(command.view()) + ' ' + textOf(message.ordinary().value()));
    return result;
  }

  Lines told;
  corvik::Result result;
  corvik::EventStream* events = nullptr;

 private:
  void start(corvik::EventStream& stream) override { events = &stream; }
  void stop() override { events = nullptr; }
  corvik::Result answer(const corvik::MetricQuery&, corvik::EventStream&) override { return {}; }
};

class NotingDelegate : public CorvikWrapperDelegate {
 public:
  explicit NotingDelegate(Lines& notes) : notes_(notes) {}
  void metricsDidUpdate(const std::optional<Dictionary>& event) override {
    notes_.push_back("metric " + textOf(event.value()));
  }
  void eventsDidUpdate(const std::optional<Dictionary>& event) override {
    notes_.push_back("trigger " + textOf(event.value()));
  }

 private:
  Lines& notes_;
};

class CorvikWrapperTest : public testing::Test {
 protected:
  CorvikWrapperTest() {
    corvik::installService(service_);
    wrapper_ = CorvikWrapper::make();
    corvik::installService(nullptr);
  }
  void TearDown() override {
    wrapper_.reset();
    settleHandlers();
    loop_.runDue();
  }

  /// Waits until the handlers have seen every event raised so far.
  void settleHandlers() {
    std::promise<void> settled;
    CorvikWrapper::queue().post([&] { settled.set_value(); });
    settled.get_future().wait();
  }
  void raise(const Text& event, std::int64_t id) {
    InterProcessDictionary message;
    message.setInteger("id"_text, id);
    service_->events->raise(event, message);
    settleHandlers();
  }

  SteadyClock clock_;
  RunLoop loop_{clock_};
  Lines notes_;
  std::shared_ptr<NotingDelegate> delegate_ = std::make_shared<NotingDelegate>(notes_);
  std::shared_ptr<NotingService> service_ = std::make_shared<NotingService>();
  std::shared_ptr<CorvikWrapper> wrapper_;
};

TEST_F(CorvikWrapperTest, SendsCommandsWithTheServicesIdentifierAndLogsTheirOutcome) {
  const std::string path = testing::TempDir() + "vesk_link_test.deviceconfig";
  std::ofstream(path) << "\x01\xAB";
  const RecordedLog log;
  EXPECT_TRUE(wrapper_->removeQuodraConfigForAppid("vesk"));
  EXPECT_TRUE(wrapper_->addQuodraConfigForAppId("vesk", path));
  service_->result = {-3, "busy"};
  EXPECT_FALSE(wrapper_->querySpecificMetric("vesk", 9999, 0, 8323091, std::numeric_limits<std::int32_t>::min(), -1));
  EXPECT_EQ(service_->told, (Lines{"kCommandClearConfiguration {kKeyAppID: 2}",
                                   "kCommandAddConfiguration {kKeyAppID: 2, kKeyPayload: 0x01ab, kKeyPayloadType: 0}",
                                   "kCommandQueryMetric {kKeyAppID: 2, kKeyPayloadType: 0, kKeyTriggerRef: 9999, "
                                   "kKeyTriggerType: 0, kKeyTriggerID: 8323091, kKeyProfileID: -2147483648, "
                                   "kKeyMetricID: -1}"}));
  EXPECT_EQ(log.lines(),
            (Lines{"-[CorvikWrapper removeQuodraConfigForAppid:]: error=0 msg=",
                   "-[CorvikWrapper addQuodraConfigForAppId:andProtofFilePath:]: error=0 msg=",
                   "-[CorvikWrapper querySpecificMetric:triggerRef:triggerType:triggerID:profileID:metricID:]: "
                   "error=-3 msg=busy"}));
}

TEST_F(CorvikWrapperTest, SendsAndLogsNothingForAnotherApplicationOrAFileThatCannotBeRead) {
  const RecordedLog log;
  for (const char* appId : {"Vesk", "", "vesk "}) {
    EXPECT_FALSE(wrapper_->addQuodraConfigForAppId(appId, "/dev/null"));
    EXPECT_FALSE(wrapper_->removeQuodraConfigForAppid(appId));
    EXPECT_FALSE(wrapper_->querySpecificMetric(appId, 1, 2, 3, 4, 5));
  }
  EXPECT_FALSE(wrapper_->addQuodraConfigForAppId("vesk", "/no/such/file"));
  EXPECT_FALSE(wrapper_->addQuodraConfigForAppId("vesk", "/"));
  EXPECT_TRUE(service_->told.empty());
  EXPECT_TRUE(log.lines().empty());
}

TEST_F(CorvikWrapperTest, ForwardsEventsToItsDelegateOnTheMainQueue) {
  const RecordedLog log;
  wrapper_->listen();
  wrapper_->setDelegate(delegate_);
  wrapper_->listen();
  raise(corvik::kEventMetric, 1);
  raise(corvik::kEventTrigger, 2);
  EXPECT_TRUE(notes_.empty());
  loop_.runDue();
  EXPECT_EQ(notes_, (Lines{"metric {id: 1}", "trigger {id: 2}"}));
  EXPECT_EQ(log.lines(),
            (Lines{"-[CorvikWrapper listen]: listening for events", "-[CorvikWrapper listen]: listening for events",
                   "-[CorvikWrapper listen]_block_invoke: MetricsTrigger dict={id: 1}",
                   "-[CorvikWrapper listen]_block_invoke: EventTrigger dict={id: 2}"}));
}

TEST_F(CorvikWrapperTest, DropsAnEventWithoutADelegateWhenItComesOrWhenItsTurnComes) {
  Lines others;
  const auto other = std::make_shared<NotingDelegate>(others);
  wrapper_->listen();
  raise(corvik::kEventMetric, 1);
  wrapper_->setDelegate(delegate_);
  loop_.runDue();
  raise(corvik::kEventMetric, 2);
  wrapper_->setDelegate(other);
  loop_.runDue();
  EXPECT_EQ(others, Lines{"metric {id: 2}"});
  raise(corvik::kEventMetric, 3);
  wrapper_->setDelegate(delegate_);
  delegate_.reset();
  loop_.runDue();
  EXPECT_TRUE(notes_.empty());
  EXPECT_EQ(others.size(), 1U);
}

TEST_F(CorvikWrapperTest, LosesItsDelegateInTheMidstOfItsEvents) {
  constexpr int kEvents = 5000;
  constexpr std::size_t kNoted = 100;
  /// Lets go of the last one who holds it while it is told of an event.
  struct LeavingDelegate : NotingDelegate {
    using NotingDelegate::NotingDelegate;
    void metricsDidUpdate(const std::optional<Dictionary>& event) override {
      NotingDelegate::metricsDidUpdate(event);
      if (++count == kNoted) held->reset();
    }
    std::shared_ptr<LeavingDelegate>* held = nullptr;
    std::size_t count = 0;
  };
  auto held = std::make_shared<LeavingDelegate>(notes_);
  held->held = &held;
  wrapper_->listen();
  wrapper_->setDelegate(held);
  std::jthread source([this] {
    for (int id = 0; id < kEvents; ++id)
      service_->events->raise(corvik::kEventMetric, InterProcessDictionary());
  });
  while (held != nullptr)
    loop_.runDue();
  source.join();
  settleHandlers();
  loop_.runDue();
  EXPECT_EQ(notes_.size(), kNoted);
}

TEST_F(CorvikWrapperTest, EndsOnTheMainThreadThoughAHandlerIsTheLastToHoldIt) {
  struct LettingGo : LogSink {
    explicit LettingGo(std::shared_ptr<CorvikWrapper>& wrapper) : held(wrapper) {}
    void write(std::string_view) override { held.reset(); }
    std::shared_ptr<CorvikWrapper>& held;
  };
  wrapper_->listen();
  wrapper_->setDelegate(delegate_);
  auto previous = SystemLog::setSink(std::make_unique<LettingGo>(wrapper_));
  raise(corvik::kEventMetric, 1);
  SystemLog::setSink(std::move(previous));
  EXPECT_EQ(wrapper_, nullptr);
  EXPECT_NE(service_->events, nullptr) << "still connected";
  loop_.runDue();
  EXPECT_EQ(notes_, Lines{"metric {id: 1}"});
  EXPECT_EQ(service_->events, nullptr);
}

TEST_F(CorvikWrapperTest, LogsAndDropsAnEventWithoutAnOrdinaryForm) {
  const RecordedLog log;
  wrapper_->listen();
  wrapper_->setDelegate(delegate_);
  InterProcessDictionary message;
  message.setDescriptor("trace"_text, FileDescriptor::borrowed(0));
  service_->events->raise(corvik::kEventMetric, message);
  settleHandlers();
  loop_.runDue();
  EXPECT_TRUE(notes_.empty());
  EXPECT_EQ(log.lines().back(),
            "-[CorvikWrapper listen]_block_invoke: MetricsTrigger dropped: it has no ordinary form");
}

}  // namespace
}  // namespace vesk
