#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <termios.h>

#include "system/clock.h"
#include "system/descriptor_writer.h"
#include "system/file_descriptor.h"
#include "system/wake_up.h"
#include "terminal/device/grid.h"

namespace vesk {

/// The terminal as the system has it: its modes, its size, its bytes and the signals about it. While one is
/// alive the terminal is taken over; it is given back when the object goes, when the program exits, and when
/// a signal ends it. One at a time.
class TerminalDevice {
 public:
  /// What bytes take the terminal over and give it back.
  struct Switches {
    std::string enter;
    std::string leave;
  };

  /// What came since the last time.
  struct Arrived {
    std::string bytes;
    bool isResized = false;
    /// The user wants the program to stop for a while: answer with `suspend`.
    bool isStopWanted = false;
    /// The program goes on after it was stopped: nothing on the terminal can be relied on.
    bool isContinued = false;
    /// The terminal is gone.
    bool isHungUp = false;
  };

  /// The terminal that the program was started from; absent when there is none.
  [[nodiscard]] static std::optional<FileDescriptor> openControllingTerminal();

  /// `terminal` is open for reading and writing, and non-blocking.
  TerminalDevice(FileDescriptor terminal, Switches switches);
  ~TerminalDevice();
  TerminalDevice(const TerminalDevice&) = delete;
  TerminalDevice& operator=(const TerminalDevice&) = delete;

  /// Readable whenever `receive` has something to tell, or the time given to `wakeAfter` has come.
  [[nodiscard]] int descriptor() const { return events_.get(); }
  [[nodiscard]] Arrived receive();
  /// Replaces the time at which the descriptor becomes readable next; absent for never.
  void wakeAfter(std::optional<Clock::Duration> delay);

  /// 80 by 24 where the terminal does not know.
  [[nodiscard]] Size size() const;
  /// Writes what the terminal takes at once; the rest goes with the calls of `receive`. What a terminal that is gone
  /// does not take is dropped.
  void write(std::string_view bytes);
  /// Whether it has not taken all that was written yet: there is no use in writing more.
  [[nodiscard]] bool isBehind() const { return !unwritten_.empty(); }

  /// Gives the terminal back, stops the program until it is continued, and takes the terminal over again.
  void suspend();
  /// Takes the terminal over, also when others changed its modes meanwhile.
  void enter();

 private:
  void leave();
  void watch(int descriptor);
  /// Writes what the terminal takes, waiting for it no longer than `patience` in all.
  void writeOn(Clock::Duration patience);

  FileDescriptor terminal_;
  DescriptorWriter writer_;
  FileDescriptor events_;
  FileDescriptor timer_;
  WakeUp signalled_;
  Switches switches_;
  termios original_{};
  std::string unwritten_;
  bool isGone_ = false;
};

}  // namespace vesk
