#pragma once

#include <algorithm>
#include <chrono>
#include <cstdint>
#include <optional>

#include "system/clock.h"
#include "terminal/view/surroundings.h"

namespace vesk {

/// What time it is in the drive: that of its last event, and what has passed since at the pace of the source.
class DriveTime {
 public:
  /// An event has come. `time` is the drive's, in milliseconds since 1970-01-01 00:00:00 UTC; absent while no event had
  /// one: then the time is counted from the first event.
  void take(std::optional<std::int64_t> time, Clock::Instant now) {
    if (time) {
      last_ = std::chrono::milliseconds(*time);
      at_ = now;
    } else if (!at_) {
      at_ = now;
    }
  }

  /// From here on the time passes at another pace than `pace`.
  void keep(Clock::Instant now, double pace) {
    last_ = at(now, pace).time;
    if (at_) at_ = now;
  }

  /// `pace` is how many seconds of the drive pass in one; 0 where it stands still.
  [[nodiscard]] DriveMoment at(Clock::Instant now, double pace) const {
    if (!at_) return {};
    const std::chrono::duration<double, std::milli> passed = (now - *at_) * pace;
    return {last_ + std::chrono::duration_cast<std::chrono::milliseconds>(passed), pace};
  }

  /// What has passed since `time`, the drive's own: milliseconds.
  [[nodiscard]] std::int64_t passedSince(std::optional<std::int64_t> time, Clock::Instant now, double pace) const {
    return time ? std::max<std::int64_t>(at(now, pace).time.count() - *time, 0) : 0;
  }

 private:
  std::chrono::milliseconds last_{0};
  std::optional<Clock::Instant> at_;
};

}  // namespace vesk
