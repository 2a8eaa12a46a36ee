#pragma once

#include "diag/translation/log_kind.h"

/// The packets of UMTS's radio.
namespace vesk::diag {

[[nodiscard]] Reading readUmtsServingCell(const LogPacket& packet, SimState& sim, EventBatch& events);
[[nodiscard]] Reading readUmtsRrcState(const LogPacket& packet, SimState& sim, EventBatch& events);
/// UMTS and GSM cells in the order in which the modem would choose them.
[[nodiscard]] Reading readUmtsRankedCells(const LogPacket& packet, SimState& sim, EventBatch& events);
[[nodiscard]] Versions umtsRankedCellVersions();

}  // namespace vesk::diag
