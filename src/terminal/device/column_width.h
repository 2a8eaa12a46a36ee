#pragma once

#include <cstddef>
#include <string_view>

namespace vesk {

/// Takes the locale of the environment for characters, or C.UTF-8 where it names none or one that the system lacks.
/// False when the user chose another charset than UTF-8, or the system has no UTF-8: then only ASCII can be shown.
bool setUpCharacterLocale();

/// The columns that a printable character takes: 1, 2, or 0 for a mark that combines with the one before.
/// -1 for a character that must not reach a terminal: controls, and those that turn the direction of text.
/// The C library's answer where the locale is a UTF-8 one, a coarse table's elsewhere.
[[nodiscard]] int columnWidth(char32_t codePoint);

/// What is drawn of the start of a text: some bytes, safe for a terminal, and the columns they take.
struct Glyph {
  /// A base character with its combining marks. It views the text itself, or static storage for a stand-in:
  /// control pictures for ASCII controls, U+FFFD for everything else that cannot be shown.
  std::string_view bytes;
  int width;
};

/// The longest glyph in bytes; marks beyond that are left out.
inline constexpr std::size_t kLongestGlyph = 15;

/// Takes one glyph off the front of `rest`, which must not be empty.
Glyph takeGlyph(std::string_view& rest);

/// The columns of a whole text.
[[nodiscard]] int textWidth(std::string_view text);

}  // namespace vesk
