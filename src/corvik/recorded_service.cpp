#include "corvik/recorded_service.h"

#include <utility>

#include "system/main_queue.h"

namespace corvik {

namespace {

/// How much the main thread plays in one batch, in steps and in bytes of payload.
constexpr int kStepsOfBatch = 64;
constexpr std::size_t kBytesOfBatch = std::size_t{64} << 10;

}  // namespace

RecordedService::RecordedService(std::unique_ptr<vesk::TimedEvents> recording, const vesk::Clock& clock,
                                 Playback playback, Runs runs)
    : player_(std::move(recording), clock, playback), runs_(runs) {}

void RecordedService::start(EventStream& events) {
  switch (runs_) {
    case Runs::onMainThread:
      turn_ = std::make_shared<std::monostate>();
      schedule(&RecordedService::begin, events);
      break;
    case Runs::onThreadOfItsOwn:
      thread_ = std::jthread([this, &events](const std::stop_token& stop) { playOn(stop, events); });
      break;
  }
}

void RecordedService::playOn(const std::stop_token& stop, EventStream& events) {
  bool hasMore = begin(stop, events);
  while ((hasMore || player_.waitForSeek(stop)) && events.waitUntilWanted(stop))
    hasMore = playNext(stop, events);
}

void RecordedService::stop() {
  turn_.reset();
  endThread();
}

void RecordedService::endThread() {
  if (!thread_.joinable()) return;
  thread_.request_stop();
  player_.interrupt();
  thread_.join();
}

Result RecordedService::answer(const MetricQuery&, EventStream&) {
  return {kStatusNotSupported, "a recording answers no query"};
}

void RecordedService::schedule(Step step, EventStream& events) {
  vesk::MainQueue::shared().post([this, step, turn = std::weak_ptr(turn_), &events] {
    if (!turn.expired() && (this->*step)({}, events)) schedule(&RecordedService::playBatch, events);
  });
}

bool RecordedService::playBatch(const std::stop_token& stop, EventStream& events) {
  batchBytes_ = 0;
  for (int steps = 0; steps < kStepsOfBatch && batchBytes_ < kBytesOfBatch; ++steps) {
    if (!playNext(stop, events)) return false;
  }
  return true;
}

bool RecordedService::begin(const std::stop_token& stop, EventStream& events) {
  if (state().phase == PlaybackState::Phase::ended || !events.waitUntilWanted(stop)) return false;
  player_.start();
  return true;
}

bool RecordedService::playNext(const std::stop_token& stop, EventStream& events) {
  Player::Step step = player_.next(stop);
  if (stop.stop_requested()) return false;
  if (const auto* event = std::get_if<vesk::RecordedEvent>(&step)) {
    batchBytes_ += event->payload.size();
    events.deliver(kEventMetric, makeMetricEvent(event->metricId, event->payload));
    return true;
  }
  if (auto* bad = std::get_if<vesk::BadLine>(&step)) {
    if (onBadLine_) events.afterDelivery([tell = onBadLine_, message = std::move(bad->message)] { tell(message); });
    return true;
  }
  if (const auto* begun = std::get_if<SeekBegun>(&step)) {
    if (onSeekBegun_)
      events.afterDelivery([tell = onSeekBegun_, isFromStart = begun->isFromStart] { tell(isFromStart); });
    return true;
  }
  if (const auto* ended = std::get_if<SeekEnded>(&step)) {
    if (onSeekEnded_) events.afterDelivery([tell = onSeekEnded_, since = ended->sinceLastEvent] { tell(since); });
    return true;
  }
  std::optional<std::string> failure;
  if (auto* failed = std::get_if<vesk::ReadFailure>(&step)) failure = std::move(failed->message);
  if (onEnd_) events.afterDelivery([tell = onEnd_, failure = std::move(failure)] { tell(failure); });
  return false;
}

}  // namespace corvik
