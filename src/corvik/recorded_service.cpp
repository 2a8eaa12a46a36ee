#include "corvik/recorded_service.h"

#include <algorithm>
#include <cerrno>
#include <poll.h>
#include <utility>

#include "system/main_queue.h"

namespace corvik {

namespace {

using vesk::Clock;

/// Longer waits are never meant; beyond this a time would not fit the clock.
constexpr double kLongestWait = 1e9;

/// How much the main thread plays at a time, in lines and in bytes of payload.
constexpr int kLinesAtATime = 64;
constexpr std::size_t kBytesAtATime = std::size_t{64} << 10;

}  // namespace

RecordedService::RecordedService(vesk::RecordingReader recording, const vesk::Clock& clock, Playback playback)
    : recording_(std::move(recording)), clock_(clock), playback_(playback) {
  state_.duration = recording_.duration();
  state_.speed = playback.speed;
  recording_.setBeforeRead([this](int descriptor) { return waitForInput(descriptor); });
}

PlaybackState RecordedService::state() const {
  const std::lock_guard lock(mutex_);
  PlaybackState shown = state_;
  if (next_) {
    const std::chrono::duration<double> left = next_->due - clock_.now();
    const double position = next_->at - left.count() * *playback_.speed;
    shown.position = std::clamp(position, shown.position, std::max(shown.position, next_->at));
  }
  return shown;
}

void RecordedService::setPhase(PlaybackState::Phase phase) {
  const std::lock_guard lock(mutex_);
  state_.phase = phase;
}

void RecordedService::start(EventStream& events) {
  if (playback_.isOnMainThread) {
    turn_ = std::make_shared<std::monostate>();
    schedule(&RecordedService::begin, events);
    return;
  }
  thread_ = std::jthread([this, &events](const std::stop_token& stop) { play(stop, events); });
}

void RecordedService::stop() {
  turn_.reset();
  endThread();
}

void RecordedService::endThread() {
  if (!thread_.joinable()) return;
  thread_.request_stop();
  interrupt_.signal();
  thread_.join();
  interrupt_.clear();
}

Result RecordedService::answer(const MetricQuery&, EventStream&) {
  return {};
}

void RecordedService::play(const std::stop_token& stop, EventStream& events) {
  if (!begin(stop, events)) return;
  while (playNext(stop, events) && events.waitUntilWanted(stop)) {
  }
}

void RecordedService::schedule(Step step, EventStream& events) {
  vesk::MainQueue::shared().async([this, step, turn = std::weak_ptr(turn_), &events] {
    if (!turn.expired() && (this->*step)({}, events)) schedule(&RecordedService::playSome, events);
  });
}

bool RecordedService::playSome(const std::stop_token& stop, EventStream& events) {
  bytesPlayed_ = 0;
  for (int lines = 0; lines < kLinesAtATime && bytesPlayed_ < kBytesAtATime; ++lines) {
    if (!playNext(stop, events)) return false;
  }
  return true;
}

bool RecordedService::begin(const std::stop_token& stop, EventStream& events) {
  if (state().phase == PlaybackState::Phase::ended || !events.waitUntilWanted(stop)) return false;
  if (!due_) due_ = clock_.now();
  setPhase(PlaybackState::Phase::playing);
  return true;
}

bool RecordedService::playNext(const std::stop_token& stop, EventStream& events) {
  vesk::RecordingReader::Step step = recording_.next();
  if (stop.stop_requested()) return false;
  if (const auto* event = std::get_if<vesk::RecordedEvent>(&step)) {
    if (!waitUntil(event->at, stop)) return false;
    playEvent(*event, events);
  } else if (auto* bad = std::get_if<vesk::BadLine>(&step)) {
    tellBadLine(std::move(bad->message), events);
  } else if (!startAgain()) {
    end(events);
    return false;
  }
  return true;
}

bool RecordedService::waitForInput(int descriptor) {
  pollfd polled[] = {{descriptor, POLLIN, 0}, {interrupt_.descriptor(), POLLIN, 0}};
  if (poll(polled, std::size(polled), 0) == 0) {
    setPhase(PlaybackState::Phase::waitingForInput);
    // What poll fails for, the read that follows tells better.
    while (poll(polled, std::size(polled), -1) < 0 && errno == EINTR) {
    }
    setPhase(PlaybackState::Phase::playing);
  }
  return polled[1].revents == 0;
}

bool RecordedService::waitUntil(double at, const std::stop_token& stop) {
  if (!playback_.speed) return true;
  const double wait = std::clamp((at - at_) / *playback_.speed, 0.0, kLongestWait);
  *due_ += std::chrono::duration_cast<Clock::Duration>(std::chrono::duration<double>(wait));
  at_ = at;
  {
    const std::lock_guard lock(mutex_);
    next_ = NextEvent{at, *due_};
  }
  clock_.sleepUntil(*due_, interrupt_);
  return !stop.stop_requested();
}

void RecordedService::playEvent(const vesk::RecordedEvent& event, EventStream& events) {
  ++eventsOfLap_;
  bytesPlayed_ += event.payload.size();
  {
    const std::lock_guard lock(mutex_);
    next_.reset();
    state_.position = event.at;
    // A recording may have grown since its end was looked at.
    if (state_.duration) state_.duration = std::max(*state_.duration, event.at);
    ++state_.events;
  }
  events.deliver(kEventMetric, makeMetricEvent(event.metricId, event.payload));
}

void RecordedService::tellBadLine(std::string message, EventStream& events) {
  if (lap_ > 0) return;
  {
    const std::lock_guard lock(mutex_);
    ++state_.badLines;
  }
  if (onBadLine_) {
    events.afterDelivery([tell = onBadLine_, message = std::move(message)] { tell(message); });
  }
}

bool RecordedService::startAgain() {
  // Without a single event to play, going round would never wait.
  const bool canGoOn = playback_.loops && eventsOfLap_ > 0 && !recording_.failure();
  if (!canGoOn || !recording_.rewind()) return false;
  ++lap_;
  eventsOfLap_ = 0;
  at_ = 0;
  return true;
}

void RecordedService::end(EventStream& events) {
  setPhase(PlaybackState::Phase::ended);
  if (onEnd_) {
    events.afterDelivery([tell = onEnd_, failure = recording_.failure()] { tell(failure); });
  }
}

}  // namespace corvik
