#include "screens/first_level_view_controller.h"

#include "screens/common_look.h"
#include "screens/second_level_view_controller.h"

namespace vesk {

const std::vector<Text>& FirstLevelViewController::categories() const {
  return tableViewFields.categoriesOf(seguedThroughRow ? seguedThroughRow->view() : std::string_view{});
}

void FirstLevelViewController::viewDidLoad() {
  TableViewController::viewDidLoad();
  applyCommonLook(*this);
}

std::size_t FirstLevelViewController::numberOfRows(std::size_t /*section*/) {
  return categories().size();
}

std::unique_ptr<TableViewCell> FirstLevelViewController::cellForRow(IndexPath at) {
  auto cell = tableView().dequeueReusableCell("FirstClickView");
  if (at.row < categories().size()) cell->setMainText(categories()[at.row]);
  return cell;
}

void FirstLevelViewController::prepareForTransition(const Transition& transition, Responder* sender) {
  const auto* cell = dynamic_cast<TableViewCell*>(sender);
  auto* destination = dynamic_cast<SecondLevelViewController*>(&transition.destination);
  if (cell == nullptr || destination == nullptr) return;
  destination->firstSelection = seguedThroughRow;
  destination->seguedThroughRow = cell->mainText();
}

}  // namespace vesk
