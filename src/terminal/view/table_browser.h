#pragma once

#include <algorithm>
#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "terminal/device/grid.h"
#include "terminal/view/table_content.h"
#include "toolkit/table_view_controller.h"

namespace vesk {

/// One line of a list as it shows. The views are good until the browser is next told anything.
struct ListLine {
  bool isHeader = false;
  /// The header, or the row's name and value.
  RowLine text;
  /// Whether this is the line of a row that bears its marks.
  bool isFirstOfRow = false;
  bool isSelected = false;
  bool isChanged = false;
  bool hasDisclosure = false;
  /// What stands at the right of a row without a value.
  std::string note{};
};

/// The part of a long list that shows, in lines.
struct ScrollExtent {
  int before = 0;
  int shown = 0;
  int total = 0;

  /// The lines of the thumb on a bar of `height` lines, and the first of them. There must be more than shows.
  [[nodiscard]] int thumb(int height) const { return std::max(height * shown / total, 1); }
  [[nodiscard]] int thumbStart(int height) const {
    const int travel = height - thumb(height);
    const int hidden = total - shown;
    return std::clamp((travel * before + hidden / 2) / hidden, 0, travel);
  }
};

/// A way through one screen's table: what of it shows in a viewport, which row is selected, which rows pass a
/// filter. Only rows that show are asked for, unless a filter or a freeze needs them all.
class TableBrowser {
 public:
  /// `screen` must outlive the browser. `readingOf` may be empty.
  explicit TableBrowser(TableViewController& screen, TableContent::ReadingOf readingOf = {})
      : screen_(screen), content_(screen.tableView(), std::move(readingOf)) {}

  [[nodiscard]] TableViewController& screen() const { return screen_; }

  void setViewport(Size size);
  /// Takes over what the table was last reloaded with, unless frozen.
  void follow();
  /// The reload of the table whose rows show.
  [[nodiscard]] std::uint64_t reloadCount() const { return content_.reloadCount(); }
  void setFrozen(bool isFrozen);
  [[nodiscard]] bool isFrozen() const { return isFrozen_; }
  /// Shows only rows whose name, value or section header has `filter` in it, in either case; all when empty.
  void setFilter(std::string filter);
  [[nodiscard]] const std::string& filter() const { return filter_; }

  /// One row down for +1, up for -1; a row taller than the viewport is walked through line by line.
  void moveSelection(int step);
  void selectFirst();
  void selectLast();
  /// The first row after the next header; after the last header, the first row.
  void selectNextSection();
  /// By lines; the selection stays within what shows.
  void scroll(int lines);
  /// So that the thumb of a scroll bar of `height` lines is around the bar's `line`, which may lie beyond its ends.
  void scrollTo(int line, int height);
  /// By almost a viewport; at an end, to the last or first row.
  void page(int direction);

  [[nodiscard]] std::optional<IndexPath> selection() const { return selection_; }
  /// The name in the selected row.
  [[nodiscard]] std::optional<Text> selectedName();
  /// Selects the row that shows in a line of the viewport; false when none does.
  bool selectLine(int line);

  /// The lines that show, from the top of the viewport; also tells the table which rows are in view.
  [[nodiscard]] std::vector<ListLine> lines(bool withReadings = true);
  [[nodiscard]] ScrollExtent scrollExtent() const;

 private:
  /// A line of header or a row, in the order of the list.
  struct Entry {
    IndexPath at;
    bool isRow;

    // NOLINTNEXTLINE(modernize-use-nullptr): the comparison with 0 is the compiler's own
    friend auto operator<=>(const Entry&, const Entry&) = default;
  };
  /// A line of the list: the line within an entry.
  struct Position {
    std::size_t entry = 0;
    int line = 0;

    // NOLINTNEXTLINE(modernize-use-nullptr): as above
    friend auto operator<=>(const Position&, const Position&) = default;
  };

  void rebuild();
  [[nodiscard]] bool passesFilter(IndexPath at);
  [[nodiscard]] int height(std::size_t entry);
  [[nodiscard]] Position moved(Position from, int lines);
  [[nodiscard]] std::size_t selectedEntry() const;
  [[nodiscard]] std::optional<std::size_t> nextRow(std::size_t entry, int step) const;
  void select(std::size_t entry);
  void clampTop();
  void showSelection();
  [[nodiscard]] bool isSelectionInView();
  void keepSelectionInView();

  TableViewController& screen_;
  TableContent content_;
  Size size_;
  bool isFrozen_ = false;
  std::string filter_;
  std::vector<Entry> entries_;
  Position top_;
  std::optional<IndexPath> selection_;
};

}  // namespace vesk
