#include "screens/vesk_view_controller.h"

#include "screens/common_look.h"
#include "screens/first_level_view_controller.h"
#include "screens/vesk_view_items.h"

namespace vesk {

void VeskViewController::viewDidLoad() {
  TableViewController::viewDidLoad();
  applyCommonLook(*this);
  tableView().setFooterView(FooterView{0, 0});
}

std::size_t VeskViewController::numberOfRows(std::size_t /*section*/) {
  return VeskViewItems::shared().launchViewItemNames.size();
}

std::unique_ptr<TableViewCell> VeskViewController::cellForRow(IndexPath at) {
  auto cell = tableView().dequeueReusableCell("LaunchView");
  const auto& names = VeskViewItems::shared().launchViewItemNames;
  if (at.row < names.size()) cell->setMainText(names[at.row]);
  return cell;
}

void VeskViewController::prepareForTransition(const Transition& transition, Responder* sender) {
  const auto* cell = dynamic_cast<TableViewCell*>(sender);
  auto* destination = dynamic_cast<FirstLevelViewController*>(&transition.destination);
  if (cell == nullptr || destination == nullptr) return;
  destination->seguedThroughRow = cell->mainText();
}

}  // namespace vesk
