#include "terminal/device/palette.h"

#include "values/parse_number.h"

namespace vesk {

namespace {

struct Row {
  Role role;
  Look look;
};

constexpr Palette paletteOf(const std::array<Row, kRoleCount>& rows) {
  Palette palette{};
  for (const Row& row : rows)
    palette[static_cast<std::size_t>(row.role)] = row.look;
  return palette;
}

constexpr Palette kWithoutColors = paletteOf({{
    {Role::Plain, {}},
    {Role::Faint, {}},
    {Role::Bar, {.isReversed = true}},
    {Role::BarStatus, {.isBold = true, .isReversed = true}},
    {Role::Title, {.isBold = true}},
    {Role::FrozenMark, {.isBold = true, .isReversed = true}},
    {Role::SectionHeader, {.isBold = true, .isUnderlined = true}},
    {Role::Value, {}},
    {Role::Changed, {.isBold = true}},
    {Role::Selected, {.isReversed = true}},
    {Role::SelectedChanged, {.isBold = true, .isReversed = true}},
    {Role::Prompt, {.isBold = true}},
    {Role::PaneHeader, {.isUnderlined = true}},
    {Role::Key, {.isBold = true}},
    {Role::Excellent, {.isBold = true}},
    {Role::Good, {}},
    {Role::Fair, {}},
    {Role::Poor, {.isUnderlined = true}},
    {Role::Alarm, {.isBold = true}},
}});

// 0 black, 1 red, 2 green, 3 yellow, 4 blue, 5 magenta, 6 cyan, 7 white. Yellow and cyan text is lost on
// light backgrounds, blue on dark ones: none of them stands on a background that is the terminal's own.
constexpr Palette kSixteen = paletteOf({{
    {Role::Plain, {}},
    {Role::Faint, {}},
    {Role::Bar, {.foreground = 7, .background = 4}},
    {Role::BarStatus, {.foreground = 7, .background = 4, .isBold = true}},
    {Role::Title, {.isBold = true}},
    {Role::FrozenMark, {.foreground = 7, .background = 1, .isBold = true}},
    {Role::SectionHeader, {.foreground = 5, .isBold = true}},
    {Role::Value, {}},
    {Role::Changed, {.foreground = 2, .isBold = true}},
    {Role::Selected, {.foreground = 0, .background = 6}},
    {Role::SelectedChanged, {.foreground = 0, .background = 6, .isBold = true}},
    {Role::Prompt, {.isBold = true}},
    {Role::PaneHeader, {.isUnderlined = true}},
    {Role::Key, {.isBold = true}},
    {Role::Excellent, {.foreground = 2, .isBold = true}},
    {Role::Good, {.foreground = 2}},
    {Role::Fair, {.foreground = 5}},
    {Role::Poor, {.foreground = 1}},
    {Role::Alarm, {.foreground = 1, .isBold = true}},
}});

// The cube and the greys alone, since 0 to 15 are whatever the user made of them.
constexpr Palette kDark = paletteOf({{
    {Role::Plain, {}},
    {Role::Faint, {.foreground = 245}},
    {Role::Bar, {.foreground = 254, .background = 24}},
    {Role::BarStatus, {.foreground = 231, .background = 24, .isBold = true}},
    {Role::Title, {.isBold = true}},
    {Role::FrozenMark, {.foreground = 231, .background = 160, .isBold = true}},
    {Role::SectionHeader, {.foreground = 110, .isBold = true}},
    {Role::Value, {.foreground = 152}},
    {Role::Changed, {.foreground = 114, .isBold = true}},
    {Role::Selected, {.foreground = 231, .background = 238}},
    {Role::SelectedChanged, {.foreground = 120, .background = 238, .isBold = true}},
    {Role::Prompt, {.foreground = 179, .isBold = true}},
    {Role::PaneHeader, {.foreground = 254, .background = 238}},
    {Role::Key, {.foreground = 110, .isBold = true}},
    {Role::Excellent, {.foreground = 120, .isBold = true}},
    {Role::Good, {.foreground = 71}},
    {Role::Fair, {.foreground = 221}},
    {Role::Poor, {.foreground = 203}},
    {Role::Alarm, {.foreground = 203, .isBold = true}},
}});

constexpr Palette kLight = paletteOf({{
    {Role::Plain, {}},
    {Role::Faint, {.foreground = 242}},
    {Role::Bar, {.foreground = 231, .background = 25}},
    {Role::BarStatus, {.foreground = 231, .background = 25, .isBold = true}},
    {Role::Title, {.isBold = true}},
    {Role::FrozenMark, {.foreground = 231, .background = 160, .isBold = true}},
    {Role::SectionHeader, {.foreground = 25, .isBold = true}},
    {Role::Value, {.foreground = 23}},
    {Role::Changed, {.foreground = 28, .isBold = true}},
    {Role::Selected, {.foreground = 16, .background = 153}},
    {Role::SelectedChanged, {.foreground = 22, .background = 153, .isBold = true}},
    {Role::Prompt, {.foreground = 130, .isBold = true}},
    {Role::PaneHeader, {.foreground = 16, .background = 252}},
    {Role::Key, {.foreground = 25, .isBold = true}},
    {Role::Excellent, {.foreground = 22, .isBold = true}},
    {Role::Good, {.foreground = 28}},
    {Role::Fair, {.foreground = 130}},
    {Role::Poor, {.foreground = 160}},
    {Role::Alarm, {.foreground = 160, .isBold = true}},
}});

/// Tones between the two, for a background that is not known: each is readable on black and on white.
constexpr Palette kEither = paletteOf({{
    {Role::Plain, {}},
    {Role::Faint, {.foreground = 243}},
    {Role::Bar, {.foreground = 231, .background = 25}},
    {Role::BarStatus, {.foreground = 231, .background = 25, .isBold = true}},
    {Role::Title, {.isBold = true}},
    {Role::FrozenMark, {.foreground = 231, .background = 160, .isBold = true}},
    {Role::SectionHeader, {.foreground = 31, .isBold = true}},
    {Role::Value, {}},
    {Role::Changed, {.foreground = 28, .isBold = true}},
    {Role::Selected, {.foreground = 231, .background = 31}},
    {Role::SelectedChanged, {.foreground = 231, .background = 31, .isBold = true}},
    {Role::Prompt, {.foreground = 130, .isBold = true}},
    {Role::PaneHeader, {.foreground = 231, .background = 240}},
    {Role::Key, {.foreground = 31, .isBold = true}},
    {Role::Excellent, {.foreground = 28, .isBold = true}},
    {Role::Good, {.foreground = 28}},
    {Role::Fair, {.foreground = 130}},
    {Role::Poor, {.foreground = 161}},
    {Role::Alarm, {.foreground = 161, .isBold = true}},
}});

}  // namespace

Palette makePalette(ColorDepth depth, Background background) {
  switch (depth) {
    case ColorDepth::None:
      return kWithoutColors;
    case ColorDepth::Sixteen:
      return kSixteen;
    case ColorDepth::TwoHundredFiftySix:
      break;
  }
  switch (background) {
    case Background::Light:
      return kLight;
    case Background::Dark:
      return kDark;
    case Background::Unknown:
      break;
  }
  return kEither;
}

Background backgroundOf(std::string_view colorfgbg) {
  const std::string_view last = colorfgbg.substr(colorfgbg.rfind(';') + 1);
  const auto number = parseNumber<int>(last);
  if (!number || *number > 15) return Background::Unknown;
  constexpr int kGrey = 8;
  constexpr int kWhite = 7;
  return *number < kWhite || *number == kGrey ? Background::Dark : Background::Light;
}

ColorDepth colorDepthOf(int colors, std::string_view noColor) {
  if (!noColor.empty() || colors < 8) return ColorDepth::None;
  return colors < 256 ? ColorDepth::Sixteen : ColorDepth::TwoHundredFiftySix;
}

}  // namespace vesk
