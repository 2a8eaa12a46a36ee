#include "terminal/panels/list_window.h"

#include <algorithm>
#include <array>
#include <utility>

namespace vesk {

void ListWindow::resize(int rows, int height) {
  rows_ = rows;
  height_ = std::max(height, 1);
  select(selected_);
}

void ListWindow::select(int row) {
  selected_ = std::clamp(row, 0, std::max(rows_ - 1, 0));
  top_ = std::clamp(top_, selected_ - height_ + 1, selected_);
  keepTop();
}

void ListWindow::keepTop() {
  top_ = std::clamp(top_, 0, std::max(rows_ - height_, 0));
}

bool ListWindow::perform(Action action) {
  const int page = std::max(height_ - 1, 1);
  const std::array<std::pair<Action, int>, 6> targets{{{Action::Up, selected_ - 1},
                                                       {Action::Down, selected_ + 1},
                                                       {Action::PageUp, selected_ - page},
                                                       {Action::PageDown, selected_ + page},
                                                       {Action::First, 0},
                                                       {Action::Last, rows_ - 1}}};
  for (const auto& [each, row] : targets) {
    if (each != action) continue;
    select(row);
    return true;
  }
  return false;
}

void ListWindow::scroll(int lines) {
  top_ += lines;
  keepTop();
  selected_ = std::clamp(selected_, top_, std::max(end() - 1, top_));
}

void ListWindow::shift(int rows) {
  rows_ += rows;
  selected_ += rows;
  top_ += rows;
}

}  // namespace vesk
