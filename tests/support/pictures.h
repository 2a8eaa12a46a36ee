#pragma once

#include <chrono>
#include <cstdlib>
#include <string>
#include <string_view>
#include <vector>

#include "terminal/device/column_width.h"
#include "terminal/view/presenter.h"
#include "terminal/view/renderer.h"
#include "toolkit/navigation_controller.h"

namespace vesk {

/// Widths of characters are those of a UTF-8 locale in every test.
inline const bool kHasUtf8Locale = setenv("LC_ALL", "C.UTF-8", 1) == 0 && setUpCharacterLocale();

/// The lines of a grid, each behind a bar so that its blanks at the start can be seen.
inline std::string pictureOf(const Grid& grid) {
  std::string picture = "\n";
  for (int line = 0; line < grid.size().lines; ++line)
    picture += "|" + grid.textOfLine(line) + "\n";
  return picture;
}

/// A presenter over a navigation stack, worked by keys and looked at as pictures.
class Desk {
 public:
  explicit Desk(NavigationController& stack, Size size = {40, 10}, Surroundings surroundings = {})
      : presenter_(stack, std::move(surroundings)) {
    resize(size);
  }

  void resize(Size size) { presenter_.resize(size); }
  void press(Key key) { presenter_.handle(KeyEvent{.key = key}); }
  void type(std::u32string_view characters) {
    for (const char32_t character : characters)
      presenter_.handle(KeyEvent{.character = character});
  }
  void mouse(MouseAction action, int column, int line) {
    presenter_.handle(MouseEvent{.action = action, .column = column, .line = line});
  }
  void click(int column, int line) {
    mouse(MouseAction::Press, column, line);
    mouse(MouseAction::Release, column, line);
  }
  void wait(Clock::Duration time) { now_ += time; }
  [[nodiscard]] Clock::Instant now() const { return now_; }

  [[nodiscard]] Presenter& presenter() { return presenter_; }
  [[nodiscard]] Grid grid() { return render(presenter_.picture(now_)); }
  std::string picture() { return pictureOf(grid()); }
  [[nodiscard]] std::string line(int number) { return grid().textOfLine(number); }
  /// The first line with a cell of `role`; -1 for none.
  [[nodiscard]] int lineOf(Role role) {
    const Grid shown = grid();
    for (int line = 0; line < shown.size().lines; ++line) {
      for (int column = 0; column < shown.size().columns; ++column) {
        if (shown.at(column, line).role == role) return line;
      }
    }
    return -1;
  }

 private:
  Presenter presenter_;
  Clock::Instant now_{std::chrono::hours(1)};
};

}  // namespace vesk
