#pragma once

#include <string_view>

#include "terminal/device/grid.h"

namespace vesk {

struct Rectangle {
  int column = 0;
  int line = 0;
  int columns = 0;
  int lines = 0;

  [[nodiscard]] bool has(int atColumn, int atLine) const {
    return column <= atColumn && atColumn < column + columns && line <= atLine && atLine < line + lines;
  }
};

/// A rectangle of a grid to draw into. Places count from its own top left; what lies outside is left out.
class Canvas {
 public:
  /// `grid` must outlive the canvas, `place` must lie within it.
  Canvas(Grid& grid, Rectangle place) : grid_(&grid), place_(place) {}

  [[nodiscard]] int columns() const { return place_.columns; }
  [[nodiscard]] int lines() const { return place_.lines; }
  [[nodiscard]] Canvas part(Rectangle inside) const;

  /// Writes `text` up to the right edge, with an ellipsis where something is left out. Returns the column after it.
  int write(int column, int line, std::string_view text, Role role) const;
  /// The same up to but not into `end`.
  int write(int column, int line, std::string_view text, Role role, int end) const;
  /// Writes `text` so that it ends before `end`.
  void writeRight(int end, int line, std::string_view text, Role role) const;
  /// Blanks over the whole line.
  void fill(int line, Role role) const;

 private:
  Grid* grid_;
  Rectangle place_;
};

}  // namespace vesk
