#include "platform/clock.h"

#include <cerrno>
#include <poll.h>

namespace vesk {

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
