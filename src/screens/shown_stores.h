#pragma once

#include "intake/stores.h"

namespace vesk {

/// What the screens show: the intake's stores as they are, or as they were when they were held. Main queue only.
[[nodiscard]] const Stores& shownStores();

/// Holds what shows as it is now; the intake goes on.
void holdShownStores();
void releaseShownStores();

}  // namespace vesk
