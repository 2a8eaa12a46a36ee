#pragma once

#include <memory>
#include <optional>

#include "intake/metric_validator.h"
#include "screens/vesk_view_items.h"
#include "toolkit/table_view_controller.h"
#include "values/text.h"

namespace vesk {

/// The categories of one area. Without an area, or with an unknown one, it has no rows.
class FirstLevelViewController : public TableViewController {
 public:
  /// The area; set by the launch screen.
  std::optional<Text> seguedThroughRow;

  void viewDidLoad() override;
  std::size_t numberOfSections() override { return 1; }
  std::size_t numberOfRows(std::size_t section) override;
  std::unique_ptr<TableViewCell> cellForRow(IndexPath at) override;
  void prepareForTransition(const Transition& transition, Responder* sender) override;

 private:
  [[nodiscard]] const std::vector<Text>& categories() const;

  const VeskViewItems tableViewFields;
  const std::shared_ptr<MetricValidator> myMetricValidator = MetricValidator::shared();
};

}  // namespace vesk
