#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "toolkit/table_data_source.h"
#include "toolkit/table_view_cell.h"
#include "values/text.h"

namespace vesk {

/// What a row says, copied from its cell. Texts are absent where the cell's are, or where there was no cell.
struct RowContent {
  std::optional<Text> main;
  std::optional<Text> detail;
  /// What the detail text means; empty for nothing more.
  std::string reading;
  CellAccessory accessory = CellAccessory::None;
  RowHeight height = RowHeight::standard();
  /// Whether the detail text is another one than before the last reload.
  bool isChanged = false;
};

/// One line of a row. The views are those of the row's texts.
struct RowLine {
  std::string_view name{};
  std::string_view value{};
  std::string_view reading{};
  /// The columns before a value that stands below its name; a value beside its name is at the right instead.
  std::optional<int> valueIndent{};
  /// Where a value beside its name ends, and the column of the readings begins two columns later; absent for the end of
  /// the row.
  std::optional<int> valueEnd{};
  /// The row has more text than lines.
  bool isCut = false;

  [[nodiscard]] RowLine withoutReading() const {
    RowLine line = *this;
    line.reading = {};
    return line;
  }
};

/// The columns before a row's texts, where the mark of a change stands.
inline constexpr int kRowGutter = 2;
/// The column where a row's texts end: a margin, or the disclosure mark between two, come after.
[[nodiscard]] constexpr int rowTextEnd(int columns, bool hasDisclosure) {
  return columns - (hasDisclosure ? 3 : 1);
}

inline constexpr int kRowGap = 2;
/// A value further from its name would be torn from it; long values and readings take the columns beyond.
inline constexpr int kWidestPair = 100;
/// Where values end in a list that has a column of readings too; absent in one that is too narrow for it.
[[nodiscard]] std::optional<int> valueEndBesideReadings(int columns);

/// A row of a list `columns` wide: name and value on one line where they fit, else the value below, indented
/// and wrapped. A fixed height cuts the row or fills it up. With `valueEnd` a value that fits before it ends there, and
/// its reading stands behind where that fits; the height is the same.
[[nodiscard]] std::vector<RowLine> layOutRow(const RowContent& row, int columns,
                                             std::optional<int> valueEnd = std::nullopt);

}  // namespace vesk
