#include <gtest/gtest.h>
#include <string>
#include <vector>

#include "app/source/replay_control.h"
#include "corvik/recorded_service.h"
#include "handset/driven_events.h"
#include "insight/insight.h"
#include "intake/metric_validator.h"
#include "recording/recording_reader.h"
#include "support/input.h"
#include "system/main_queue.h"
#include "system/output_lines.h"
#include "system/run_loop.h"

namespace vesk {
namespace {

/// What a drive leaves behind.
struct Followed {
  Followed() { insight.observeEventsOf(*intake); }

  std::shared_ptr<MetricValidator> intake = MetricValidator::listeningTo(nullptr);
  insight::Insight insight;
};

/// Follows a replay that is held, wherever it goes.
class Follower : public corvik::EventStream {
 public:
  explicit Follower(const std::string& recording)
      : service_(std::make_unique<RecordingReader>(fileWith(recording), "r"), clock_, {1.0, false}) {
    service_.setSeekHandlers(
        [this](bool isFromStart) {
          if (!isFromStart) return;
          followed_.intake->startAnew();
          followed_.insight.startAnew();
        },
        [this](double /*sinceLastEvent*/) { loop_.stop(); });
    service_.player().setHeld(true);
    service_.connect(*this);
  }
  ~Follower() {
    service_.shutDown();
    loop_.runDue();
  }

  corvik::Player& player() { return service_.player(); }
  const Followed& arrive() {
    loop_.run();
    return followed_;
  }

  void raise(const Text& event, InterProcessDictionary message) override { deliver(event, std::move(message)); }
  void deliver(const Text& /*event*/, InterProcessDictionary message) override {
    afterDelivery([this, metric = *message.ordinary()] { followed_.intake->validateMetric(metric); });
  }
  void afterDelivery(Task task) override { MainQueue::shared().post(std::move(task)); }
  bool waitUntilWanted(const std::stop_token& stop) override { return !stop.stop_requested(); }

 private:
  SteadyClock clock_;
  RunLoop loop_{clock_};
  Followed followed_;
  corvik::RecordedService service_;
};

TEST(LookBack, LeavesWhatPlayingUpToThereLeaves) {
  OutputLines::setSink(nullptr);
  const std::vector<handset::HandsetEvent> events = handset::drivenEvents(3, 120);
  std::string recording;
  Followed straight;
  constexpr int kSeconds = 70;
  std::size_t count = 0;
  for (const handset::HandsetEvent& each : events) {
    if (each.kind == handset::HandsetEvent::Kind::trigger) continue;
    appendRecordedEvent(recording, {static_cast<double>(each.atMs) / 1000, each.id, each.payload.bytes()});
    if (each.atMs > std::int64_t{kSeconds} * 1000) continue;
    ++count;
    straight.intake->validateMetric(*corvik::makeMetricEvent(each.id, each.payload.bytes()).ordinary());
  }
  Follower follower(recording);
  const auto expectTheSame = [&](const Followed& reached) {
    EXPECT_TRUE(reached.intake->stores == straight.intake->stores);
    EXPECT_EQ(reached.insight.counts().all, count);
    EXPECT_EQ(reached.insight.now(), straight.insight.now());
    EXPECT_EQ(reached.insight.happenings().size(), straight.insight.happenings().size());
  };
  follower.player().seek(kSeconds);
  expectTheSame(follower.arrive());
  follower.player().seek(110);
  EXPECT_FALSE(follower.arrive().intake->stores == straight.intake->stores);
  follower.player().seek(kSeconds);
  expectTheSame(follower.arrive());
  follower.player().seek(20);
  EXPECT_LT(follower.arrive().insight.counts().all, count);
  ReplayControl control([](const std::string& line) { FAIL() << line; });
  control.setPlayer(&follower.player());
  follower.player().setSpeed(std::nullopt);
  control.goTo({.event = count - 1});
  expectTheSame(follower.arrive());
  EXPECT_EQ(follower.player().state().speed, 1.0) << "it would not stay at that moment";
}

TEST(LookBack, IsRefusedInOneLineWhereThereIsNoWayBack) {
  std::vector<std::string> lines;
  ReplayControl control([&](const std::string& line) { lines.push_back(line); });
  control.jump(std::chrono::seconds(10));
  control.changeSpeed(1);
  const SteadyClock clock;
  Pipe pipe;
  corvik::Player player(std::make_unique<RecordingReader>(std::move(pipe.reading), "pipe"), clock, {1.0, false});
  control.setPlayer(&player);
  control.jump(std::chrono::seconds(-10));
  control.goTo({});
  control.setHeld(true);
  EXPECT_FALSE(player.state().isHeld);
  for (const int step : {1, 1, 1, -1})
    control.changeSpeed(step);
  EXPECT_EQ(player.state().speed, 5.0);
  const std::string pipeHasNone = "a pipe has no way back; replay a file to go back and forth";
  const std::string speed = "the replay's speed: ";
  EXPECT_EQ(lines, (std::vector<std::string>{"only a replay goes back and forth", "only a replay has another speed",
                                             pipeHasNone, pipeHasNone, speed + "×2", speed + "×5", speed + "×10",
                                             speed + "×5"}));
  EXPECT_EQ(nextSpeed(1000.0, 1), std::nullopt);
  EXPECT_EQ(nextSpeed(std::nullopt, -1), 1000.0);
  EXPECT_EQ(nextSpeed(0.05, -1), 0.05);
  EXPECT_EQ(nextSpeed(3.0, -1), 2.0);
}

}  // namespace
}  // namespace vesk
