#pragma once

#include "handset/model/radio.h"
#include "messages/gsm/gsm.h"

/// The GSM metrics as the handset fills them in, without their timestamps.
namespace vesk::handset {

[[nodiscard]] metrics::KCellularGsmScellInfo makeGsmCellInfo(const GsmCell& serving, bool isDedicated);
/// What the cell broadcasts: system information 3 and 4, and that of GPRS.
[[nodiscard]] metrics::KCellularGsmIdleConfig makeGsmIdleConfig(const GsmCell& serving, bool isDedicated);
[[nodiscard]] metrics::KCellularGsmGprsConfig makeGprsConfig();

[[nodiscard]] metrics::KCellularGsmIdleScellMeasurement makeGsmIdle(const GsmSignal& serving, Random& random);
/// The last measurement period of a call: the level, the quality and the powers of four bursts.
[[nodiscard]] metrics::KCellularGsmCsRfMeasurement makeGsmDedicated(const GsmSignal& serving, Random& random);
[[nodiscard]] metrics::KCellularGsmGrrEventMeasCr makeGsmNeighbours(const Radio& radio, const GsmCell& serving);

}  // namespace vesk::handset
