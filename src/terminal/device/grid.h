#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "terminal/device/column_width.h"

namespace vesk {

/// What a piece of the picture is; the palette decides how that looks.
enum class Role : std::uint8_t {
  Plain,
  Faint,
  Bar,
  BarStatus,
  Title,
  FrozenMark,
  SectionHeader,
  Value,
  Changed,
  Selected,
  SelectedChanged,
  Prompt,
  PaneHeader,
  Key,
  Excellent,
  Good,
  Fair,
  Poor,
  Alarm,
};
inline constexpr std::size_t kRoleCount = static_cast<std::size_t>(Role::Alarm) + 1;

struct Size {
  int columns = 0;
  int lines = 0;

  friend bool operator==(const Size&, const Size&) = default;
};

/// One place of the terminal. A glyph two columns wide fills its cell and leaves the next one without bytes.
struct Cell {
  std::array<char, kLongestGlyph> bytes{' '};
  std::uint8_t size = 1;
  Role role = Role::Plain;

  [[nodiscard]] std::string_view glyph() const { return {bytes.data(), size}; }
  /// Whether this is the right half of the glyph before.
  [[nodiscard]] bool isRightHalf() const { return size == 0; }

  friend bool operator==(const Cell&, const Cell&) = default;
};

/// A picture of the whole terminal in memory.
class Grid {
 public:
  Grid() = default;
  /// All blank. A negative size counts as none.
  explicit Grid(Size size);

  [[nodiscard]] Size size() const { return size_; }
  /// The place must be inside.
  [[nodiscard]] const Cell& at(int column, int line) const { return cells_[indexOf(column, line)]; }

  /// Writes `text` from `column` on, up to but not into `end`; what does not fit is left out, and a wide
  /// glyph is never cut: blanks stand where a half of one would. Returns the column after the last one
  /// written.
  int write(int column, int line, std::string_view text, Role role, int end);
  /// The same with an ellipsis in the last column where something is left out.
  int writeCut(int column, int line, std::string_view text, Role role, int end);
  /// Blanks from `column` up to `end`.
  void fill(int column, int line, Role role, int end);

  /// The glyphs of a line, without the blanks at its end.
  [[nodiscard]] std::string textOfLine(int line) const;

  friend bool operator==(const Grid&, const Grid&) = default;

 private:
  [[nodiscard]] std::size_t indexOf(int column, int line) const {
    return static_cast<std::size_t>(line) * static_cast<std::size_t>(size_.columns) + static_cast<std::size_t>(column);
  }
  void put(int column, int line, std::string_view glyph, int width, Role role);

  Size size_;
  std::vector<Cell> cells_;
};

}  // namespace vesk
