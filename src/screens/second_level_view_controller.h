#pragma once

#include <memory>
#include <optional>
#include <string_view>

#include "intake/metric_validator.h"
#include "screens/category_sources.h"
#include "screens/vesk_view_items.h"
#include "system/timer.h"
#include "toolkit/table_view_controller.h"
#include "values/text.h"

namespace vesk {

/// The latest values of one category, read afresh by every callback and as a whole every 5 seconds.
class SecondLevelViewController : public TableViewController,
                                  public std::enable_shared_from_this<SecondLevelViewController> {
 public:
  /// The area and the category; set by the first level screen. Without them nothing is known to show.
  std::optional<Text> firstSelection;
  std::optional<Text> seguedThroughRow;

  /// Schedules one reload of the table on the main queue: what the timer does.
  void update();

  void viewDidLoad() override;
  void didLeaveNavigationStack() override;
  std::size_t numberOfSections() override;
  std::optional<Text> headerTitle(std::size_t section) override;
  std::size_t numberOfRows(std::size_t section) override;
  std::unique_ptr<TableViewCell> cellForRow(IndexPath at) override;
  RowHeight rowHeight(IndexPath /*at*/) override { return RowHeight::automatic(); }
  RowHeight estimatedRowHeight(IndexPath /*at*/) override { return RowHeight::automatic(); }

 private:
  [[nodiscard]] const CategorySource& source() const;
  /// The record that a section shows; absent when there is none, or none any more.
  [[nodiscard]] std::optional<Record> recordOf(std::size_t section) const;

  const VeskViewItems tableViewFields;
  const std::shared_ptr<MetricValidator> myMetricValidator = MetricValidator::shared();
  std::optional<Timer> refreshTimer_;
};

}  // namespace vesk
