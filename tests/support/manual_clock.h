#pragma once

#include <condition_variable>
#include <mutex>
#include <poll.h>

#include "platform/clock.h"

namespace vesk {

/// A clock that stands still until it is advanced. Threads that sleep by it wake when their time has come.
class ManualClock : public Clock {
 public:
  [[nodiscard]] Instant now() const override {
    const std::lock_guard lock(mutex_);
    return now_;
  }

  void advance(Duration by) {
    {
      const std::lock_guard lock(mutex_);
      now_ += by;
    }
    advanced_.signal();
  }

  /// For one thread at a time.
  void sleepUntil(Instant instant, const WakeUp& interrupt) const override {
    while (now() < instant) {
      setSleeping(true);
      pollfd polled[] = {{interrupt.descriptor(), POLLIN, 0}, {advanced_.descriptor(), POLLIN, 0}};
      poll(polled, 2, -1);
      setSleeping(false);
      advanced_.clear();
      if (polled[0].revents != 0) return;
    }
  }

  /// Blocks until a thread sleeps by this clock.
  void waitForSleeper() const {
    std::unique_lock lock(mutex_);
    changed_.wait(lock, [this] { return isSleeping_; });
  }

 private:
  void setSleeping(bool isSleeping) const {
    const std::lock_guard lock(mutex_);
    isSleeping_ = isSleeping;
    changed_.notify_all();
  }

  mutable std::mutex mutex_;
  mutable std::condition_variable changed_;
  mutable bool isSleeping_ = false;
  Instant now_;
  WakeUp advanced_;
};

}  // namespace vesk
