#pragma once

#include <optional>
#include <string>
#include <vector>

#include "toolkit/table_view_controller.h"

namespace vesk {

/// A table screen whose content a test states and changes, and which counts what it is asked for.
class FakeTableScreen : public TableViewController {
 public:
  struct Row {
    std::optional<Text> main;
    std::optional<Text> detail;
  };
  struct Section {
    std::optional<Text> header;
    std::vector<Row> rows;
  };

  std::vector<Section> content;
  std::string identifier = "SecondClickView";
  RowHeight height = RowHeight::automatic();

  int sectionCounts = 0;
  int rowCounts = 0;
  int cellRequests = 0;
  int loads = 0;
  int departures = 0;

  static Row row(std::string_view main, std::string_view detail) { return {Text::copy(main), Text::copy(detail)}; }

  void viewDidLoad() override {
    TableViewController::viewDidLoad();
    ++loads;
  }
  void didLeaveNavigationStack() override { ++departures; }

  std::size_t numberOfSections() override {
    ++sectionCounts;
    return content.size();
  }
  std::optional<Text> headerTitle(std::size_t section) override { return content[section].header; }
  std::size_t numberOfRows(std::size_t section) override {
    ++rowCounts;
    return content[section].rows.size();
  }
  /// Null for a row that the content no longer has.
  std::unique_ptr<TableViewCell> cellForRow(IndexPath at) override {
    ++cellRequests;
    if (at.section >= content.size() || at.row >= content[at.section].rows.size()) return nullptr;
    const Row& row = content[at.section].rows[at.row];
    std::unique_ptr<TableViewCell> cell = tableView().dequeueReusableCell(identifier);
    if (row.main) cell->setMainText(row.main);
    if (row.detail) cell->setDetailText(row.detail);
    return cell;
  }
  RowHeight rowHeight(IndexPath /*at*/) override { return height; }
  RowHeight estimatedRowHeight(IndexPath /*at*/) override { return height; }
};

}  // namespace vesk
