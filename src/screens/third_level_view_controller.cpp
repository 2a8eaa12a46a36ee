#include "screens/third_level_view_controller.h"

#include "screens/common_look.h"

namespace vesk {

void ThirdLevelViewController::viewDidLoad() {
  TableViewController::viewDidLoad();
  applyCommonLook(*this);
}

std::unique_ptr<TableViewCell> ThirdLevelViewController::cellForRow(IndexPath /*at*/) {
  return tableView().dequeueReusableCell("ThirdClickView");
}

}  // namespace vesk
