#pragma once

#include <algorithm>
#include <condition_variable>
#include <mutex>
#include <optional>
#include <poll.h>
#include <span>
#include <vector>

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
  void waitUntil(std::optional<Instant> instant, std::span<pollfd> descriptors) const override {
    std::vector<pollfd> polled(descriptors.begin(), descriptors.end());
    polled.push_back({advanced_.descriptor(), POLLIN, 0});
    while (goToSleep(instant)) {
      poll(polled.data(), polled.size(), -1);
      advanced_.clear();
      std::copy(polled.begin(), polled.end() - 1, descriptors.begin());
      if (std::any_of(descriptors.begin(), descriptors.end(), [](const pollfd& each) { return each.revents != 0; })) {
        const std::lock_guard lock(mutex_);
        sleepingUntil_.reset();
        return;
      }
    }
    poll(descriptors.data(), descriptors.size(), 0);
  }

  /// Blocks until a thread sleeps by this clock: how long it will.
  [[nodiscard]] Duration waitForSleeper() const {
    std::unique_lock lock(mutex_);
    asleep_.wait(lock, [this] { return sleepingUntil_.has_value(); });
    return *sleepingUntil_ - now_;
  }

 private:
  [[nodiscard]] bool goToSleep(std::optional<Instant> instant) const {
    const std::lock_guard lock(mutex_);
    if (instant && *instant <= now_) return false;
    sleepingUntil_ = instant.value_or(Instant::max());
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
