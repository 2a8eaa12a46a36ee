#include "toolkit/table_view_controller.h"

#include "toolkit/interface_layout.h"

namespace vesk {

TableViewController::TableViewController() {
  tableView_.setReloadObserver([this] { setNeedsDisplay(); });
}

void TableViewController::loadViewIfNeeded() {
  if (isViewLoaded()) return;
  ViewController::loadViewIfNeeded();
  tableView_.reloadData();
}

void TableViewController::didReceiveMemoryWarning() {
  ViewController::didReceiveMemoryWarning();
  tableView_.drainReusePool();
}

bool TableViewController::selectRow(IndexPath at) {
  if (interfaceLayout() == nullptr) return false;
  const TransitionDeclaration* onSelection = interfaceLayout()->firstTransition(nameInLayout());
  TableViewCell* cell = onSelection != nullptr ? tableView_.cellForRow(at) : nullptr;
  return cell != nullptr && performTransition(onSelection->identifier, cell);
}

void TableViewController::wasMade(const InterfaceLayout& layout, std::string_view name) {
  ViewController::wasMade(layout, name);
  tableView_.declareCells(layout.cells());
}

}  // namespace vesk
