#include <clocale>
#include <cstdlib>
#include <gtest/gtest.h>

#include "support/pictures.h"
#include "terminal/device/column_width.h"
#include "terminal/device/grid.h"
#include "terminal/view/path_bar.h"
#include "terminal/view/wrapping.h"

namespace vesk {
namespace {

std::string shown(std::string_view text) {
  Grid grid({40, 1});
  grid.write(0, 0, text, Role::Plain, 40);
  return grid.textOfLine(0);
}

TEST(TextColumns, NothingThatActsOnATerminalReachesIt) {
  ASSERT_TRUE(kHasUtf8Locale);
  struct {
    std::string_view text;
    std::string_view shown;
  } const cases[] = {
      {"\x1b[31mred", "␛[31mred"},
      {std::string_view("a\0b\tc\x7F", 6), "a␀b␉c␡"},
      {"\xC2\x9B"
       "31m",
       "\uFFFD31m"},                         // the one-character CSI
      {"\xFF\xC3", "\uFFFD\uFFFD"},          // no UTF-8
      {"\u202Eab\u200D", "\uFFFDab\uFFFD"},  // turns the line's direction; joins what follows
      {"\u0301x", "\uFFFDx"},                // a mark without a base
      {"e\u0301", "e\u0301"},
  };
  for (const auto& each : cases) {
    EXPECT_EQ(shown(each.text), each.shown);
  }
}

TEST(TextColumns, WidthsAreThoseOfTheTerminalWithAndWithoutAUtf8Locale) {
  for (const char* locale : {"C.UTF-8", "C"}) {
    std::setlocale(LC_CTYPE, locale);
    EXPECT_EQ(textWidth("漢字"), 4) << locale;
    EXPECT_EQ(textWidth("e\u0301\u0302x"), 2) << locale;
    EXPECT_EQ(textWidth("é›…"), 3) << locale;
    EXPECT_EQ(columnWidth(0x9B), -1) << locale;
  }
  setUpCharacterLocale();
}

TEST(TextColumns, AGridNeverHoldsHalfAWideGlyph) {
  Grid grid({4, 1});
  EXPECT_EQ(grid.write(0, 0, "a漢字", Role::Plain, 4), 4);
  EXPECT_EQ(grid.textOfLine(0), "a漢");
  grid.write(2, 0, "x", Role::Plain, 4);
  EXPECT_EQ(grid.textOfLine(0), "a x");
  grid.write(0, 0, "漢字", Role::Plain, 4);
  grid.write(1, 0, "字", Role::Plain, 4);
  EXPECT_EQ(grid.textOfLine(0), " 字");
  EXPECT_FALSE(grid.at(3, 0).isRightHalf());
}

TEST(TextColumns, TextIsWrappedAtLineFeedsThenBlanksThenAnywhere) {
  struct {
    std::string_view text;
    int width;
    std::vector<std::string_view> lines;
  } const cases[] = {
      {"one two", 6, {"one", "two"}},          {"one  two", 4, {"one", "two"}}, {"ab cdefgh", 4, {"ab", "cdef", "gh"}},
      {"a\n\n  b\n", 5, {"a", "", "  b", ""}}, {"漢字", 1, {"漢", "字"}},       {"abc ", 3, {"abc"}},
  };
  for (const auto& each : cases) {
    EXPECT_EQ(wrapText(each.text, each.width), each.lines) << each.text;
  }
}

TEST(TextColumns, TheLocaleSaysWhetherUtf8ShowsAndNoneMeansItDoes) {
  const struct {
    const char* locale;
    bool showsUtf8;
  } cases[] = {{"C", false}, {"POSIX", false}, {"xx_YY.ISO-8859-1", false}, {"xx_YY.utf8", true}, {"C.UTF-8", true}};
  for (const auto& each : cases) {
    setenv("LC_ALL", each.locale, 1);
    EXPECT_EQ(setUpCharacterLocale(), each.showsUtf8) << each.locale;
  }
}

TEST(TextColumns, APathThatDoesNotFitLosesItsStart) {
  const std::vector<std::string> names{"Vesk", "LTE", "Tx Power"};
  struct {
    int width;
    std::string_view text;
    std::size_t firstDepth;
    int firstColumn;
  } const cases[] = {
      {20, "… › LTE › Tx Power", 2, 4},
      {3, "… › Tx Power", 3, 4},
  };
  for (const auto& each : cases) {
    const PathBar bar = layOutPath(names, each.width);
    EXPECT_EQ(bar.text, each.text);
    EXPECT_EQ(bar.segments.front().depth, each.firstDepth);
    EXPECT_EQ(bar.segments.front().column, each.firstColumn);
    EXPECT_EQ(bar.segments.back().end, textWidth(bar.text));
  }
}

}  // namespace
}  // namespace vesk
