#include "terminal/panels/overview_layout.h"

#include <algorithm>

namespace vesk {

namespace {

constexpr Size kLeastFramed{60, 14};
constexpr int kWideColumns = 100;
/// From here on cells and happenings stand beside each other.
constexpr int kVeryWideColumns = 160;

/// With their frames.
constexpr int kServingLines = 10;
/// Without the details of the cell.
constexpr int kLeastServingLines = 9;
constexpr int kLeastPane = 6;

/// A row of boxes is divided where this many hundredths of the width are.
void addRow(std::vector<Pane>& panes, Size size, int& line, int lines, PaneKind left, PaneKind right, int hundredths) {
  const int middle = size.columns * hundredths / 100;
  panes.push_back({left, {0, line, middle + 1, lines}});
  panes.push_back({right, {middle, line, size.columns - middle, lines}});
  line += lines - 1;
}

void addBox(std::vector<Pane>& panes, Size size, int& line, int lines, PaneKind kind) {
  panes.push_back({kind, {0, line, size.columns, lines}});
  line += lines - 1;
}

OverviewLayout wideLayout(Size size) {
  OverviewLayout layout;
  int line = 0;
  addRow(layout.panes, size, line, kServingLines, PaneKind::serving, PaneKind::connection, 55);
  const int left = size.lines - line;
  if (size.columns >= kVeryWideColumns) {
    const int lower = std::max(left / 2, std::min(left, kLeastPane));
    if (left - lower + 1 >= kLeastPane) {
      addRow(layout.panes, size, line, left - lower + 1, PaneKind::trend, PaneKind::recent, 80);
    }
    addRow(layout.panes, size, line, size.lines - line, PaneKind::cells, PaneKind::happenings, 60);
    return layout;
  }
  const bool hasCells = left >= 3 * kLeastPane;
  const int trend = std::clamp(left / (hasCells ? 3 : 2), kLeastPane, 24);
  if (left >= 2 * kLeastPane) addRow(layout.panes, size, line, trend, PaneKind::trend, PaneKind::recent, 75);
  if (hasCells) addBox(layout.panes, size, line, (size.lines - line) / 2, PaneKind::cells);
  addBox(layout.panes, size, line, size.lines - line, PaneKind::happenings);
  return layout;
}

OverviewLayout narrowLayout(Size size) {
  OverviewLayout layout;
  int line = 0;
  constexpr int kRoomyLines = 20;
  addBox(layout.panes, size, line, size.lines < kRoomyLines ? kLeastServingLines : kServingLines, PaneKind::serving);
  const int left = size.lines - line;
  if (left >= 4 * kLeastPane + 2) addBox(layout.panes, size, line, kLeastPane + 2, PaneKind::connection);
  const bool hasCells = left >= 4 * kLeastPane;
  const int rest = size.lines - line;
  if (rest >= 2 * kLeastPane - 2) {
    addBox(layout.panes, size, line, rest * (hasCells ? 1 : 3) / (hasCells ? 3 : 5) + 1, PaneKind::trend);
  }
  if (hasCells) addBox(layout.panes, size, line, (size.lines - line) / 2 + 1, PaneKind::cells);
  addBox(layout.panes, size, line, size.lines - line, PaneKind::happenings);
  return layout;
}

}  // namespace

OverviewLayout OverviewLayout::of(Size size) {
  if (size.columns < kLeastFramed.columns || size.lines < kLeastFramed.lines) {
    // Without frames the panes reach beyond the edge, and over the line between them.
    const int serving = std::min(size.lines, kLeastServingLines - 2);
    return {{{PaneKind::serving, {-1, -1, size.columns + 2, serving + 2}},
             {PaneKind::happenings, {-1, serving - 1, size.columns + 2, size.lines - serving + 2}}},
            false};
  }
  return size.columns >= kWideColumns ? wideLayout(size) : narrowLayout(size);
}

}  // namespace vesk
