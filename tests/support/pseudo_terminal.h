#pragma once

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdlib>
#include <fcntl.h>
#include <poll.h>
#include <string>
#include <sys/ioctl.h>
#include <termios.h>
#include <unistd.h>

#include "system/file_descriptor.h"
#include "terminal/device/grid.h"

namespace vesk {

/// Waits until there is something to read; false after that time, by default ten seconds, which is never.
inline bool waitUntilReadable(int descriptor, int milliseconds = 10000) {
  pollfd polled{descriptor, POLLIN, 0};
  int count = 0;
  do
    count = poll(&polled, 1, milliseconds);
  while (count < 0 && errno == EINTR);
  return count == 1;
}

/// A terminal whose user is the test.
class PseudoTerminal {
 public:
  explicit PseudoTerminal(Size size) : user_(posix_openpt(O_RDWR | O_NOCTTY | O_NONBLOCK | O_CLOEXEC)) {
    grantpt(user_.get());
    unlockpt(user_.get());
    program_ = openForProgram();
    resize(size);
  }

  /// Another descriptor of the program's side.
  [[nodiscard]] FileDescriptor openForProgram() const {
    return FileDescriptor(open(ptsname(user_.get()), O_RDWR | O_NOCTTY | O_NONBLOCK | O_CLOEXEC));
  }
  void resize(Size size) const {
    const winsize window{static_cast<unsigned short>(size.lines), static_cast<unsigned short>(size.columns), 0, 0};
    ioctl(user_.get(), TIOCSWINSZ, &window);
  }
  [[nodiscard]] termios modes() const {
    termios modes{};
    tcgetattr(program_.get(), &modes);
    return modes;
  }
  [[nodiscard]] bool isLineByLine() const { return (modes().c_lflag & (ICANON | ECHO)) == (ICANON | ECHO); }

  void type(std::string_view bytes) const {
    [[maybe_unused]] auto count = write(user_.get(), bytes.data(), bytes.size());
  }
  /// Everything that was written to the terminal up to and including `end`; what there was, if that never
  /// came.
  std::string readUpTo(std::string_view end) {
    while (true) {
      if (const std::size_t place = unread_.find(end); place != std::string::npos) {
        std::string taken = unread_.substr(0, place + end.size());
        unread_.erase(0, taken.size());
        return taken;
      }
      const std::string some = readSome();
      if (some.empty()) return unread_;
      unread_ += some;
    }
  }
  /// Blocks until something was written to the terminal; empty when nothing ever is, or never more.
  [[nodiscard]] std::string readSome() const { return readWithin(10000); }
  /// The same, for no longer than that.
  [[nodiscard]] std::string readWithin(int milliseconds) const {
    std::array<char, 4096> buffer;
    if (!waitUntilReadable(user_.get(), milliseconds)) return {};
    const ssize_t count = read(user_.get(), buffer.data(), buffer.size());
    return {buffer.data(), static_cast<std::size_t>(std::max<ssize_t>(count, 0))};
  }

 private:
  FileDescriptor user_;
  FileDescriptor program_;
  std::string unread_;
};

}  // namespace vesk
