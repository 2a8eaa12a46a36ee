#pragma once

#include <string_view>

#include "property.h"
#include "terminal/device/grid.h"
#include "values/utf8.h"

namespace vesk {

/// Nothing that acts on a terminal, and nothing that is no text.
inline void requireHarmless(std::string_view text) {
  while (!text.empty()) {
    const std::size_t size = utf8CharacterSize(text);
    require(size > 0, "what is shown is UTF-8");
    const char32_t character = codePointOf(text.substr(0, size));
    require(character >= 0x20 && character != 0x7F && (character < 0x80 || character > 0x9F),
            "no control character is shown");
    text.remove_prefix(size);
  }
}

/// A whole picture of the size asked for, of which every cell can be sent to a terminal.
inline void requireDrawable(const Grid& grid, Size size) {
  require(grid.size() == size, "a picture has the size of its terminal");
  for (int line = 0; line < size.lines; ++line) {
    for (int column = 0; column < size.columns; ++column) {
      const Cell& cell = grid.at(column, line);
      requireHarmless(cell.glyph());
      require(!cell.isRightHalf() || (column > 0 && !grid.at(column - 1, line).isRightHalf()),
              "a right half follows its left one");
    }
  }
}

}  // namespace vesk
