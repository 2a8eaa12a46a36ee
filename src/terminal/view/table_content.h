#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "terminal/view/row_layout.h"
#include "toolkit/table_view.h"

namespace vesk {

/// What a table says as of one of its reloads. Rows are asked for when they are needed and kept while they are in view,
/// or until the content follows a later reload.
class TableContent {
 public:
  /// What a row with that name means; empty for nothing more than its value.
  using ReadingOf = std::function<std::string(IndexPath at, std::string_view name)>;

  /// `table` must outlive the content. `readingOf` may be empty.
  explicit TableContent(TableView& table, ReadingOf readingOf = {}) : table_(table), readingOf_(std::move(readingOf)) {}

  [[nodiscard]] bool hasReadings() const { return readingOf_ != nullptr; }
  [[nodiscard]] std::uint64_t reloadCount() const { return reloadCount_; }

  /// Takes over the table's present state. False when it was not reloaded since the last time.
  bool follow();
  /// Asks for every row that was not needed yet.
  void fetchAll();

  [[nodiscard]] std::size_t sectionCount() const { return sections_.size(); }
  [[nodiscard]] std::size_t rowCount(std::size_t section) const { return sections_[section].rows.size(); }
  [[nodiscard]] const std::optional<Text>& header(std::size_t section) const { return sections_[section].header; }
  /// The row must be within the counts.
  const RowContent& row(IndexPath at);
  /// The row's height in lines in a list `columns` wide.
  int height(IndexPath at, int columns);
  /// The same, or the table's estimate for a row that was not needed yet.
  [[nodiscard]] int likelyHeight(IndexPath at) const { return rowAt(at).height; }
  /// The rows from `first` to `last`, both included, are in view: others are asked for again when they are next needed.
  /// False when these were not asked for at one time, and may be of several records: then they are asked for again too.
  /// Not to be called for a content that is held.
  [[nodiscard]] bool keepInView(IndexPath first, IndexPath last);

 private:
  struct Row {
    std::optional<RowContent> content;
    /// An estimate until the row was laid out.
    int height;
    int columnsOfHeight = 0;
    /// Which of times_ it was when the content was asked for.
    std::uint64_t askedAt = 0;
    /// The content is what it was when the row was last in view.
    bool isOutdated = false;
  };
  struct Section {
    std::optional<Text> header;
    std::vector<Row> rows;
  };

  [[nodiscard]] const Row& rowAt(IndexPath at) const { return sections_[at.section].rows[at.row]; }
  [[nodiscard]] Row& rowAt(IndexPath at) { return sections_[at.section].rows[at.row]; }
  [[nodiscard]] RowContent fetch(IndexPath at);
  [[nodiscard]] bool hasChanged(IndexPath at, const RowContent& content) const;

  TableView& table_;
  ReadingOf readingOf_;
  std::uint64_t reloadCount_ = 0;
  /// How often it was said what is in view.
  std::uint64_t times_ = 0;
  std::vector<Section> sections_;
  /// The sections before the last reload; absent before the second one.
  std::optional<std::vector<Section>> previous_;
};

}  // namespace vesk
