#pragma once

#include <string_view>

namespace vesk {

/// The finest signs that a terminal's font has to draw graphs with.
enum class Signs {
  ascii,
  /// Whole and half blocks, as in the fonts of a console.
  blocks,
  /// Braille patterns, and blocks in eighths.
  braille,
};

/// Whether the terminal knows no more than the bytes of its time, whatever the locale says.
[[nodiscard]] constexpr bool isWithoutUtf8(std::string_view terminalName) {
  return terminalName.starts_with("ansi") || terminalName.starts_with("vt1") || terminalName.starts_with("vt2") ||
         terminalName.starts_with("vt52");
}

/// `terminalName` is that of TERM. Consoles have fonts of a few hundred signs.
[[nodiscard]] constexpr Signs signsOf(std::string_view terminalName, bool showsUtf8) {
  if (!showsUtf8) return Signs::ascii;
  return terminalName.starts_with("linux") || terminalName.starts_with("fbterm") ? Signs::blocks : Signs::braille;
}

}  // namespace vesk
