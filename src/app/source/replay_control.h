#pragma once

#include <chrono>
#include <functional>
#include <optional>
#include <string>

#include "corvik/player.h"
#include "insight/moment.h"

namespace vesk {

/// What the user does with a replay, or is refused. Main queue only.
class ReplayControl {
 public:
  /// `tell` is told in one line why nothing is done, or what was done where nothing else shows it.
  explicit ReplayControl(std::function<void(const std::string& line)> tell) : tell_(std::move(tell)) {}

  /// Null for a source that is no replay. It must outlive this.
  void setPlayer(corvik::Player* player) { player_ = player; }

  /// Whether there is a way back.
  [[nodiscard]] bool isSeekable() const { return player_ != nullptr && player_->state().duration.has_value(); }
  /// A source that cannot wait, such as a pipe, goes on.
  void setHeld(bool isHeld);
  /// One step faster for +1, slower for -1.
  void changeSpeed(int step);
  /// Forward, or back. A replay that never waits goes on from there at the drive's own speed, and so it does from
  /// where goTo() leads.
  void jump(std::chrono::seconds distance);
  /// To the moment at which its metric event had just come.
  void goTo(const insight::Moment& moment);

 private:
  /// Null, and refused, where there is no way back.
  [[nodiscard]] corvik::Player* readyToSeek();

  std::function<void(const std::string&)> tell_;
  corvik::Player* player_ = nullptr;
};

/// "×1", "×0.5", "×max".
[[nodiscard]] std::string speedText(const std::optional<double>& speed);
/// The next of the usual speeds; absent for no waiting at all, which is the fastest.
[[nodiscard]] std::optional<double> nextSpeed(std::optional<double> speed, int step);

}  // namespace vesk
