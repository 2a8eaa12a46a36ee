#pragma once

#include "system/wake_up.h"

namespace vesk {

/// Makes SIGINT, SIGTERM and SIGHUP stop the main run loop, from now on. Returns what the first such signal wakes. It
/// stays signalled: whoever waits for a slow reader gives up then.
const WakeUp& stopMainLoopOnSignals();

}  // namespace vesk
