#pragma once

#include "toolkit/table_view_controller.h"

namespace vesk {

/// The launch screen: the areas.
class VeskViewController : public TableViewController {
 public:
  void viewDidLoad() override;
  std::size_t numberOfSections() override { return 1; }
  std::size_t numberOfRows(std::size_t section) override;
  std::unique_ptr<TableViewCell> cellForRow(IndexPath at) override;
  void prepareForTransition(const Transition& transition, Responder* sender) override;
};

}  // namespace vesk
