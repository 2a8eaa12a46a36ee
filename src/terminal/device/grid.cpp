#include "terminal/device/grid.h"

#include <algorithm>

namespace vesk {

Grid::Grid(Size size) : size_{std::max(size.columns, 0), std::max(size.lines, 0)}, cells_(indexOf(0, size_.lines)) {}

int Grid::write(int column, int line, std::string_view text, Role role, int end) {
  end = std::min(end, size_.columns);
  if (line < 0 || line >= size_.lines || column < 0) return column;
  while (!text.empty() && column < end) {
    const Glyph glyph = takeGlyph(text);
    if (column + glyph.width > end) {
      put(column, line, " ", 1, role);
      return column + 1;
    }
    put(column, line, glyph.bytes, glyph.width, role);
    column += glyph.width;
  }
  return column;
}

int Grid::writeCut(int column, int line, std::string_view text, Role role, int end) {
  end = std::min(end, size_.columns);
  // More bytes than a line can show need no measuring.
  const bool isLong = text.size() > static_cast<std::size_t>(size_.columns) * kLongestGlyph;
  if (!isLong && column + textWidth(text) <= end) return write(column, line, text, role, end);
  if (column >= end) return column;
  write(column, line, text, role, end - 1);
  return write(end - 1, line, "…", role, end);
}

void Grid::fill(int column, int line, Role role, int end) {
  end = std::min(end, size_.columns);
  if (line < 0 || line >= size_.lines) return;
  for (column = std::max(column, 0); column < end; ++column)
    put(column, line, " ", 1, role);
}

void Grid::put(int column, int line, std::string_view glyph, int width, Role role) {
  Cell* cell = &cells_[indexOf(column, line)];
  if (cell->isRightHalf()) cell[-1] = Cell{.role = cell[-1].role};
  if (column + width < size_.columns && cell[width].isRightHalf()) cell[width] = Cell{.role = cell[width].role};
  cell->bytes = {};
  std::copy(glyph.begin(), glyph.end(), cell->bytes.begin());
  cell->size = static_cast<std::uint8_t>(glyph.size());
  cell->role = role;
  if (width == 2) cell[1] = Cell{.bytes = {}, .size = 0, .role = role};
}

std::string Grid::textOfLine(int line) const {
  std::string text;
  for (int column = 0; column < size_.columns; ++column)
    text += at(column, line).glyph();
  text.erase(text.find_last_not_of(' ') + 1);
  return text;
}

}  // namespace vesk
