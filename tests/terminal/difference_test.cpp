#include "terminal/device/difference.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <gtest/gtest.h>
#include <utility>
#include <vector>

#include "support/pictures.h"
#include "terminal/device/palette.h"

namespace vesk {
namespace {

/// A terminal whose control strings can be read: <c> clear, <0> plain, <2> the look of role 2.
Capabilities readable() {
  Capabilities terminal;
  terminal.moveTo = "<%p2%d,%p1%d>";
  terminal.plain = "<0>";
  terminal.clear = "<c>";
  for (std::size_t role = 1; role < terminal.looks.size(); ++role)
    terminal.looks[role] = "<" + std::to_string(role) + ">";
  return terminal;
}

Grid gridOf(std::string_view text, Role role = Role::Plain) {
  Grid grid({8, 2});
  grid.write(0, 1, text, role, 8);
  return grid;
}

TEST(Difference, WritesWhatChangedAndNothingElse) {
  const std::string bar = std::to_string(static_cast<int>(Role::Bar));
  Grid full({2, 2});
  for (int line = 0; line < 2; ++line)
    full.write(0, line, "ab", Role::Plain, 2);
  struct {
    Grid shown;
    Grid wanted;
    std::string bytes;
  } const cases[] = {
      {gridOf("abc"), gridOf("abc"), ""},
      {gridOf("abcd"), gridOf("aXYd"), "<1,1><0>XY<0>"},
      {gridOf("abcd"), gridOf("XbcY"), "<0,1><0>X<3,1>Y<0>"},
      {gridOf("ab"), gridOf("ab", Role::Bar), "<0,1><0><" + bar + ">ab<0>"},
      {gridOf("漢b"), gridOf("abc"), "<0,1><0>abc<0>"},
      {gridOf("漢字"), gridOf("字字"), "<0,1><0>字<0>"},
      {Grid(), gridOf("a"), "<0><c><0,1><0>a<0>"},
      {Grid({3, 3}), Grid({8, 2}), "<0><c>"},
      // Where the cursor stands after the last column differs between terminals.
      {Grid({2, 2}), full, "<0,0><0>ab<0,1>ab<0>"},
  };
  for (const auto& each : cases) {
    std::string bytes;
    appendDifference(bytes, each.shown, each.wanted, readable());
    EXPECT_EQ(bytes, each.bytes);
  }

  Capabilities ascii = readable();
  ascii.showsUtf8 = false;
  std::string bytes;
  appendDifference(bytes, Grid({8, 2}), gridOf("›•é漢x"), ascii);
  EXPECT_EQ(bytes, "<0,1><0>>*???x<0>");
}

TEST(Palette, TakesColoursAsTheTerminalHasThem) {
  EXPECT_EQ(colorDepthOf(256, ""), ColorDepth::TwoHundredFiftySix);
  EXPECT_EQ(colorDepthOf(8, ""), ColorDepth::Sixteen);
  EXPECT_EQ(colorDepthOf(-1, ""), ColorDepth::None);
  EXPECT_EQ(colorDepthOf(256, "1"), ColorDepth::None);
  EXPECT_EQ(backgroundOf("0;default;15"), Background::Light);
  EXPECT_EQ(backgroundOf("12;8"), Background::Dark);
  EXPECT_EQ(backgroundOf(""), Background::Unknown);
}

/// The relative luminance of a colour of the cube or of the greys.
double luminanceOf(int color) {
  const auto linear = [](int level) { return std::pow((level / 255.0 + 0.055) / 1.055, 2.4); };
  if (color >= 232) return linear(8 + 10 * (color - 232));
  const auto level = [](int step) { return step == 0 ? 0 : 55 + 40 * step; };
  const int place = color - 16;
  return 0.2126 * linear(level(place / 36)) + 0.7152 * linear(level(place / 6 % 6)) + 0.0722 * linear(level(place % 6));
}

TEST(Palette, TextIsReadableOnItsBackground) {
  const std::pair<Background, std::vector<double>> cases[] = {
      {Background::Dark, {0}}, {Background::Light, {1}}, {Background::Unknown, {0, 1}}};
  for (const auto& [background, grounds] : cases) {
    for (const Look& look : makePalette(ColorDepth::TwoHundredFiftySix, background)) {
      if (!look.foreground) continue;
      const double text = luminanceOf(*look.foreground) + 0.05;
      for (double ground : look.background ? std::vector{luminanceOf(*look.background)} : grounds) {
        ground += 0.05;
        EXPECT_GE(std::max(text, ground) / std::min(text, ground), 4.0) << int{*look.foreground};
      }
    }
  }
}

TEST(Palette, NoMeaningHangsOnColourAlone) {
  const auto look = [](const Palette& palette, Role role) { return palette[static_cast<std::size_t>(role)]; };
  const Palette none = makePalette(ColorDepth::None, Background::Dark);
  for (const Look& each : none) {
    EXPECT_FALSE(each.foreground || each.background);
  }
  EXPECT_NE(look(none, Role::Selected), look(none, Role::Plain));
  EXPECT_NE(look(none, Role::Changed), look(none, Role::Value));
  EXPECT_NE(look(none, Role::SelectedChanged), look(none, Role::Selected));
}

}  // namespace
}  // namespace vesk
