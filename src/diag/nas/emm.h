#pragma once

#include "diag/layout/byte_reader.h"
#include "diag/packet.h"

namespace vesk::diag {

class EventBatch;
struct SimState;

/// Reads a message about the registration with LTE, of one byte at least.
[[nodiscard]] Reading readEmmMessage(ByteSpan message, SimState& sim, EventBatch& events);

}  // namespace vesk::diag
