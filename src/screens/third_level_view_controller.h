#pragma once

#include <optional>

#include "screens/vesk_view_items.h"
#include "toolkit/table_view_controller.h"
#include "values/text.h"

namespace vesk {

/// Reserved for the details of one field: it shows one empty row, and no screen leads to it yet.
class ThirdLevelViewController : public TableViewController {
 public:
  /// The way here: area, category and field.
  std::optional<Text> firstSelection;
  std::optional<Text> secondSelection;
  std::optional<Text> seguedThroughRow;

  void viewDidLoad() override;
  std::size_t numberOfSections() override { return 1; }
  std::size_t numberOfRows(std::size_t /*section*/) override { return 1; }
  std::unique_ptr<TableViewCell> cellForRow(IndexPath at) override;

 private:
  const VeskViewItems tableViewFields;
};

}  // namespace vesk
