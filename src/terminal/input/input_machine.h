#pragma once

#include <chrono>
#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "system/clock.h"
#include "terminal/input/input_event.h"

namespace vesk {

/// Turns the bytes that a terminal sends into keys and mouse events. It reads UTF-8, the CSI and SS3
/// sequences of the usual terminals with their modifiers, SGR mouse reports and bracketed pastes; every other sequence
/// is swallowed whole, and so are bytes that are no UTF-8.
class InputMachine {
 public:
  /// An Escape that nothing follows for this long was the key.
  static constexpr std::chrono::milliseconds kLoneEscape{50};
  /// A sequence that was begun, and that nobody can have typed, is given up after this long.
  static constexpr std::chrono::milliseconds kUnfinishedSequence{1000};

  /// Appends to `events` what `bytes`, which arrived at `now`, and the time until then amount to.
  void feed(std::string_view bytes, Clock::Instant now, std::vector<InputEvent>& events);
  /// Appends what the passing of time amounts to.
  void advance(Clock::Instant now, std::vector<InputEvent>& events);
  /// When to call `advance`, unless bytes come first.
  [[nodiscard]] std::optional<Clock::Instant> deadline() const { return deadline_; }

 private:
  enum class State {
    Ground,
    Character,     ///< inside a UTF-8 character
    Escape,        ///< after ESC
    Csi,           ///< after ESC [
    LinuxConsole,  ///< after ESC [ [: one more byte
    Ss3,           ///< after ESC O
    OldMouse,      ///< after ESC [ M: three more bytes
    String,        ///< inside OSC, DCS, SOS, PM or APC
    StringEscape,  ///< after ESC in one of these
    Paste,         ///< after ESC [ 200 ~, until ESC [ 201 ~
  };

  void take(char byte, std::vector<InputEvent>& events);
  void takeInGround(unsigned char byte, std::vector<InputEvent>& events);
  void takeInCharacter(unsigned char byte, std::vector<InputEvent>& events);
  void takeAfterEscape(unsigned char byte, std::vector<InputEvent>& events);
  void takeInCsi(unsigned char byte, std::vector<InputEvent>& events);
  void takeInSs3(unsigned char byte, std::vector<InputEvent>& events);
  void takeInPaste(char byte, std::vector<InputEvent>& events);
  void enter(State state);

  State state_ = State::Ground;
  /// What the present state has collected, cut at kLongestSequence; of a paste, at kLongestPaste.
  std::string collected_;
  bool isAltHeld_ = false;
  std::optional<Clock::Instant> deadline_;
};

}  // namespace vesk
