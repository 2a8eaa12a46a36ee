#pragma once

#include "diag/translation/log_kind.h"

/// The packets of GSM's radio.
namespace vesk::diag {

/// A message of GSM's RR.
[[nodiscard]] Reading readGsmRrMessage(const LogPacket& packet, SimState& sim, EventBatch& events);

[[nodiscard]] Reading readGsmServingCell(const LogPacket& packet, SimState& sim, EventBatch& events);
[[nodiscard]] Reading readGsmServingLevel(const LogPacket& packet, SimState& sim, EventBatch& events);
[[nodiscard]] Reading readGsmNeighbourLevels(const LogPacket& packet, SimState& sim, EventBatch& events);
[[nodiscard]] Reading readGsmNeighbourList(const LogPacket& packet, SimState& sim, EventBatch& events);
[[nodiscard]] Reading readGsmReselection(const LogPacket& packet, SimState& sim, EventBatch& events);

}  // namespace vesk::diag
