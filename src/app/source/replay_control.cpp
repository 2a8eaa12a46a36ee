#include "app/source/replay_control.h"

#include <algorithm>
#include <array>
#include <cstdio>

namespace vesk {

namespace {

constexpr std::array kSpeeds{0.1, 0.2, 0.5, 1.0, 2.0, 5.0, 10.0, 20.0, 50.0, 100.0, 200.0, 500.0, 1000.0};

}  // namespace

std::string speedText(const std::optional<double>& speed) {
  if (!speed) return "×max";
  char text[32];
  std::snprintf(text, sizeof text, "×%g", *speed);
  return text;
}

std::optional<double> nextSpeed(std::optional<double> speed, int step) {
  if (step > 0) {
    const auto* faster = speed ? std::upper_bound(kSpeeds.begin(), kSpeeds.end(), *speed) : kSpeeds.end();
    return faster == kSpeeds.end() ? std::nullopt : std::optional(*faster);
  }
  const auto* notSlower = speed ? std::lower_bound(kSpeeds.begin(), kSpeeds.end(), *speed) : kSpeeds.end();
  return notSlower == kSpeeds.begin() ? std::min(*speed, kSpeeds.front()) : *(notSlower - 1);
}

corvik::Player* ReplayControl::readyToSeek() {
  if (player_ == nullptr) {
    tell_("only a replay goes back and forth");
  } else if (!isSeekable()) {
    tell_("a pipe has no way back; replay a file to go back and forth");
  } else {
    // One that never waits would leave the moment at once.
    if (!player_->state().speed) player_->setSpeed(1.0);
    return player_;
  }
  return nullptr;
}

void ReplayControl::setHeld(bool isHeld) {
  if (isSeekable()) player_->setHeld(isHeld);
}

void ReplayControl::changeSpeed(int step) {
  if (player_ == nullptr) return tell_("only a replay has another speed");
  const corvik::PlaybackState before = player_->state();
  const std::optional<double> speed = nextSpeed(before.speed, step);
  player_->setSpeed(speed);
  const bool isShown = before.phase == corvik::PlaybackState::Phase::playing && before.duration;
  if (!isShown) tell_("the replay's speed: " + speedText(speed));
}

void ReplayControl::jump(std::chrono::seconds distance) {
  corvik::Player* player = readyToSeek();
  if (player != nullptr) player->seek(player->state().position + static_cast<double>(distance.count()));
}

void ReplayControl::goTo(const insight::Moment& moment) {
  corvik::Player* player = readyToSeek();
  if (player != nullptr) player->seekToEvent(moment.event + 1);
}

}  // namespace vesk
