#pragma once

#include "handset/model/radio.h"
#include "messages/wcdma/wcdma.h"

/// The UMTS metrics as the handset fills them in, without their timestamps.
namespace vesk::handset {

[[nodiscard]] metrics::KCellularWcdmaCellInfo makeUmtsCellInfo(const UmtsCell& serving);
/// What the cell broadcasts for selection and reselection, with the levels above the least ones.
[[nodiscard]] metrics::KCellularWcdmaSelReselCellInfo makeUmtsSelection(const Radio& radio, const UmtsSignal& serving);
[[nodiscard]] metrics::KCellularWcdmaRrcConfiguration makeUmtsConfiguration(bool isConnected);

[[nodiscard]] metrics::KCellularWcdmaScellMeasurement makeUmtsServing(const UmtsSignal& serving, bool isConnected);
/// Power control with the path loss that the level shows. The entries carry the control channel's power as PUCCH and
/// the whole power as PUSCH.
[[nodiscard]] metrics::KCellularWcdmaTxPower makeUmtsTxPower(const UmtsSignal& serving, Random& random);
[[nodiscard]] metrics::KCellularWcdmaNbrCellMeas makeUmtsNeighbours(const Radio& radio, const UmtsCell& serving);

}  // namespace vesk::handset
