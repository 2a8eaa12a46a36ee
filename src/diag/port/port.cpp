#include "diag/port/port.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <poll.h>
#include <sys/file.h>
#include <sys/ioctl.h>
#include <sys/stat.h>
#include <termios.h>
#include <unistd.h>
#include <utility>

namespace vesk::diag {

namespace {

/// How long a port that takes no more is waited for, in milliseconds: a command is a few dozen bytes.
constexpr int kWriteTime = 1000;
/// Reads at most, where logs keep coming.
constexpr int kMostDrained = 256;

struct Fault {
  int error;
  const char* words;
};

constexpr Fault kFaults[] = {
    {ENOENT, "there is no such port: is the modem plugged in? ls /dev/ttyUSB* /dev/wwan* shows the ports there are"},
    {ENODEV, "there is no modem behind this port any more: plug it in again"},
    {ENXIO, "there is no modem behind this port: plug it in again"},
    {EIO, "there is no modem behind this port any more: plug it in again"},
    {EACCES,
     "you may not open this port: join its group (sudo usermod -aG dialout $USER, then log in again); a /dev/wwan… "
     "port "
     "is for root alone"},
    {EPERM, "you may not open this port: run as root"},
    {EBUSY,
     "another program holds this port, often ModemManager: mmcli --inhibit-device=UID keeps it away from the modem, "
     "sudo systemctl stop ModemManager from all"},
    {EISDIR, "this is a directory, and no port"},
};

/// A terminal that hands on every byte as it is, and neither echoes nor heeds any.
bool setRaw(int descriptor) {
  termios modes{};
  if (tcgetattr(descriptor, &modes) != 0) return false;
  cfmakeraw(&modes);
  modes.c_cflag |= CLOCAL | CREAD;
  modes.c_cflag &= ~static_cast<tcflag_t>(CRTSCTS | CSTOPB);
  modes.c_iflag &= ~static_cast<tcflag_t>(IXOFF | IXANY);
  modes.c_cc[VMIN] = 1;
  modes.c_cc[VTIME] = 0;
  cfsetispeed(&modes, B115200);
  cfsetospeed(&modes, B115200);
  return tcsetattr(descriptor, TCSANOW, &modes) == 0;
}

}  // namespace

Port::Port(std::string path) : path_(std::move(path)) {
  if (!open() || !setUp()) {
    fail(errno);
    descriptor_ = FileDescriptor();
  }
}

bool Port::open() {
  descriptor_ = FileDescriptor(::open(path_.c_str(), O_RDWR | O_NONBLOCK | O_NOCTTY | O_CLOEXEC));
  return descriptor_.isOpen();
}

bool Port::setUp() {
  struct stat status {};
  if (fstat(descriptor_.get(), &status) != 0) return false;
  if (S_ISREG(status.st_mode)) {
    failure_ = path_ + ": this is a file, and no port; --replay reads captures";
    return false;
  }
  // The lock keeps programs of this kind away, also where root may open what is held.
  if (flock(descriptor_.get(), LOCK_EX | LOCK_NB) != 0 && errno == EWOULDBLOCK) {
    errno = EBUSY;
    return false;
  }
  isTerminal_ = isatty(descriptor_.get()) != 0;
  return !isTerminal_ || (ioctl(descriptor_.get(), TIOCEXCL) == 0 && setRaw(descriptor_.get()));
}

void Port::fail(int error) {
  if (!failure_.empty()) return;
  const char* words = std::strerror(error);
  for (const Fault& fault : kFaults) {
    if (fault.error == error) words = fault.words;
  }
  failure_ = path_ + ": " + words;
}

void Port::drain() {
  std::uint8_t thrownAway[4096];
  for (int count = 0; count<kMostDrained&& ::read(descriptor_.get(), thrownAway, sizeof thrownAway)> 0; ++count) {
  }
}

std::optional<std::span<const std::uint8_t>> Port::read(std::span<std::uint8_t> place) {
  const ssize_t count = ::read(descriptor_.get(), place.data(), place.size());
  if (count > 0) return place.first(static_cast<std::size_t>(count));
  if (count < 0 && (errno == EAGAIN || errno == EINTR)) return place.first(0);
  return std::nullopt;
}

bool Port::send(const Command& command) {
  std::span<const std::uint8_t> left = command.frame();
  while (!left.empty()) {
    const ssize_t count = write(descriptor_.get(), left.data(), left.size());
    if (count >= 0) {
      left = left.subspan(static_cast<std::size_t>(count));
    } else if (errno == EAGAIN) {
      pollfd waited{descriptor_.get(), POLLOUT, 0};
      if (poll(&waited, 1, kWriteTime) == 0) return false;
    } else if (errno != EINTR) {
      return false;
    }
  }
  return true;
}

}  // namespace vesk::diag
