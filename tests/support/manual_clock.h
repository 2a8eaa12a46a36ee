#pragma once

#include <condition_variable>
#include <mutex>
#include <optional>
#include <poll.h>

#include "system/clock.h"

namespace vesk {

/// A clock that stands still until it is advanced. A thread that sleeps by it wakes when its time has come.
class ManualClock : public Clock {
 public:
  [[nodiscard]] Instant now() const override {
    const std::lock_guard lock(mutex_);
    return now_;
  }

  void advance(Duration by) {
    const std::lock_guard lock(mutex_);
    now_ += by;
    if (sleepingUntil_ <= now_) sleepingUntil_.reset();
    advanced_.signal();
  }

  /// For one thread at a time.
  void sleepUntil(Instant instant, const WakeUp& interrupt) const override {
    while (goToSleep(instant)) {
      pollfd polled[] = {{interrupt.descriptor(), POLLIN, 0}, {advanced_.descriptor(), POLLIN, 0}};
      poll(polled, 2, -1);
      advanced_.clear();
      if (polled[0].revents != 0) return;
    }
  }

  /// Blocks until a thread sleeps by this clock: how long it will.
  [[nodiscard]] Duration waitForSleeper() const {
    std::unique_lock lock(mutex_);
    asleep_.wait(lock, [this] { return sleepingUntil_.has_value(); });
    return *sleepingUntil_ - now_;
  }

 private:
  [[nodiscard]] bool goToSleep(Instant instant) const {
    const std::lock_guard lock(mutex_);
    if (instant <= now_) return false;
    sleepingUntil_ = instant;
    asleep_.notify_all();
    return true;
  }

  mutable std::mutex mutex_;
  mutable std::condition_variable asleep_;
  mutable std::optional<Instant> sleepingUntil_;
  Instant now_;
  WakeUp advanced_;
};

}  // namespace vesk
