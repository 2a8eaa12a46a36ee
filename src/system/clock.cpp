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

void SteadyClock::sleepUntil(Instant instant, const WakeUp& interrupt) const {
  for (;;) {
    const Duration left = instant - now();
    if (left <= Duration::zero()) return;
    const auto seconds = std::chrono::duration_cast<std::chrono::seconds>(left);
    const timespec timeout{seconds.count(), static_cast<long>((left - seconds).count())};
    pollfd waited{interrupt.descriptor(), POLLIN, 0};
    const int ready = ppoll(&waited, 1, &timeout, nullptr);
    if (ready > 0 || (ready < 0 && errno != EINTR)) return;
  }
}

}  // namespace vesk
