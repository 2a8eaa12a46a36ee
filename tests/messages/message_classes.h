#pragma once

#include <array>
#include <cstdint>
#include <memory>
#include <span>
#include <string_view>

#include "messages/gsm/gsm.h"
#include "messages/lte/lte.h"
#include "messages/nas/nas.h"
#include "messages/wcdma/wcdma.h"

namespace vesk {

/// A message class with the operations that its base does not have.
struct MessageClass {
  std::string_view name;
  std::shared_ptr<ProtoCodable> (*decode)(std::span<const std::uint8_t> payload);
  std::shared_ptr<ProtoCodable> (*deepCopy)(const ProtoCodable& message);
  void (*copyTo)(const ProtoCodable& from, ProtoCodable& to);
  void (*merge)(const ProtoCodable& from, ProtoCodable& into);
};

template <class... M>
constexpr std::array<MessageClass, sizeof...(M)> messageClasses() {
  using Base = ProtoCodable;
  return {MessageClass{
      M::kClassName,
      [](std::span<const std::uint8_t> payload) -> std::shared_ptr<Base> { return M::initWithData(payload); },
      [](const Base& message) -> std::shared_ptr<Base> { return dynamic_cast<const M&>(message).copyWithZone(); },
      [](const Base& from, Base& to) { dynamic_cast<const M&>(from).copyTo(dynamic_cast<M&>(to)); },
      [](const Base& from, Base& into) { dynamic_cast<M&>(into).mergeFrom(dynamic_cast<const M&>(from)); },
  }...};
}

namespace metrics {

inline constexpr auto kEveryMessage = messageClasses<

    KCellularLteRrcState, KCellularLteCdrxConfig, KCellularLteScellInfo, KCellularLteSelReselCellInfo,
    KCellularLteServingCellMeasurement, KCellularLteTxPower, KCellularLteRsrpRsrqSinr, KCellularLteComponentCarrierInfo,
    KCellularLteCarrierAggregationStatus, KCellularLteNbrEutraCellMeas, KCellularLteNbrInterRatCellMeas, NbrEutra,
    TxPowerInfo, RxInfo, RsrpRsrqSinr, SecondaryComponentCarrier, EgwErrcNbrEutraMeas, EgwErrcNbrUtraMeas,
    EgwErrcNbrGeranMeas, LteCellMeasResult, UtraCellMeasResult, GsmCellMeasResult, EutraFreqInfo, UtraFreqInfo,
    GsmFreqInfo, KCellularWcdmaRrcConnectionState, KCellularWcdmaCellInfo, KCellularWcdmaScellMeasurement,
    KCellularWcdmaTxPower, KCellularWcdmaNbrCellMeas, KCellularWcdmaSelReselCellInfo, KCellularWcdmaRrcConfiguration,
    GsmNcellMeas, UmtsNcellMeas, LteNcellMeas, KCellularGsmScellInfo, KCellularGsmIdleConfig,
    KCellularGsmIdleScellMeasurement, KCellularGsmCsRfMeasurement, KCellularGsmGrrEventMeasCr, KCellularGsmGprsConfig,
    KCellularMmCommonInfo, KCellularEmmContext, KCellularMmContext, KCellularGmmContext,
    KCellularActivatedBearerContexts, KCellularSimCardFiles, Plmn, KCellularLocationAreaId, KCellularTrackingAreaId,
    RoutingAreaId, Guti, BearerContext, ElementaryFile>();

}  // namespace metrics

}  // namespace vesk
