#pragma once

#include <cstdint>
#include <optional>

namespace vesk::handset {

/// When a condition has held for long enough without a break (time to trigger).
class TimeToTrigger {
 public:
  explicit TimeToTrigger(std::int64_t neededMs) : neededMs_(neededMs) {}

  [[nodiscard]] bool hasHeld(bool condition, std::int64_t nowMs) {
    if (!condition) {
      sinceMs_.reset();
      return false;
    }
    if (!sinceMs_) sinceMs_ = nowMs;
    return nowMs - *sinceMs_ >= neededMs_;
  }
  void reset() { sinceMs_.reset(); }

 private:
  std::int64_t neededMs_;
  std::optional<std::int64_t> sinceMs_;
};

/// Something that comes back after a fixed time.
class Periodic {
 public:
  explicit Periodic(std::int64_t periodMs) : periodMs_(periodMs) {}

  /// True at the first call, then once for each period.
  [[nodiscard]] bool isDue(std::int64_t nowMs) {
    if (nowMs < dueMs_) return false;
    dueMs_ = nowMs + periodMs_;
    return true;
  }
  /// Due at once.
  void reset() { dueMs_ = 0; }

 private:
  std::int64_t periodMs_;
  std::int64_t dueMs_ = 0;
};

}  // namespace vesk::handset
