#include "terminal/device/terminal_signals.h"

#include <algorithm>
#include <array>
#include <atomic>
#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <unistd.h>

namespace vesk::terminal_signals {

namespace {

using Handler = void (*)(int, siginfo_t*, void*);

/// Everything that a signal handler touches: of a fixed size, and written before `isArmed` is set.
struct Restoration {
  std::atomic<bool> isArmed = false;
  int descriptor = -1;
  std::array<char, 256> bytes{};
  std::size_t size = 0;
  termios modes{};
};

Restoration restoration;
std::atomic<const WakeUp*> wakeUpInForce = nullptr;
std::atomic<bool> isResized = false;
std::atomic<bool> isStopWanted = false;
std::atomic<bool> isContinued = false;

void giveTerminalBack() {
  if (!restoration.isArmed.exchange(false)) return;
  [[maybe_unused]] const ssize_t written = write(restoration.descriptor, restoration.bytes.data(), restoration.size);
  tcsetattr(restoration.descriptor, TCSANOW, &restoration.modes);
}

void noteSignal(int signal, siginfo_t* /*information*/, void* /*context*/) {
  const int errorBefore = errno;
  if (signal == SIGWINCH) isResized = true;
  if (signal == SIGTSTP) isStopWanted = true;
  if (signal == SIGCONT) isContinued = true;
  if (const WakeUp* wakeUp = wakeUpInForce) wakeUp->signal();
  errno = errorBefore;
}

void endProgram(int signal, siginfo_t* information, void* context);

struct Watched {
  int signal;
  Handler handler;
  /// Whether a handler of the program's own keeps its place.
  bool isLeftToTheProgram;
  struct sigaction before {};
  bool isInstalled = false;
};

std::array watchedSignals{
    Watched{SIGWINCH, noteSignal, false}, Watched{SIGTSTP, noteSignal, false}, Watched{SIGCONT, noteSignal, false},
    Watched{SIGINT, endProgram, true},    Watched{SIGTERM, endProgram, true},  Watched{SIGHUP, endProgram, true},
    Watched{SIGQUIT, endProgram, true},   Watched{SIGSEGV, endProgram, false}, Watched{SIGBUS, endProgram, false},
    Watched{SIGILL, endProgram, false},   Watched{SIGFPE, endProgram, false},  Watched{SIGABRT, endProgram, false},
};

/// Gives the terminal back and lets the signal do what it would have done.
void endProgram(int signal, siginfo_t* information, void* /*context*/) {
  giveTerminalBack();
  for (const Watched& watched : watchedSignals) {
    if (watched.signal == signal) sigaction(signal, &watched.before, nullptr);
  }
  // A fault happens again by itself when the handler returns, with all its particulars. What the terminal's
  // keys sent comes from the kernel too, and does not.
  const bool isFault = information->si_code > 0 && information->si_code != SI_KERNEL;
  if (!isFault) raise(signal);
}

struct sigaction actionOf(Handler handler) {
  struct sigaction action {};
  action.sa_sigaction = handler;
  action.sa_flags = SA_SIGINFO | SA_RESTART;
  sigemptyset(&action.sa_mask);
  return action;
}

}  // namespace

void install(const WakeUp& wakeUp) {
  wakeUpInForce = &wakeUp;
  static const bool isRegistered = std::atexit(giveTerminalBack) == 0;
  static_cast<void>(isRegistered);
  for (Watched& watched : watchedSignals) {
    sigaction(watched.signal, nullptr, &watched.before);
    const bool isDefault = (watched.before.sa_flags & SA_SIGINFO) == 0 && watched.before.sa_handler == SIG_DFL;
    const bool isIgnoredStop = watched.signal == SIGTSTP && watched.before.sa_handler == SIG_IGN;
    if ((watched.isLeftToTheProgram && !isDefault) || isIgnoredStop) continue;
    const struct sigaction action = actionOf(watched.handler);
    watched.isInstalled = sigaction(watched.signal, &action, nullptr) == 0;
  }
}

void uninstall() {
  for (Watched& watched : watchedSignals) {
    if (watched.isInstalled) sigaction(watched.signal, &watched.before, nullptr);
    watched.isInstalled = false;
  }
  wakeUpInForce = nullptr;
}

void arm(int descriptor, std::string_view bytes, const termios& modes) {
  restoration.isArmed = false;
  restoration.descriptor = descriptor;
  restoration.size = std::min(bytes.size(), restoration.bytes.size());
  std::copy_n(bytes.begin(), restoration.size, restoration.bytes.begin());
  restoration.modes = modes;
  restoration.isArmed = true;
}

void disarm() {
  restoration.isArmed = false;
}

Seen take() {
  return {isResized.exchange(false), isStopWanted.exchange(false), isContinued.exchange(false)};
}

void stopProgram() {
  struct sigaction byDefault {};
  byDefault.sa_handler = SIG_DFL;
  struct sigaction before {};
  sigaction(SIGTSTP, &byDefault, &before);
  raise(SIGTSTP);
  sigaction(SIGTSTP, &before, nullptr);
  isContinued = false;
}

}  // namespace vesk::terminal_signals
