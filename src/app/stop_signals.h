#pragma once

#include "system/wake_up.h"

namespace vesk {

/// From here on SIGINT, SIGTERM and SIGHUP stop the main run loop, which must outlive them. What is returned is
/// signalled for good by the first of them: nobody should be waited for any more.
const WakeUp& stopMainLoopOnSignals();

}  // namespace vesk
