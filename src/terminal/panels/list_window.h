#pragma once

#include "terminal/input/key_bindings.h"

namespace vesk {

/// A window over a list of rows, each a line tall, with one row selected.
class ListWindow {
 public:
  /// What there is and what of it can show. The selected row stays in the window.
  void resize(int rows, int height);

  [[nodiscard]] int selected() const { return selected_; }
  /// The row in the window's first line, and the row after its last.
  [[nodiscard]] int top() const { return top_; }
  [[nodiscard]] int end() const { return top_ + height_ < rows_ ? top_ + height_ : rows_; }

  /// False for keys that move nothing.
  bool perform(Action action);
  void scroll(int lines);
  void select(int row);
  /// That many rows came before all others: what is selected and what shows stay the same.
  void shift(int rows);

 private:
  void keepTop();

  int rows_ = 0;
  int height_ = 1;
  int top_ = 0;
  int selected_ = 0;
};

}  // namespace vesk
