#pragma once

#include <compare>
#include <cstddef>
#include <memory>
#include <optional>

#include "toolkit/table_view_cell.h"
#include "values/text.h"

namespace vesk {

/// A row's place in a table.
struct IndexPath {
  std::size_t section = 0;
  std::size_t row = 0;

  // NOLINTNEXTLINE(modernize-use-nullptr): the comparison with 0 is the compiler's own
  friend auto operator<=>(const IndexPath&, const IndexPath&) = default;
};

/// How tall a row is: a number of text lines, or as many as its texts need.
class RowHeight {
 public:
  static constexpr RowHeight automatic() { return RowHeight(std::nullopt); }
  /// `count` is at least 1.
  static constexpr RowHeight ofLines(int count) { return RowHeight(count); }
  /// What rows have unless their screen says otherwise: one line.
  static constexpr RowHeight standard() { return ofLines(1); }

  [[nodiscard]] constexpr bool isAutomatic() const { return !lines_; }
  /// The number of lines; absent when automatic.
  [[nodiscard]] constexpr std::optional<int> lines() const { return lines_; }

  friend bool operator==(const RowHeight&, const RowHeight&) = default;

 private:
  constexpr explicit RowHeight(std::optional<int> lines) : lines_(lines) {}

  std::optional<int> lines_;
};

/// Where a table takes its content from. Counts and header titles are asked for once per reload, in the order
/// below; cells and heights only for rows that come into view. The content may have shrunk since it was
/// counted: a row that is no more gives an empty cell or null, never an error.
class TableDataSource {
 public:
  virtual std::size_t numberOfSections() = 0;
  /// The text above a section; absent for none.
  virtual std::optional<Text> headerTitle(std::size_t section) = 0;
  virtual std::size_t numberOfRows(std::size_t section) = 0;
  /// A cell from the table's reuse pool with its texts set.
  virtual std::unique_ptr<TableViewCell> cellForRow(IndexPath at) = 0;
  virtual RowHeight rowHeight(IndexPath at) = 0;
  /// The height that is assumed of a row until it comes into view.
  virtual RowHeight estimatedRowHeight(IndexPath at) = 0;

 protected:
  ~TableDataSource() = default;
};

}  // namespace vesk
