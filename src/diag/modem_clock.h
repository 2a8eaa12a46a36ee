#pragma once

#include <cstdint>

namespace vesk::diag {

/// Whether a modem's time, in milliseconds since 1970, is one of before a network has set its clock, which starts in
/// 1980.
[[nodiscard]] constexpr bool isBeforeClockIsSet(std::uint64_t milliseconds) {
  constexpr std::uint64_t kYear2000 = 946684800000;
  return milliseconds < kYear2000;
}

/// Turns the times of packets into the seconds of a recording. A clock that is set, or put back, takes no time.
class RecordingTime {
 public:
  /// Seconds since the first event, of the next one: its packet's time is `milliseconds`.
  [[nodiscard]] double at(std::uint64_t milliseconds) {
    const std::uint64_t last = last_;
    const bool isFirst = !hasBegun_;
    hasBegun_ = true;
    last_ = milliseconds;
    const bool wasSet = isBeforeClockIsSet(last) && !isBeforeClockIsSet(milliseconds);
    if (!isFirst && !wasSet && milliseconds > last) passed_ += milliseconds - last;
    return static_cast<double>(passed_) / 1000;
  }

 private:
  bool hasBegun_ = false;
  std::uint64_t last_ = 0;
  /// Milliseconds since the first event.
  std::uint64_t passed_ = 0;
};

}  // namespace vesk::diag
