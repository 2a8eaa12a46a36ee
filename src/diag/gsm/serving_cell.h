#pragma once

#include <cstdint>
#include <optional>

#include "diag/layout/values.h"
#include "diag/translation/sim_state.h"

namespace vesk::diag {

class EventBatch;

/// Who a GSM cell is.
struct GsmCellIdentity {
  PlmnDigits network;
  std::uint32_t lac;
  std::uint32_t cellId;
};

/// Adds the cell as the serving one, with the channel and BSIC of `lastCell` where it is that one.
void addGsmServingCell(const GsmCellIdentity& identity, const std::optional<GsmCell>& lastCell, EventBatch& events);

}  // namespace vesk::diag
