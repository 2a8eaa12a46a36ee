#include "terminal/view/row_layout.h"

#include <algorithm>

#include "terminal/device/column_width.h"
#include "terminal/view/wrapping.h"

namespace vesk {

namespace {

constexpr int kIndent = 2;

std::string_view viewOf(const std::optional<Text>& text) {
  return text ? text->view() : std::string_view{};
}

bool fitsBesideItsName(std::string_view name, std::string_view value, int width) {
  // A byte count far beyond the width saves measuring a long text.
  constexpr std::size_t kMostBytesPerColumn = 16;
  if (name.size() + value.size() > static_cast<std::size_t>(width) * kMostBytesPerColumn) return false;
  if (name.find('\n') != std::string_view::npos || value.find('\n') != std::string_view::npos) return false;
  const int gap = name.empty() || value.empty() ? 0 : kRowGap;
  return textWidth(name) + gap + textWidth(value) <= width;
}

}  // namespace

std::optional<int> valueEndBesideReadings(int columns) {
  constexpr int kNarrowest = 64;
  if (columns < kNarrowest) return std::nullopt;
  const int end = rowTextEnd(std::min(columns, kWidestPair), false);
  return end - end * 2 / 5 - kRowGap;
}

std::vector<RowLine> layOutRow(const RowContent& row, int columns, std::optional<int> valueEnd) {
  const int width = rowTextEnd(columns, row.accessory == CellAccessory::Disclosure) - kRowGutter;
  const std::string_view name = viewOf(row.main);
  const std::string_view value = viewOf(row.detail);
  std::vector<RowLine> lines;
  if (fitsBesideItsName(name, value, width)) {
    RowLine& line = lines.emplace_back(RowLine{.name = name, .value = value});
    if (valueEnd && !value.empty() && fitsBesideItsName(name, value, *valueEnd - kRowGutter)) {
      line.valueEnd = valueEnd;
      if (*valueEnd + kRowGap + textWidth(row.reading) <= kRowGutter + width) line.reading = row.reading;
    }
  } else if (row.height == RowHeight::ofLines(1)) {
    lines.push_back({.name = name, .value = value, .isCut = true});
  } else {
    for (const std::string_view line : wrapText(name, width))
      lines.push_back({.name = line});
    for (const std::string_view line : wrapText(value, width - kIndent))
      lines.push_back({.value = line, .valueIndent = kIndent});
  }
  if (const std::optional<int> fixed = row.height.lines()) {
    const auto count = static_cast<std::size_t>(std::max(*fixed, 1));
    const bool isCut = lines.size() > count;
    lines.resize(count);
    if (isCut) lines.back().isCut = true;
  }
  return lines;
}

}  // namespace vesk
