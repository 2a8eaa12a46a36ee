#pragma once

#include <array>
#include <optional>
#include <string>

#include "terminal/device/appearance.h"
#include "terminal/device/palette.h"
#include "terminal/device/signs.h"

namespace vesk {

/// The byte strings that make a terminal do things; empty where it cannot.
struct Capabilities {
  std::string moveTo;  ///< terminfo's "cup", still to be filled in
  std::string plain;   ///< back to the terminal's own look
  /// What makes text look as a role, starting from `plain`.
  std::array<std::string, kRoleCount> looks;
  std::string clear;
  std::string enterScreen;  ///< takes the terminal over: its other screen, no cursor, no wrapping, mouse reports
  std::string leaveScreen;  ///< gives it back as it was
  /// A line for the user where another terminal stands in for that of TERM; else empty.
  std::string warning;
  bool showsUtf8 = true;
  Signs signs = Signs::braille;

  /// The cursor to a place counted from 0.
  [[nodiscard]] std::string move(int column, int line) const;
};

/// Reads the terminfo entry of TERM, or of a usual terminal in place of an unknown one, for the terminal at
/// `descriptor`. Absent when there is none or it is too simple for screens; `reason` then says why in one line.
[[nodiscard]] std::optional<Capabilities> readCapabilities(int descriptor, bool showsUtf8, const Appearance& appearance,
                                                           std::string& reason);

}  // namespace vesk
