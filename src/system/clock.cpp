#include "system/clock.h"

#include <algorithm>
#include <cerrno>
#include <limits>
#include <poll.h>

namespace vesk {

int pollTimeout(Clock::Duration left) {
  using std::chrono::milliseconds;
  const milliseconds::rep wait = std::chrono::ceil<milliseconds>(left).count();
  return static_cast<int>(std::clamp<milliseconds::rep>(wait, 0, std::numeric_limits<int>::max()));
}

void Clock::sleepUntil(Instant instant, const WakeUp& interrupt) const {
  if (instant <= now()) return;
  pollfd waited{interrupt.descriptor(), POLLIN, 0};
  waitUntil(instant, {&waited, 1});
}

void SteadyClock::waitUntil(std::optional<Instant> instant, std::span<pollfd> descriptors) const {
  for (;;) {
    const Duration left = instant ? std::max(*instant - now(), Duration::zero()) : Duration::zero();
    const auto seconds = std::chrono::duration_cast<std::chrono::seconds>(left);
    const timespec timeout{seconds.count(), static_cast<long>((left - seconds).count())};
    const int ready = ppoll(descriptors.data(), descriptors.size(), instant ? &timeout : nullptr, nullptr);
    if (ready >= 0 || errno != EINTR) return;
  }
}

}  // namespace vesk
