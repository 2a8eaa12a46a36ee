#include "app/program/vesk_interface.h"

#include "app/program/root_navigation_controller.h"
#include "screens/first_level_view_controller.h"
#include "screens/second_level_view_controller.h"
#include "screens/third_level_view_controller.h"
#include "screens/vesk_view_controller.h"

namespace vesk {

const InterfaceLayout& veskInterface() {
  static const InterfaceLayout theLayout({
      .rootStack = makeStackOf<RootNavigationController>,
      .firstScreen = "Launch",
      .screens =
          {
              {"Launch", makeScreenOf<VeskViewController>, "Vesk"},
              {"FirstLevel", makeScreenOf<FirstLevelViewController>, {}},
              {"SecondLevel", makeScreenOf<SecondLevelViewController>, {}},
              {"ThirdLevel", makeScreenOf<ThirdLevelViewController>, {}},
          },
      .cells =
          {
              {"LaunchView", CellStyle::Basic, CellAccessory::Disclosure},
              {"FirstClickView", CellStyle::Basic, CellAccessory::Disclosure},
              {"SecondClickView", CellStyle::RightDetail, CellAccessory::None},
              {"ThirdClickView", CellStyle::RightDetail, CellAccessory::None},
          },
      .transitions =
          {
              {"Launch", "showCategories", "FirstLevel"},
              {"FirstLevel", "showValues", "SecondLevel"},
          },
  });
  return theLayout;
}

}  // namespace vesk
