#pragma once

#include "toolkit/view_controller.h"

namespace vesk {

/// What every screen does when its view has loaded: on a platform that knows light and dark, it takes the system's
/// background.
void applyCommonLook(ViewController& screen);

}  // namespace vesk
