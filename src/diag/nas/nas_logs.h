#pragma once

#include "diag/translation/log_kind.h"

/// The packets of registrations and bearers.
namespace vesk::diag {

/// What the modem has made of its registration with LTE.
[[nodiscard]] Reading readEmmState(const LogPacket& packet, SimState& sim, EventBatch& events);
/// A plain message of LTE's NAS, of either protocol and direction.
[[nodiscard]] Reading readEpsNasMessage(const LogPacket& packet, SimState& sim, EventBatch& events);

/// What the modem has made of its registrations with UMTS and GSM.
[[nodiscard]] Reading readMmState(const LogPacket& packet, SimState& sim, EventBatch& events);
[[nodiscard]] Reading readGmmState(const LogPacket& packet, SimState& sim, EventBatch& events);
/// A message of UMTS's and GSM's NAS, of either direction.
[[nodiscard]] Reading readNasMessage(const LogPacket& packet, SimState& sim, EventBatch& events);

}  // namespace vesk::diag
