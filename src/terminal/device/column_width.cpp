#include "terminal/device/column_width.h"

#include <algorithm>
#include <array>
#include <clocale>
#include <cstdlib>
#include <cstring>
#include <cwchar>
#include <langinfo.h>

#include "values/ascii.h"
#include "values/utf8.h"

namespace vesk {

namespace {

struct Range {
  char32_t first;
  char32_t last;
};

template <std::size_t Count>
bool isWithin(char32_t codePoint, const std::array<Range, Count>& ranges) {
  return std::any_of(ranges.begin(), ranges.end(),
                     [&](const Range& range) { return range.first <= codePoint && codePoint <= range.last; });
}

/// Marks without a width that change how the rest of a line is laid out instead of combining.
constexpr std::array kLayoutControls{
    Range{0x00AD, 0x00AD}, Range{0x061C, 0x061C}, Range{0x180E, 0x180E}, Range{0x200B, 0x200F}, Range{0x2028, 0x202E},
    Range{0x2060, 0x206F}, Range{0xFE00, 0xFE0F}, Range{0xFEFF, 0xFEFF}, Range{0xFFF9, 0xFFFB}, Range{0xE0000, 0xE0FFF},
};

/// For a C library that knows ASCII alone.
constexpr std::array kCombining{
    Range{0x0300, 0x036F}, Range{0x0483, 0x0489}, Range{0x0591, 0x05BD}, Range{0x0610, 0x061A},
    Range{0x064B, 0x065F}, Range{0x0E31, 0x0E31}, Range{0x0E34, 0x0E3A}, Range{0x1AB0, 0x1AFF},
    Range{0x1DC0, 0x1DFF}, Range{0x20D0, 0x20FF}, Range{0x302A, 0x302D}, Range{0xFE20, 0xFE2F},
};
constexpr std::array kWide{
    Range{0x1100, 0x115F},   Range{0x2E80, 0x303E},   Range{0x3041, 0x33FF},   Range{0x3400, 0x4DBF},
    Range{0x4E00, 0xA4CF},   Range{0xA960, 0xA97C},   Range{0xAC00, 0xD7A3},   Range{0xF900, 0xFAFF},
    Range{0xFE30, 0xFE6F},   Range{0xFF00, 0xFF60},   Range{0xFFE0, 0xFFE6},   Range{0x1F300, 0x1F64F},
    Range{0x1F680, 0x1F6FF}, Range{0x1F900, 0x1F9FF}, Range{0x20000, 0x3FFFD},
};

constexpr std::string_view kReplacement = "\uFFFD";

/// U+2400 to U+241F picture the controls in their order, U+2421 the delete character.
constexpr std::array<std::array<char, 3>, 33> kControlPictures = [] {
  std::array<std::array<char, 3>, 33> pictures{};
  for (unsigned code = 0; code < pictures.size(); ++code) {
    const unsigned shift = code == 32 ? 33 : code;
    pictures[code] = {'\xE2', '\x90', static_cast<char>(0x80 + shift)};
  }
  return pictures;
}();

std::string_view pictureOfControl(char32_t codePoint) {
  const std::array<char, 3>& picture = kControlPictures[codePoint < 0x20 ? codePoint : 32];
  return {picture.data(), picture.size()};
}

bool isLocaleUtf8() {
  return std::strcmp(nl_langinfo(CODESET), "UTF-8") == 0;
}

/// The locale that the user chose for characters; empty for none.
std::string_view chosenLocale() {
  for (const char* variable : {"LC_ALL", "LC_CTYPE", "LANG"}) {
    const char* value = std::getenv(variable);
    if (value != nullptr && *value != '\0') return value;
  }
  return {};
}

/// Whether a locale that the system does not have says by its name that it is another one than UTF-8.
bool namesOtherCharset(std::string_view locale) {
  if (locale == "C" || locale == "POSIX") return true;
  const std::size_t dot = locale.find('.');
  if (dot == std::string_view::npos) return false;
  const std::string_view charset = locale.substr(dot + 1, locale.find('@', dot) - dot - 1);
  return !containsIgnoringCase(charset, "utf-8") && !containsIgnoringCase(charset, "utf8");
}

}  // namespace

bool setUpCharacterLocale() {
  const std::string_view chosen = chosenLocale();
  if (std::setlocale(LC_CTYPE, "") != nullptr) {
    if (isLocaleUtf8()) return true;
    if (!chosen.empty()) return false;
  }
  if (namesOtherCharset(chosen)) return false;
  return std::setlocale(LC_CTYPE, "C.UTF-8") != nullptr && isLocaleUtf8();
}

int columnWidth(char32_t codePoint) {
  if (isControl(codePoint)) return -1;
  if (codePoint < 0x7F) return 1;
  if (isWithin(codePoint, kLayoutControls)) return -1;
  if (MB_CUR_MAX > 1) return wcwidth(static_cast<wchar_t>(codePoint));
  if (isWithin(codePoint, kCombining)) return 0;
  return isWithin(codePoint, kWide) ? 2 : 1;
}

Glyph takeGlyph(std::string_view& rest) {
  const std::size_t size = utf8CharacterSize(rest);
  const std::string_view base = rest.substr(0, std::max<std::size_t>(size, 1));
  const char32_t codePoint = size == 0 ? 0xFFFD : codePointOf(base);
  const int width = columnWidth(codePoint);
  if (size == 0 || width < 1) {
    rest.remove_prefix(base.size());
    const bool isAsciiControl = size == 1 && width < 0;
    return {isAsciiControl ? pictureOfControl(codePoint) : kReplacement, 1};
  }
  std::size_t end = size;
  std::size_t shown = size;
  for (std::size_t mark = 0; end < rest.size(); end += mark) {
    mark = utf8CharacterSize(rest.substr(end));
    if (mark < 2 || columnWidth(codePointOf(rest.substr(end, mark))) != 0) break;
    if (shown == end && end + mark <= kLongestGlyph) shown = end + mark;
  }
  const std::string_view bytes = rest.substr(0, shown);
  rest.remove_prefix(end);
  return {bytes, width};
}

int textWidth(std::string_view text) {
  int width = 0;
  while (!text.empty())
    width += takeGlyph(text).width;
  return width;
}

}  // namespace vesk
