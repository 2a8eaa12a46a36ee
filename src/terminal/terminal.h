#pragma once

#include <chrono>
#include <memory>
#include <string>

#include "system/clock.h"
#include "terminal/device/capabilities.h"
#include "terminal/device/grid.h"
#include "terminal/device/terminal_device.h"
#include "terminal/input/input_machine.h"
#include "terminal/view/presenter.h"
#include "terminal/view/surroundings.h"
#include "toolkit/navigation_controller.h"

namespace vesk {

/// Shows a navigation stack on the terminal that the program was started from, and lets its keys and mouse
/// work it. It runs no loop of its own: the program's loop watches one descriptor and calls `serve` when it
/// is readable. Main queue only. Start here.
///
///     std::string reason;
///     std::unique_ptr<Terminal> terminal = Terminal::open(stack, clock, surroundings, reason);
///     if (terminal == nullptr) { /* say `reason`, run without screens */ }
///     loop.addInput(terminal->descriptor(), [&] { terminal->serve(); });
class Terminal {
 public:
  /// However much happens, what nobody typed shows at most this often.
  static constexpr std::chrono::milliseconds kFrame{50};
  /// The same of the screens that every event changes.
  static constexpr std::chrono::milliseconds kPanelFrame{100};

  /// Takes the terminal over and draws the stack. Null when there is no terminal or it is too simple for
  /// screens; `reason` then says why in one line. `stack` and `clock` must outlive the terminal, and what
  /// `surroundings` calls too. Takes the locale of the environment for characters.
  [[nodiscard]] static std::unique_ptr<Terminal> open(NavigationController& stack, const Clock& clock,
                                                      Surroundings surroundings, const Appearance& appearance,
                                                      std::string& reason);
  /// The same on a terminal that is open already.
  Terminal(NavigationController& stack, const Clock& clock, Surroundings surroundings, FileDescriptor terminal,
           Capabilities capabilities);
  /// Gives the terminal back.
  ~Terminal();
  Terminal(const Terminal&) = delete;
  Terminal& operator=(const Terminal&) = delete;

  /// Readable whenever `serve` has something to do.
  [[nodiscard]] int descriptor() const { return device_.descriptor(); }
  /// Takes the input, follows the terminal's size and the stopping of the program, draws what is to be drawn.
  void serve();

  /// Does what the key of `action` does.
  void perform(Action action);
  /// While the replay goes to another moment, what shows stays as it is; then it is that of the moment.
  void setOnTheWay(bool isOnTheWay);
  /// Shows a line for some seconds, and rings where it is worth looking up for.
  void tell(std::string notice, bool rings);

  /// Something that shows may have changed: the stack, the source's state, the arrivals. Cheap, so call it as
  /// often as it is true. The stack and the diagnostic lines tell it by themselves.
  void setNeedsDisplay();

 private:
  void suspend();
  void startAfresh();
  void draw(Clock::Instant now);
  /// When what nobody typed may show next.
  [[nodiscard]] Clock::Instant nextFrame() const {
    return lastDrawn_ + (presenter_.showsPanel() ? kPanelFrame : kFrame);
  }
  void scheduleWakeUp(Clock::Instant now);

  NavigationController& stack_;
  const Clock& clock_;
  Surroundings surroundings_;
  Capabilities capabilities_;
  TerminalDevice device_;
  InputMachine input_;
  Presenter presenter_;
  /// What stands on the terminal.
  Grid shown_;
  bool needsDisplay_ = false;
  bool isServing_ = false;
  Clock::Instant lastRung_;
  Clock::Instant lastDrawn_;
};

}  // namespace vesk
