#include "corvik/player.h"

#include <algorithm>
#include <cerrno>
#include <cmath>
#include <poll.h>
#include <utility>

namespace corvik {

namespace {

using vesk::Clock;
using vesk::TimedEvents;

/// Seconds. Longer waits are never meant; beyond this a time would not fit the clock.
constexpr double kLongestWait = 1e9;

/// Seconds of the recording: a pause beyond this is shortened to that.
constexpr double kLongPause = 60;
constexpr double kShortenedPause = 5;
Clock::Duration seconds(double count) {
  return std::chrono::duration_cast<Clock::Duration>(
      std::chrono::duration<double>(std::clamp(count, 0.0, kLongestWait)));
}

}  // namespace

Player::Player(std::unique_ptr<TimedEvents> recording, const Clock& clock, Playback playback)
    : recording_(std::move(recording)), clock_(clock), loops_(playback.loops), keepsPauses_(playback.keepsPauses) {
  state_.duration = recording_->duration();
  state_.speed = playback.speed;
  recording_->setBeforeRead([this](int descriptor) { return waitForInput(descriptor); });
}

PlaybackState Player::state() const {
  const std::lock_guard lock(stateLock_);
  PlaybackState shown = state_;
  shown.position = target_ && std::isfinite(target_->at) ? target_->at : position();
  return shown;
}

double Player::position() const {
  if (!next_) return state_.position;
  const std::chrono::duration<double> left = next_->due - clock_.now();
  const double passed = next_->at - left.count() * *state_.speed;
  return std::clamp(passed, state_.position, std::max(state_.position, next_->at));
}

void Player::setPhase(PlaybackState::Phase phase) {
  const std::lock_guard lock(stateLock_);
  state_.phase = phase;
}

void Player::start() {
  const std::lock_guard lock(stateLock_);
  if (!due_) due_ = clock_.now();
  if (state_.phase != PlaybackState::Phase::ended) state_.phase = PlaybackState::Phase::playing;
}

void Player::restartTime(double position) {
  state_.position = position;
  state_.shortenedPause.reset();
  next_.reset();
  at_ = position;
  if (due_) due_ = clock_.now();
}

void Player::setHeld(bool isHeld) {
  {
    const std::lock_guard lock(stateLock_);
    if (state_.isHeld == isHeld) return;
    state_.isHeld = isHeld;
    restartTime(position());
  }
  interrupt_.signal();
}

void Player::setSpeed(std::optional<double> speed) {
  {
    const std::lock_guard lock(stateLock_);
    restartTime(position());
    state_.speed = speed;
  }
  interrupt_.signal();
}

bool Player::seek(double position) {
  return seekTo({.at = std::max(position, 0.0)});
}

bool Player::seekToEvent(std::size_t count) {
  return seekTo({.events = count});
}

bool Player::seekTo(Target target) {
  {
    const std::lock_guard lock(stateLock_);
    if (!state_.duration) return false;
    if (std::isfinite(target.at)) target.at = std::min(target.at, *state_.duration);
    target_ = target;
    state_.isSeeking = false;
  }
  interrupt_.signal();
  return true;
}

Player::Step Player::next(const std::stop_token& stop) {
  stop_ = &stop;
  for (;;) {
    if (const std::optional<SeekBegun> begun = beginSeek()) return *begun;
    if (!pending_) {
      TimedEvents::Step step = recording_->next();
      if (stop.stop_requested()) return vesk::EndOfRecording{};
      if (const auto* event = std::get_if<vesk::RecordedEvent>(&step)) {
        pending_ = *event;
      } else if (auto* bad = std::get_if<vesk::BadLine>(&step)) {
        if (countBadLine()) return std::move(*bad);
        continue;
      } else {
        if (endsSeek()) return SeekEnded{sinceLastEvent_};
        auto* failure = std::get_if<vesk::ReadFailure>(&step);
        if (failure == nullptr && startAgain()) continue;
        setPhase(PlaybackState::Phase::ended);
        if (failure != nullptr) return std::move(*failure);
        return vesk::EndOfRecording{};
      }
    }
    switch (waitForTurn(pending_->at, stop)) {
      case Turn::event:
        return *std::exchange(pending_, std::nullopt);
      case Turn::arrival:
        return SeekEnded{sinceLastEvent_};
      case Turn::somethingElse:
        if (stop.stop_requested()) return vesk::EndOfRecording{};
        break;
    }
  }
}

bool Player::waitForSeek(const std::stop_token& stop) {
  std::unique_lock lock(stateLock_);
  if (!state_.duration) return false;
  while (!target_ && !stop.stop_requested())
    sleepUntil(clock_.now() + seconds(kLongestWait), lock);
  return !stop.stop_requested();
}

/// A stop is requested, and a wish noted, before the signal: who looks at them after the sleep misses neither.
void Player::sleepUntil(Clock::Instant instant, std::unique_lock<std::mutex>& lock) {
  lock.unlock();
  clock_.sleepUntil(instant, interrupt_);
  interrupt_.clear();
  lock.lock();
}

bool Player::waitForInput(int descriptor) {
  for (;;) {
    pollfd polled[] = {{descriptor, POLLIN, 0}, {interrupt_.descriptor(), POLLIN, 0}};
    if (poll(polled, std::size(polled), 0) == 0) {
      setPhase(PlaybackState::Phase::waitingForInput);
      // What poll fails for, the read that follows tells better.
      while (poll(polled, std::size(polled), -1) < 0 && errno == EINTR) {
      }
      setPhase(PlaybackState::Phase::playing);
    }
    if (polled[1].revents == 0) return true;
    interrupt_.clear();
    if (stop_->stop_requested()) return false;
  }
}

Player::Turn Player::waitForTurn(double at, const std::stop_token& stop) {
  std::unique_lock lock(stateLock_);
  while (!stop.stop_requested()) {
    if (target_) {
      if (!state_.isSeeking) break;
      if (at <= target_->at && state_.events < target_->events) {
        countEvent(at);
        return Turn::event;
      }
      arrive(std::isfinite(target_->at) ? target_->at : state_.position);
      return Turn::arrival;
    }
    if (state_.isHeld) {
      sleepUntil(clock_.now() + seconds(kLongestWait), lock);
      continue;
    }
    if (state_.speed) {
      const double pause = at - at_;
      const bool isShortened = pause > kLongPause && !keepsPauses_;
      const Clock::Instant due = *due_ + seconds((isShortened ? kShortenedPause : pause) / *state_.speed);
      if (clock_.now() < due) {
        next_ = NextEvent{at, due};
        if (isShortened) state_.shortenedPause = pause;
        sleepUntil(due, lock);
        continue;
      }
      due_ = due;
      at_ = at;
    }
    countEvent(at);
    return Turn::event;
  }
  return Turn::somethingElse;
}

std::optional<SeekBegun> Player::beginSeek() {
  const std::lock_guard lock(stateLock_);
  if (!target_ || state_.isSeeking) return std::nullopt;
  const bool isBack = target_->at < state_.position || target_->events < state_.events;
  if (isBack) {
    if (!recording_->rewind()) {
      target_.reset();
      return std::nullopt;
    }
    pending_.reset();
    eventsOfLap_ = 0;
    badLinesOfLap_ = 0;
    state_.events = 0;
    restartTime(0);
  }
  state_.isSeeking = true;
  state_.phase = PlaybackState::Phase::playing;
  return SeekBegun{isBack};
}

bool Player::endsSeek() {
  const std::lock_guard lock(stateLock_);
  if (!target_ || (loops_ && !std::isfinite(target_->at))) return false;
  arrive(state_.position);
  return true;
}

void Player::arrive(double position) {
  restartTime(position);
  target_.reset();
  state_.isSeeking = false;
  sinceLastEvent_ = std::max(position - lastEventAt_, 0.0);
}

void Player::countEvent(double at) {
  ++eventsOfLap_;
  next_.reset();
  state_.shortenedPause.reset();
  state_.position = at;
  lastEventAt_ = at;
  // A recording may have grown since its end was looked at.
  if (state_.duration) state_.duration = std::max(*state_.duration, at);
  ++state_.events;
}

bool Player::countBadLine() {
  ++badLinesOfLap_;
  const std::lock_guard lock(stateLock_);
  if (badLinesOfLap_ <= state_.badLines) return false;
  state_.badLines = badLinesOfLap_;
  return true;
}

bool Player::startAgain() {
  // Without a single event to play, going round would never wait.
  if (!loops_ || eventsOfLap_ == 0 || !recording_->rewind()) return false;
  eventsOfLap_ = 0;
  badLinesOfLap_ = 0;
  const std::lock_guard lock(stateLock_);
  at_ = 0;
  return true;
}

}  // namespace corvik
