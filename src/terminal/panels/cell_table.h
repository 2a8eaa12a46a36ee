#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "insight/present.h"
#include "terminal/panels/canvas.h"

namespace vesk {

/// By which column cells are in order.
struct CellOrder {
  std::size_t column;
  bool isFalling;
};

/// What is said of cells beside their figures.
class CellNotes {
 public:
  /// Of the cells that are heard on `drive`.
  CellNotes(const insight::Present& drive, const std::vector<insight::HeardCell>& cells);

  /// "serving", "re-established 4.0 s ago", "served 15.0 s ago", "best quality"; the first of these that is so, or
  /// nothing.
  [[nodiscard]] std::string of(const insight::HeardCell& cell) const;

 private:
  struct Entered {
    insight::HeardKey cell;
    std::int64_t ago;
  };

  /// By re-establishments, latest first.
  std::vector<Entered> reestablished_;
  /// The best of each technology, where that is not the one that serves.
  std::vector<insight::HeardKey> best_;
};

/// The table of the cells heard: its columns as far as there is room for them.
class CellTable {
 public:
  /// For canvases of that width.
  explicit CellTable(int columns);

  /// The heads, on the first line; the column of `order` bears an arrow.
  void drawHeads(const Canvas& canvas, const std::optional<CellOrder>& order) const;
  void drawRow(const Canvas& canvas, int line, const insight::HeardCell& cell, const CellNotes& notes,
               bool isSelected) const;

  /// The table's column at a column of the canvas.
  [[nodiscard]] std::optional<std::size_t> columnAt(int column) const;

 private:
  struct Place {
    std::size_t column;
    int start;
    int end;
  };

  std::vector<Place> places_;
};

/// By a column, in the direction that is natural to it: the strongest first.
[[nodiscard]] CellOrder naturalOrder(std::size_t column);
/// The order after that one: by the next column that can be sorted by; absent after the last.
[[nodiscard]] std::optional<CellOrder> orderAfter(const std::optional<CellOrder>& order);

/// Cells that are alike stay as they were; what is unknown comes last.
void sortCells(std::vector<insight::HeardCell>& cells, const CellOrder& order);

}  // namespace vesk
