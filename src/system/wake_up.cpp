#include "system/wake_up.h"

#include <cerrno>
#include <cstdint>
#include <sys/eventfd.h>
#include <system_error>

namespace vesk {

WakeUp::WakeUp() : descriptor_(eventfd(0, EFD_NONBLOCK | EFD_CLOEXEC)) {
  if (!descriptor_.isOpen()) throw std::system_error(errno, std::generic_category(), "eventfd");
}

void WakeUp::signal() const noexcept {
  const int savedError = errno;
  const std::uint64_t one = 1;
  // It fails only when it has been signalled 2^64 - 2 times already: then it is readable as it is.
  [[maybe_unused]] const ssize_t written = write(descriptor_.get(), &one, sizeof one);
  errno = savedError;
}

void WakeUp::clear() const noexcept {
  std::uint64_t count = 0;
  [[maybe_unused]] const ssize_t taken = read(descriptor_.get(), &count, sizeof count);
}

}  // namespace vesk
