#pragma once

#include "diag/layout/byte_reader.h"
#include "diag/packet.h"

namespace vesk::diag {

class EventBatch;
struct SimState;

/// Each reads a message from its first byte on, which on the broadcast channel is its length.
[[nodiscard]] Reading readSystemInformation3(ByteSpan message, SimState& sim, EventBatch& events);
[[nodiscard]] Reading readSystemInformation13(ByteSpan message, SimState& sim, EventBatch& events);
[[nodiscard]] Reading readGsmMeasurementReport(ByteSpan message, SimState& sim, EventBatch& events);

}  // namespace vesk::diag
