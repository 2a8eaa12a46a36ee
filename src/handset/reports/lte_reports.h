#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "handset/model/radio.h"
#include "messages/lte/lte.h"

/// The LTE metrics as the handset fills them in, without their timestamps.
namespace vesk::handset {

[[nodiscard]] metrics::KCellularLteScellInfo makeLteCellInfo(const LteCell& serving);
/// What the cell broadcasts: the parameters of selection, reselection and access, and the other carriers.
[[nodiscard]] metrics::KCellularLteSelReselCellInfo makeLteSelection(const LteCell& serving);

/// The configuration of connected-mode DRX, or that there is none any more.
[[nodiscard]] metrics::KCellularLteCdrxConfig makeLteDrx(bool isConnected, std::uint32_t transmissionMode);

/// One measurement of the serving cell through both receive chains.
struct LteSample {
  std::uint32_t pci;
  double rsrp[2];
  double rsrq[2];
  double sinr[2];
};
/// The samples of one call, or of idle mode, with their mean; there must be one, and `callId` is empty in idle mode.
[[nodiscard]] metrics::KCellularLteRsrpRsrqSinr makeLteSamples(const std::vector<LteSample>& samples,
                                                               std::uint32_t periodMs, const std::string& callId);
[[nodiscard]] metrics::KCellularLteServingCellMeasurement makeLteServing(const LteSignal& serving, bool isConnected,
                                                                         double secondChainGain);
/// Power control with the path loss that the level shows; a few subframes.
[[nodiscard]] metrics::KCellularLteTxPower makeLteTxPower(const LteSignal& serving, Random& random);

/// The strongest cells besides `serving`, on its frequency and others.
[[nodiscard]] metrics::KCellularLteNbrEutraCellMeas makeLteNeighbours(const Radio& radio, const LteCell& serving);
[[nodiscard]] metrics::KCellularLteNbrInterRatCellMeas makeLteOtherTechnologies(const Radio& radio);

}  // namespace vesk::handset
