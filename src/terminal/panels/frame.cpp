#include "terminal/panels/frame.h"

#include <array>
#include <string_view>

namespace vesk {

namespace {

constexpr std::uint8_t kArmUp = 1;
constexpr std::uint8_t kArmRight = 2;
constexpr std::uint8_t kArmDown = 4;
constexpr std::uint8_t kArmLeft = 8;

/// By the arms that meet.
constexpr std::array<std::string_view, 16> kJoints{
    "", "│", "─", "└", "│", "│", "┌", "├", "─", "┘", "─", "┴", "┐", "┤", "┬", "┼",
};

}  // namespace

Frame::Frame(Size size)
    : size_(size), arms_(static_cast<std::size_t>(size.columns) * static_cast<std::size_t>(size.lines)) {}

void Frame::join(int column, int line, std::uint8_t arms) {
  arms_[static_cast<std::size_t>(line) * static_cast<std::size_t>(size_.columns) + static_cast<std::size_t>(column)] |=
      arms;
}

void Frame::add(Rectangle box) {
  const int right = box.column + box.columns - 1;
  const int bottom = box.line + box.lines - 1;
  for (const int line : {box.line, bottom}) {
    for (int column = box.column; column < right; ++column) {
      join(column, line, kArmRight);
      join(column + 1, line, kArmLeft);
    }
  }
  for (const int column : {box.column, right}) {
    for (int line = box.line; line < bottom; ++line) {
      join(column, line, kArmDown);
      join(column, line + 1, kArmUp);
    }
  }
}

void Frame::draw(const Canvas& canvas) const {
  std::size_t place = 0;
  for (int line = 0; line < size_.lines; ++line) {
    for (int column = 0; column < size_.columns; ++column, ++place) {
      if (arms_[place] != 0) canvas.write(column, line, kJoints[arms_[place]], Role::Faint);
    }
  }
}

}  // namespace vesk
