#include "corvik/recorded_service.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <string>
#include <vector>

#include "corvik/client.h"
#include "recording/recording_reader.h"
#include "support/input.h"
#include "support/manual_clock.h"
#include "system/main_queue.h"
#include "system/run_loop.h"

namespace corvik {
namespace {

using namespace std::chrono_literals;
using Runs = RecordedService::Runs;
using Phase = PlaybackState::Phase;

using Ids = std::vector<std::int64_t>;

std::string line(double at, int id) {
  std::string text;
  vesk::appendRecordedEvent(text, {at, id, {}});
  return text;
}

/// A client of a recorded service, which notes the ids of the metrics it gets.
class RecordedServiceTest : public testing::Test {
 protected:
  /// The main queue is the process's: no task may stay behind.
  void TearDown() override {
    manager_.reset();
    queue_.reset();
    loop_.runDue();
  }

  void connect(vesk::FileDescriptor recording, Playback playback, Runs runs = Runs::onThreadOfItsOwn) {
    auto reader = std::make_unique<vesk::RecordingReader>(std::move(recording), "r");
    service_ = std::make_shared<RecordedService>(std::move(reader), clock_, playback, runs);
    service_->setBadLineHandler([this](const std::string& message) { badLines_.push_back(message); });
    service_->setEndHandler([this](const std::optional<std::string>& failure) {
      failure_ = failure;
      isEnded_ = true;
      loop_.stop();
    });
    service_->setSeekHandlers([this](bool isFromStart) { ids_ = {isFromStart ? kFromStart : kOn}; },
                              [this](double sinceLastEvent) {
                                sinceLastEvent_ = sinceLastEvent;
                                ids_.push_back(kArrived);
                                loop_.stop();
                              });
    installService(service_);
    manager_ = client::CreateManager("test", *queue_);
    installService(nullptr);
    client::RegisterEventHandler(
        manager_, kEventMetric, [this](const vesk::InterProcessDictionary& event, const client::WorkGroup&) {
          vesk::MainQueue::shared().post([this, id = event.integer(kKeyMetricID)] { take(id.value()); });
        });
    client::EventsOn(manager_);
    vesk::InterProcessDictionary configuration;
    configuration.setData(kKeyPayload, vesk::Data::copy(std::vector<std::uint8_t>{1}));
    vesk::InterProcessDictionary reply;
    EXPECT_EQ(client::PerformCommand(manager_, kCommandAddConfiguration, configuration, reply).code, 0);
  }

  void take(std::int64_t id) {
    ids_.push_back(id);
    if (ids_.size() == stopAfter_) loop_.stop();
  }
  /// What comes when the next `count` events may come that the service now waits for.
  Ids next(std::size_t count) {
    ids_.clear();
    stopAfter_ = count;
    clock_.advance(clock_.waitForSleeper());
    loop_.run();
    return ids_;
  }

  /// What comes until the way to a position has ended.
  Ids arrival() {
    stopAfter_ = 0;
    loop_.run();
    return ids_;
  }

  static constexpr std::int64_t kFromStart = -1;
  static constexpr std::int64_t kOn = -2;
  static constexpr std::int64_t kArrived = -3;

  vesk::ManualClock clock_;
  vesk::SteadyClock steadyClock_;
  vesk::RunLoop loop_{steadyClock_};
  std::optional<vesk::WorkQueue> queue_{"test"};
  Ids ids_;
  double sinceLastEvent_ = 0;
  std::vector<std::string> badLines_;
  std::optional<std::string> failure_;
  bool isEnded_ = false;
  std::size_t stopAfter_ = 0;
  std::shared_ptr<RecordedService> service_;
  std::shared_ptr<client::Manager> manager_;
};

class RecordedServiceOnEitherThread : public RecordedServiceTest, public testing::WithParamInterface<Runs> {};
INSTANTIATE_TEST_SUITE_P(Runs, RecordedServiceOnEitherThread,
                         testing::Values(Runs::onThreadOfItsOwn, Runs::onMainThread));

TEST_P(RecordedServiceOnEitherThread, PlaysAllAsFastAsItIsTakenThenTellsItsEnd) {
  std::string recording;
  Ids expected;
  for (int id = 0; id < 5000; ++id) {
    recording += line(id * 10.0, id);
    expected.push_back(id);
    if (id == 2) recording += "bad\n";
  }
  connect(vesk::fileWith(recording), {std::nullopt, false}, GetParam());
  loop_.run();
  EXPECT_TRUE(isEnded_);
  EXPECT_EQ(ids_, expected);
  vesk::InterProcessDictionary query;
  for (const vesk::Text& key : {kKeyTriggerRef, kKeyTriggerType, kKeyTriggerID, kKeyProfileID, kKeyMetricID})
    query.setInteger(key, 0);
  EXPECT_EQ(client::PerformCommand(manager_, kCommandQueryMetric, query, query).code, kStatusNotSupported);
  EXPECT_EQ(badLines_, std::vector<std::string>{"r:4: no JSON object"});
  EXPECT_EQ(failure_, std::nullopt);
  const PlaybackState state = service_->state();
  EXPECT_EQ(state.phase, Phase::ended);
  EXPECT_EQ(state.position, 49990.0);
  EXPECT_EQ(state.duration, 49990.0);
  EXPECT_EQ(state.events, 5000U);
  EXPECT_EQ(state.badLines, 1U);
}

TEST_P(RecordedServiceOnEitherThread, PlaysNothingOnceItsClientHasGone) {
  std::string recording;
  for (int id = 0; id < 5000; ++id)
    recording += line(0, id);
  connect(vesk::fileWith(recording), {std::nullopt, true}, GetParam());
  stopAfter_ = 100;
  loop_.run();
  manager_.reset();
  loop_.runDue();
  const std::size_t taken = ids_.size();
  loop_.runDue();
  EXPECT_EQ(ids_.size(), taken);
  EXPECT_FALSE(isEnded_);
}

TEST_F(RecordedServiceTest, KeepsTheRecordingsPaceAndDoesNotWaitForAStepBack) {
  connect(vesk::fileWith(line(1, 1) + line(3, 3) + line(0.5, 4) + line(1.5, 5)), {2.0, false});
  EXPECT_EQ(clock_.waitForSleeper(), 500ms);
  EXPECT_EQ(next(1), Ids{1});
  EXPECT_EQ(clock_.waitForSleeper(), 1s);
  EXPECT_EQ(next(2), (Ids{3, 4}));
  EXPECT_EQ(service_->state().phase, Phase::playing);
  EXPECT_EQ(service_->state().position, 0.5);
  clock_.advance(400ms);
  EXPECT_EQ(clock_.waitForSleeper(), 100ms);
  EXPECT_EQ(next(1), Ids{5});
  // The end may have come together with the last event.
  while (!isEnded_)
    loop_.run();
}

TEST_F(RecordedServiceTest, ShortensPausesOfMoreThanAMinuteUnlessTheyAreKept) {
  for (const bool keepsPauses : {false, true}) {
    connect(vesk::fileWith(line(60, 2) + line(121, 3)), {.speed = 1.0, .keepsPauses = keepsPauses});
    EXPECT_EQ(clock_.waitForSleeper(), 60s);
    EXPECT_EQ(service_->state().shortenedPause, std::nullopt);
    EXPECT_EQ(next(1), Ids{2});
    EXPECT_EQ(clock_.waitForSleeper(), keepsPauses ? 61s : 5s);
    EXPECT_EQ(service_->state().shortenedPause, keepsPauses ? std::nullopt : std::optional(61.0));
    EXPECT_EQ(next(1), Ids{3});
    EXPECT_EQ(service_->state().shortenedPause, std::nullopt);
    while (!isEnded_)
      loop_.run();
    isEnded_ = false;
    manager_.reset();
  }
}

TEST_F(RecordedServiceTest, GoesRoundAndTellsBadLinesOnce) {
  connect(vesk::fileWith(line(1, 1) + "bad\n" + line(3, 2)), {1.0, true});
  EXPECT_EQ(next(1), Ids{1});
  for (int lap = 0; lap < 2; ++lap) {
    EXPECT_EQ(clock_.waitForSleeper(), 2s);
    EXPECT_EQ(next(1), Ids{2});
    EXPECT_EQ(clock_.waitForSleeper(), 1s);
    EXPECT_EQ(next(1), Ids{1});
  }
  EXPECT_EQ(badLines_.size(), 1U);
}

TEST_F(RecordedServiceTest, GoesToAnyMomentByPlayingUpToItThenOnFromThere) {
  connect(vesk::fileWith(line(1, 1) + line(2, 2) + "bad\n" + line(2, 3) + line(4, 4) + line(9, 5)), {1.0, false});
  Player& player = service_->player();
  EXPECT_GT(clock_.waitForSleeper(), 0s);
  player.setHeld(true);
  EXPECT_TRUE(player.seek(3));
  EXPECT_EQ(arrival(), (Ids{kOn, 1, 2, 3, kArrived}));
  EXPECT_EQ(service_->state().position, 3);
  EXPECT_TRUE(player.seek(3.5));
  EXPECT_EQ(arrival(), (Ids{kOn, kArrived}));
  EXPECT_EQ(sinceLastEvent_, 1.5);
  EXPECT_TRUE(player.seek(1.5));
  EXPECT_EQ(arrival(), (Ids{kFromStart, 1, kArrived}));
  EXPECT_EQ(sinceLastEvent_, 0.5);
  EXPECT_TRUE(player.seekToEvent(2));
  EXPECT_EQ(arrival(), (Ids{kOn, 2, kArrived}));
  EXPECT_EQ(sinceLastEvent_, 0);
  EXPECT_TRUE(player.seek(-7));
  EXPECT_EQ(arrival(), (Ids{kFromStart, kArrived}));
  EXPECT_TRUE(player.seek(3));
  EXPECT_EQ(arrival(), (Ids{kOn, 1, 2, 3, kArrived}));

  clock_.advance(1h);
  player.setSpeed(2);
  player.setHeld(false);
  while (clock_.waitForSleeper() > 1s) {
  }
  EXPECT_EQ(clock_.waitForSleeper(), 500ms);
  EXPECT_EQ(next(1), Ids{4});
  EXPECT_GT(clock_.waitForSleeper(), 0s);
  clock_.advance(1s);
  EXPECT_EQ(service_->state().position, 6);

  EXPECT_TRUE(player.seek(1e9));
  EXPECT_EQ(arrival(), (Ids{kOn, 5, kArrived}));
  while (!isEnded_)
    loop_.run();
  EXPECT_EQ(service_->state().phase, Phase::ended);
  EXPECT_TRUE(player.seek(4));
  EXPECT_EQ(arrival(), (Ids{kFromStart, 1, 2, 3, 4, kArrived}));
  EXPECT_EQ(badLines_.size(), 1U);
  EXPECT_EQ(service_->state().events, 4U);
}

TEST_F(RecordedServiceTest, PlaysAPipeAsItIsWrittenAndIsInterruptedWhileItWaitsForMore) {
  vesk::Pipe pipe;
  connect(std::move(pipe.reading), {std::nullopt, false});
  for (int id = 1; id <= 2; ++id) {
    vesk::writeAll(pipe.writing, line(id, id));
    stopAfter_ = static_cast<std::size_t>(id);
    loop_.run();
  }
  EXPECT_EQ(ids_, (Ids{1, 2}));
  EXPECT_EQ(service_->state().duration, std::nullopt);
  EXPECT_FALSE(service_->player().seek(0));
  service_->player().setSpeed(3);
  manager_.reset();
  EXPECT_FALSE(isEnded_);
}

TEST_F(RecordedServiceTest, IsInterruptedWhileItWaitsForAnEventsTime) {
  connect(vesk::fileWith(line(1e9, 1)), {.speed = 1.0, .keepsPauses = true});
  EXPECT_GT(clock_.waitForSleeper(), 1h);
  manager_.reset();
  EXPECT_TRUE(ids_.empty());
}

TEST_F(RecordedServiceTest, TellsWhyTheRecordingCouldNotBeRead) {
  connect(vesk::FileDescriptor(open("/", O_RDONLY)), {1.0, true});
  loop_.run();
  EXPECT_EQ(failure_, "r: Is a directory");
}

}  // namespace
}  // namespace corvik
