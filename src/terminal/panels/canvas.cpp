#include "terminal/panels/canvas.h"

#include <algorithm>

namespace vesk {

Canvas Canvas::part(Rectangle inside) const {
  const int column = std::clamp(inside.column, 0, place_.columns);
  const int line = std::clamp(inside.line, 0, place_.lines);
  return {*grid_,
          {place_.column + column, place_.line + line, std::clamp(inside.columns, 0, place_.columns - column),
           std::clamp(inside.lines, 0, place_.lines - line)}};
}

int Canvas::write(int column, int line, std::string_view text, Role role) const {
  return write(column, line, text, role, place_.columns);
}

int Canvas::write(int column, int line, std::string_view text, Role role, int end) const {
  if (line < 0 || line >= place_.lines || column < 0) return column;
  const int edge = place_.column + std::min(end, place_.columns);
  return grid_->writeCut(place_.column + column, place_.line + line, text, role, edge) - place_.column;
}

void Canvas::writeRight(int end, int line, std::string_view text, Role role) const {
  write(std::max(end - textWidth(text), 0), line, text, role, end);
}

void Canvas::fill(int line, Role role) const {
  if (line < 0 || line >= place_.lines) return;
  grid_->fill(place_.column, place_.line + line, role, place_.column + place_.columns);
}

}  // namespace vesk
