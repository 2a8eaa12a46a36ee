#include "terminal/view/wrapping.h"

#include <algorithm>

#include "terminal/device/column_width.h"

namespace vesk {

namespace {

/// The number of bytes of `text` that make the first line.
std::size_t firstLineSize(std::string_view text, int width) {
  std::size_t afterBlank = 0;
  int columns = 0;
  for (std::string_view rest = text; !rest.empty();) {
    const std::size_t start = text.size() - rest.size();
    const bool isBlank = rest.front() == ' ';
    columns += takeGlyph(rest).width;
    if (columns > width) {
      if (isBlank) return start;
      return afterBlank > 0 ? afterBlank : start;
    }
    if (isBlank) afterBlank = text.size() - rest.size();
  }
  return text.size();
}

void wrapParagraph(std::string_view text, int width, std::vector<std::string_view>& lines) {
  do {
    std::string_view line = text.substr(0, firstLineSize(text, width));
    text.remove_prefix(line.size());
    if (!text.empty()) {
      line = line.substr(0, line.find_last_not_of(' ') + 1);
      text.remove_prefix(std::min(text.find_first_not_of(' '), text.size()));
    }
    lines.push_back(line);
  } while (!text.empty());
}

}  // namespace

std::vector<std::string_view> wrapText(std::string_view text, int width) {
  std::vector<std::string_view> lines;
  width = std::max(width, 2);
  while (true) {
    const std::size_t lineFeed = text.find('\n');
    wrapParagraph(text.substr(0, lineFeed), width, lines);
    if (lineFeed == std::string_view::npos) return lines;
    text.remove_prefix(lineFeed + 1);
  }
}

}  // namespace vesk
