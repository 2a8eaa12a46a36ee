#pragma once

#include "diag/translation/log_kind.h"

/// The packets of LTE's radio.
namespace vesk::diag {

[[nodiscard]] Reading readLteServingCell(const LogPacket& packet, SimState& sim, EventBatch& events);
[[nodiscard]] Versions lteServingCellVersions();

/// While connected, all cells that the modem serves or measures as one.
[[nodiscard]] Reading readLteServingMeasurement(const LogPacket& packet, SimState& sim, EventBatch& events);
[[nodiscard]] Versions lteServingMeasurementVersions();
[[nodiscard]] Reading readLteIdleServingMeasurement(const LogPacket& packet, SimState& sim, EventBatch& events);
[[nodiscard]] Versions lteIdleServingMeasurementVersions();

[[nodiscard]] Reading readLteFilteredNeighbours(const LogPacket& packet, SimState& sim, EventBatch& events);
[[nodiscard]] Versions lteFilteredNeighbourVersions();
[[nodiscard]] Reading readLteMeasuredNeighbours(const LogPacket& packet, SimState& sim, EventBatch& events);
[[nodiscard]] Versions lteMeasuredNeighbourVersions();
[[nodiscard]] Reading readLteIdleMeasuredNeighbours(const LogPacket& packet, SimState& sim, EventBatch& events);
[[nodiscard]] Versions lteIdleMeasuredNeighbourVersions();
[[nodiscard]] Reading readLteIdleNeighbours(const LogPacket& packet, SimState& sim, EventBatch& events);
[[nodiscard]] Versions lteIdleNeighbourVersions();

[[nodiscard]] Reading readLtePuschPower(const LogPacket& packet, SimState& sim, EventBatch& events);
[[nodiscard]] Versions ltePuschPowerVersions();
[[nodiscard]] Reading readLtePucchPower(const LogPacket& packet, SimState& sim, EventBatch& events);
[[nodiscard]] Versions ltePucchPowerVersions();
[[nodiscard]] Reading readLtePuschPowerControl(const LogPacket& packet, SimState& sim, EventBatch& events);
[[nodiscard]] Versions ltePuschPowerControlVersions();
[[nodiscard]] Reading readLtePucchPowerControl(const LogPacket& packet, SimState& sim, EventBatch& events);
[[nodiscard]] Versions ltePucchPowerControlVersions();

[[nodiscard]] Reading readLteRrcMessage(const LogPacket& packet, SimState& sim, EventBatch& events);
[[nodiscard]] Versions lteRrcMessageVersions();

}  // namespace vesk::diag
