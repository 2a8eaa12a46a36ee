#pragma once

namespace vesk {

/// From here on SIGINT, SIGTERM and SIGHUP stop the main run loop, which must outlive them.
void stopMainLoopOnSignals();

}  // namespace vesk
