#pragma once

#include "toolkit/table_data_source.h"
#include "toolkit/table_view.h"
#include "toolkit/view_controller.h"

namespace vesk {

/// A screen that is a table. A concrete one overrides the callbacks of TableDataSource; without overrides it
/// is an empty table of rows of the standard height.
class TableViewController : public ViewController, public TableDataSource {
 public:
  TableViewController();

  [[nodiscard]] TableView& tableView() { return tableView_; }

  /// Loads the table's content after the view has loaded.
  void loadViewIfNeeded() override;
  void didReceiveMemoryWarning() override;

  /// The user chose a row: runs the first transition that the layout declares from this screen, with the
  /// row's cell as its sender. False when there is none, or no cell at that place.
  bool selectRow(IndexPath at);

  std::size_t numberOfSections() override { return 1; }
  std::optional<Text> headerTitle(std::size_t /*section*/) override { return std::nullopt; }
  std::size_t numberOfRows(std::size_t /*section*/) override { return 0; }
  std::unique_ptr<TableViewCell> cellForRow(IndexPath /*at*/) override { return nullptr; }
  RowHeight rowHeight(IndexPath /*at*/) override { return RowHeight::standard(); }
  RowHeight estimatedRowHeight(IndexPath at) override { return rowHeight(at); }

 protected:
  void wasMade(const InterfaceLayout& layout, std::string_view name) override;

 private:
  TableView tableView_{*this};
};

}  // namespace vesk
