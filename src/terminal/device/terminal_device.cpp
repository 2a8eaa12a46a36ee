#include "terminal/device/terminal_device.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <chrono>
#include <fcntl.h>
#include <sys/epoll.h>
#include <sys/ioctl.h>
#include <sys/timerfd.h>
#include <unistd.h>
#include <utility>

#include "terminal/device/terminal_signals.h"

namespace vesk {

namespace {

/// How long the program waits for a terminal that takes nothing before it leaves it as it is.
constexpr std::chrono::milliseconds kPatience{1000};

/// Keys come one by one and unseen; the keys for interrupting and stopping go on working, but cut off nothing that
/// was written before; those for holding the output do not.
termios screenModes(termios modes) {
  modes.c_iflag &= ~static_cast<tcflag_t>(ICRNL | INLCR | IXON);
  modes.c_lflag &= ~static_cast<tcflag_t>(ICANON | ECHO | ECHONL | IEXTEN);
  modes.c_lflag |= NOFLSH;
  modes.c_cc[VMIN] = 1;
  modes.c_cc[VTIME] = 0;
  return modes;
}

void setModes(int terminal, const termios& modes) {
  while (tcsetattr(terminal, TCSANOW, &modes) != 0 && errno == EINTR) {
  }
}

}  // namespace

std::optional<FileDescriptor> TerminalDevice::openControllingTerminal() {
  FileDescriptor terminal(open("/dev/tty", O_RDWR | O_NONBLOCK | O_NOCTTY | O_CLOEXEC));
  if (!terminal.isOpen()) return std::nullopt;
  return terminal;
}

TerminalDevice::TerminalDevice(FileDescriptor terminal, Switches switches)
    : terminal_(std::move(terminal)),
      writer_(FileDescriptor::borrowed(terminal_.get())),
      events_(epoll_create1(EPOLL_CLOEXEC)),
      timer_(timerfd_create(CLOCK_MONOTONIC, TFD_NONBLOCK | TFD_CLOEXEC)),
      switches_(std::move(switches)) {
  watch(terminal_.get());
  watch(timer_.get());
  watch(signalled_.descriptor());
  tcgetattr(terminal_.get(), &original_);
  terminal_signals::install(signalled_);
  enter();
}

TerminalDevice::~TerminalDevice() {
  leave();
  terminal_signals::uninstall();
}

void TerminalDevice::watch(int descriptor) {
  epoll_event event{};
  event.events = EPOLLIN;
  event.data.fd = descriptor;
  epoll_ctl(events_.get(), EPOLL_CTL_ADD, descriptor, &event);
}

void TerminalDevice::enter() {
  terminal_signals::arm(terminal_.get(), switches_.leave, original_);
  setModes(terminal_.get(), screenModes(original_));
  write(switches_.enter);
}

void TerminalDevice::leave() {
  terminal_signals::disarm();
  write(switches_.leave);
  writeOn(kPatience);
  unwritten_.clear();
  setModes(terminal_.get(), original_);
}

void TerminalDevice::suspend() {
  leave();
  terminal_signals::stopProgram();
  enter();
}

TerminalDevice::Arrived TerminalDevice::receive() {
  std::uint64_t expirations = 0;
  [[maybe_unused]] const ssize_t ticks = read(timer_.get(), &expirations, sizeof expirations);
  signalled_.clear();
  writeOn(Clock::Duration::zero());
  const auto [isResized, isStopWanted, isContinued] = terminal_signals::take();
  Arrived arrived{.bytes = {}, .isResized = isResized, .isStopWanted = isStopWanted, .isContinued = isContinued};

  // One read a call: a flood of input leaves time for everything else.
  std::array<char, 4096> buffer;
  const ssize_t count = isGone_ ? 0 : read(terminal_.get(), buffer.data(), buffer.size());
  if (count > 0) {
    arrived.bytes.assign(buffer.data(), static_cast<std::size_t>(count));
  } else if (count == 0 || (errno != EAGAIN && errno != EINTR)) {
    isGone_ = true;
    epoll_ctl(events_.get(), EPOLL_CTL_DEL, terminal_.get(), nullptr);
  }
  arrived.isHungUp = isGone_;
  return arrived;
}

void TerminalDevice::wakeAfter(std::optional<Clock::Duration> delay) {
  itimerspec when{};
  if (delay) {
    // A time of zero would switch the timer off.
    const Clock::Duration ahead = std::max(*delay, Clock::Duration(1));
    const auto seconds = std::chrono::duration_cast<std::chrono::seconds>(ahead);
    when.it_value.tv_sec = seconds.count();
    when.it_value.tv_nsec = (ahead - seconds).count();
  }
  timerfd_settime(timer_.get(), 0, &when, nullptr);
}

Size TerminalDevice::size() const {
  winsize window{};
  const bool isKnown = ioctl(terminal_.get(), TIOCGWINSZ, &window) == 0 && window.ws_col > 0 && window.ws_row > 0;
  if (!isKnown) return {80, 24};
  return {window.ws_col, window.ws_row};
}

void TerminalDevice::write(std::string_view bytes) {
  unwritten_ += bytes;
  writeOn(Clock::Duration::zero());
}

void TerminalDevice::writeOn(Clock::Duration patience) {
  if (unwritten_.empty()) return;
  std::size_t taken = unwritten_.size();
  if (!isGone_) {
    const auto written = writer_.write(unwritten_, {.end = std::chrono::steady_clock::now() + patience});
    isGone_ = written.outcome == DescriptorWriter::Outcome::failed;
    if (!isGone_) taken = written.count;
  }
  unwritten_.erase(0, taken);
  epoll_event event{};
  event.events = unwritten_.empty() ? EPOLLIN : EPOLLIN | EPOLLOUT;
  event.data.fd = terminal_.get();
  epoll_ctl(events_.get(), EPOLL_CTL_MOD, terminal_.get(), &event);
}

}  // namespace vesk
