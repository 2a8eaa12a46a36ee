#include "corvik/player.h"

#include <algorithm>
#include <cerrno>
#include <poll.h>
#include <utility>
#include <variant>

namespace corvik {

namespace {

using vesk::Clock;
using vesk::TimedEvents;

/// Longer waits are never meant; beyond this a time would not fit the clock.
constexpr double kLongestWait = 1e9;

}  // namespace

Player::Player(std::unique_ptr<TimedEvents> recording, const Clock& clock, Playback playback)
    : recording_(std::move(recording)), clock_(clock), playback_(playback) {
  state_.duration = recording_->duration();
  state_.speed = playback.speed;
  recording_->setBeforeRead([this](int descriptor) { return waitForInput(descriptor); });
}

PlaybackState Player::state() const {
  const std::lock_guard lock(stateLock_);
  PlaybackState shown = state_;
  if (next_) {
    const std::chrono::duration<double> left = next_->due - clock_.now();
    const double position = next_->at - left.count() * *playback_.speed;
    shown.position = std::clamp(position, shown.position, std::max(shown.position, next_->at));
  }
  return shown;
}

void Player::setPhase(PlaybackState::Phase phase) {
  const std::lock_guard lock(stateLock_);
  state_.phase = phase;
}

void Player::start() {
  if (!due_) due_ = clock_.now();
  setPhase(PlaybackState::Phase::playing);
}

TimedEvents::Step Player::next(const std::stop_token& stop) {
  for (;;) {
    TimedEvents::Step step = recording_->next();
    if (stop.stop_requested()) return step;
    if (const auto* event = std::get_if<vesk::RecordedEvent>(&step)) {
      if (playback_.speed) waitUntil(event->at);
      if (!stop.stop_requested()) countEvent(event->at);
      return step;
    }
    if (std::holds_alternative<vesk::BadLine>(step)) {
      if (countBadLine()) return step;
    } else if (std::holds_alternative<vesk::ReadFailure>(step) || !startAgain()) {
      setPhase(PlaybackState::Phase::ended);
      return step;
    }
  }
}

bool Player::waitForInput(int descriptor) {
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

void Player::waitUntil(double at) {
  const double wait = std::clamp((at - at_) / *playback_.speed, 0.0, kLongestWait);
  *due_ += std::chrono::duration_cast<Clock::Duration>(std::chrono::duration<double>(wait));
  at_ = at;
  {
    const std::lock_guard lock(stateLock_);
    next_ = NextEvent{at, *due_};
  }
  clock_.sleepUntil(*due_, interrupt_);
}

void Player::countEvent(double at) {
  ++eventsOfLap_;
  const std::lock_guard lock(stateLock_);
  next_.reset();
  state_.position = at;
  // A recording may have grown since its end was looked at.
  if (state_.duration) state_.duration = std::max(*state_.duration, at);
  ++state_.events;
}

bool Player::countBadLine() {
  if (lap_ > 0) return false;
  const std::lock_guard lock(stateLock_);
  ++state_.badLines;
  return true;
}

bool Player::startAgain() {
  // Without a single event to play, going round would never wait.
  if (!playback_.loops || eventsOfLap_ == 0 || !recording_->rewind()) return false;
  ++lap_;
  eventsOfLap_ = 0;
  at_ = 0;
  return true;
}

}  // namespace corvik
