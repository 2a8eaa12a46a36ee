#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <span>
#include <string_view>
#include <vector>

#include "toolkit/table_data_source.h"
#include "toolkit/table_view_cell.h"
#include "values/text.h"

namespace vesk {

/// How the cells of one identifier look.
struct CellDeclaration {
  std::string_view identifier;
  CellStyle style = CellStyle::RightDetail;
  CellAccessory accessory = CellAccessory::None;
};

/// Space under the rows, in columns and lines.
struct FooterView {
  int width = 0;
  int height = 0;

  friend bool operator==(const FooterView&, const FooterView&) = default;
};

/// The rows of one screen as of its last reload, and the pool that their cells come from and go back to.
class TableView {
 public:
  /// `source` must outlive the table.
  explicit TableView(TableDataSource& source) : source_(source) {}
  TableView(const TableView&) = delete;
  TableView& operator=(const TableView&) = delete;

  // What a screen calls.

  /// Takes the counts and header titles anew and gives every cell back to the pool.
  void reloadData();
  /// A cell without texts, from the pool or new. An identifier that was not declared gives the plain
  /// CellDeclaration.
  [[nodiscard]] std::unique_ptr<TableViewCell> dequeueReusableCell(std::string_view identifier);
  /// `cells` must outlive the table.
  void declareCells(std::span<const CellDeclaration> cells) { declarations_ = cells; }
  /// `observer` is called after every reload.
  void setReloadObserver(std::function<void()> observer) { reloadObserver_ = std::move(observer); }
  void setFooterView(std::optional<FooterView> footer) { footer_ = footer; }
  /// Lets go of the cells that wait for reuse.
  void drainReusePool() { pool_.clear(); }

  // What draws a table calls.

  /// How often the table was reloaded; 0 before its first content.
  [[nodiscard]] std::uint64_t reloadCount() const { return reloadCount_; }
  [[nodiscard]] std::size_t numberOfSections() const { return sections_.size(); }
  /// 0 for a section that does not exist.
  [[nodiscard]] std::size_t numberOfRows(std::size_t section) const;
  /// Absent for a section that has none or does not exist.
  [[nodiscard]] std::optional<Text> headerTitle(std::size_t section) const;
  [[nodiscard]] const std::optional<FooterView>& footerView() const { return footer_; }

  /// The cell of a row that comes into view, asked for unless it is in view already. Null for a row that was
  /// not counted and where the source gives none. Valid until the row leaves the view or the next reload.
  TableViewCell* cellForRow(IndexPath at);
  [[nodiscard]] RowHeight rowHeight(IndexPath at) { return source_.rowHeight(at); }
  [[nodiscard]] RowHeight estimatedRowHeight(IndexPath at) { return source_.estimatedRowHeight(at); }
  /// The rows from `first` to `last`, both included, are in view: cells of others go back to the pool.
  void keepInView(IndexPath first, IndexPath last);
  /// No row is in view: each is asked for again when it is next needed.
  void letGoOfCells();

 private:
  struct Section {
    std::optional<Text> header;
    std::size_t rows;
  };
  using CellsInView = std::map<IndexPath, std::unique_ptr<TableViewCell>>;

  void recycle(std::unique_ptr<TableViewCell> cell);
  [[nodiscard]] CellDeclaration declarationOf(std::string_view identifier) const;

  TableDataSource& source_;
  std::span<const CellDeclaration> declarations_;
  std::vector<Section> sections_;
  std::uint64_t reloadCount_ = 0;
  std::function<void()> reloadObserver_;
  std::optional<FooterView> footer_;
  CellsInView inView_;
  std::vector<std::unique_ptr<TableViewCell>> pool_;
};

}  // namespace vesk
