#include "screens/common_look.h"

#include "toolkit/system_appearance.h"

namespace vesk {

void applyCommonLook(ViewController& screen) {
  constexpr PlatformVersion kFirstWithAppearances{13, 0};
  if (platformVersion() >= kFirstWithAppearances) screen.setBackgroundColor(Color::SystemBackground);
}

}  // namespace vesk
