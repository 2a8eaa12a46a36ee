#pragma once

#include "values/optional_number.h"
#include "values/value.h"

namespace vesk::insight {

/// What a receive chain of UMTS measures of the serving cell.
struct UmtsChain {
  OptionalNumber<double> rscp;
  OptionalNumber<double> ecNo;
  OptionalNumber<double> rssi;
};

/// Ec/N0 is RSCP / RSSI: where the RSCP is not reported, the two tell it.
[[nodiscard]] UmtsChain umtsChainOf(const Dictionary& record);

}  // namespace vesk::insight
