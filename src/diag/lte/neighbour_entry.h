#pragma once

#include <cstdint>

#include "messages/lte/lte.h"

namespace vesk::diag {

/// Adds a neighbour with its raw levels, unless it has no RSRP.
void addLteNeighbour(metrics::KCellularLteNbrEutraCellMeas& report, std::uint32_t earfcn, std::uint32_t pci,
                     std::uint32_t rawRsrp, std::uint32_t rawRsrq);

}  // namespace vesk::diag
