#include "toolkit/table_view.h"

#include <gtest/gtest.h>

#include "support/fake_table_screen.h"

namespace vesk {
namespace {

FakeTableScreen::Section sectionOf(std::optional<Text> header, int rows) {
  FakeTableScreen::Section section{std::move(header), {}};
  for (int row = 0; row < rows; ++row)
    section.rows.push_back(FakeTableScreen::row("name" + std::to_string(row), "value"));
  return section;
}

TEST(TableView, TakesCountsAndHeadersOncePerReloadAndCellsOnlyInView) {
  FakeTableScreen screen;
  screen.content = {sectionOf("PDP 0"_text, 3), sectionOf(std::nullopt, 5)};
  screen.loadViewIfNeeded();
  screen.loadViewIfNeeded();
  TableView& table = screen.tableView();
  EXPECT_EQ(screen.loads, 1);
  EXPECT_EQ(table.reloadCount(), 1U);

  EXPECT_EQ(table.numberOfSections(), 2U);
  EXPECT_EQ(table.numberOfRows(1), 5U);
  EXPECT_EQ(table.numberOfRows(2), 0U);
  EXPECT_EQ(table.headerTitle(0), "PDP 0"_text);
  EXPECT_EQ(table.headerTitle(1), std::nullopt);
  EXPECT_EQ(screen.sectionCounts, 1);
  EXPECT_EQ(screen.rowCounts, 2);
  EXPECT_EQ(screen.cellRequests, 0);

  const TableViewCell* cell = table.cellForRow({1, 4});
  ASSERT_NE(cell, nullptr);
  EXPECT_EQ(cell->mainText(), "name4"_text);
  EXPECT_EQ(table.cellForRow({1, 4}), cell);
  EXPECT_EQ(screen.cellRequests, 1);
}

TEST(TableView, AsksForNoCellThatWasNotCountedAndCopesWithNullOnes) {
  FakeTableScreen screen;
  screen.content = {sectionOf(std::nullopt, 2)};
  screen.loadViewIfNeeded();
  EXPECT_EQ(screen.tableView().cellForRow({0, 2}), nullptr);
  EXPECT_EQ(screen.tableView().cellForRow({1, 0}), nullptr);
  EXPECT_EQ(screen.cellRequests, 0);

  screen.content.clear();
  EXPECT_EQ(screen.tableView().cellForRow({0, 1}), nullptr);
  EXPECT_EQ(screen.cellRequests, 1);
}

TEST(TableView, ReusesCellsOfTheSameIdentifierWithTheirTextsReset) {
  FakeTableScreen screen;
  screen.content = {sectionOf(std::nullopt, 3)};
  screen.loadViewIfNeeded();
  TableView& table = screen.tableView();
  const TableViewCell* first = table.cellForRow({0, 0});
  const TableViewCell* second = table.cellForRow({0, 1});

  screen.content[0].rows[2] = {};
  table.keepInView({0, 1}, {0, 2});
  const TableViewCell* reused = table.cellForRow({0, 2});
  EXPECT_EQ(reused, first);
  EXPECT_EQ(reused->mainText(), std::nullopt);
  EXPECT_EQ(reused->detailText(), std::nullopt);
  EXPECT_EQ(table.cellForRow({0, 1}), second);

  table.reloadData();
  const std::unique_ptr<TableViewCell> other = table.dequeueReusableCell("LaunchView");
  EXPECT_NE(other.get(), first);
  EXPECT_NE(other.get(), second);
}

}  // namespace
}  // namespace vesk
