#pragma once

#include <chrono>
#include <optional>
#include <poll.h>
#include <span>

#include "system/wake_up.h"

namespace vesk {

/// Time that only goes forward, from an unspecified start. Handed to whatever measures or waits, so that
/// tests can drive it by hand. Usable from any thread.
class Clock {
 public:
  using Duration = std::chrono::nanoseconds;
  using Instant = std::chrono::time_point<std::chrono::steady_clock, Duration>;

  virtual ~Clock() = default;
  [[nodiscard]] virtual Instant now() const = 0;
  /// Blocks the calling thread until `instant`, for ever where it is absent, or until one of the descriptors is ready:
  /// their revents tell, as poll(2) leaves them.
  virtual void waitUntil(std::optional<Instant> instant, std::span<pollfd> descriptors) const = 0;
  /// Blocks the calling thread until `instant`, or until `interrupt` is signalled.
  void sleepUntil(Instant instant, const WakeUp& interrupt) const;
};

/// How long poll(2) has to wait for what lies `left` ahead: in milliseconds, rounded up, for waking before the time
/// would mean a round for nothing; 0 for what has come.
[[nodiscard]] int pollTimeout(Clock::Duration left);

/// The system's monotonic clock.
class SteadyClock : public Clock {
 public:
  [[nodiscard]] Instant now() const override { return std::chrono::steady_clock::now(); }
  void waitUntil(std::optional<Instant> instant, std::span<pollfd> descriptors) const override;
};

}  // namespace vesk
