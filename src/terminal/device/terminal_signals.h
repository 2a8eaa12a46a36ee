#pragma once

#include <string_view>
#include <termios.h>

#include "system/wake_up.h"

/// The signals that concern a terminal. There is one such terminal at a time.
namespace vesk::terminal_signals {

/// What has been signalled since it was last asked for.
struct Seen {
  bool isResized;
  bool isStopWanted;
  bool isContinued;
};

/// From here on resizing, stopping and continuing signal `wakeUp`, and a signal that ends the program, or its
/// exit, first gives the terminal back. Signals that the program handles or ignores itself are left to it,
/// but for crashes.
void install(const WakeUp& wakeUp);
/// Puts everything back as it was.
void uninstall();

/// What gives the terminal back: `bytes`, at most 256, written to `descriptor`, then `modes`.
void arm(int descriptor, std::string_view bytes, const termios& modes);
/// The terminal needs no giving back.
void disarm();

[[nodiscard]] Seen take();

/// Stops the program as the signal would without a handler; returns when it is continued.
void stopProgram();

}  // namespace vesk::terminal_signals
