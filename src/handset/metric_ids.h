#pragma once

#include <cstdint>

#include "messages/gsm/gsm.h"
#include "messages/lte/lte.h"
#include "messages/nas/nas.h"
#include "messages/wcdma/wcdma.h"

namespace vesk::handset {

/// The identifier under which a message travels.
template <class MetricMessage>
inline constexpr std::int64_t kMetricId = 0;

template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularSimCardFiles> = 0x3C0013;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularGsmScellInfo> = 0x3C2E0C;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularWcdmaCellInfo> = 0x3C300C;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteScellInfo> = 0x3C40C2;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteRrcState> = 0x3C4E04;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteCdrxConfig> = 0x3C4E18;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteRsrpRsrqSinr> = 0x3C4F6A;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularGsmIdleConfig> = 0x3CD001;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularGsmIdleScellMeasurement> = 0x3CD002;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularGsmCsRfMeasurement> = 0x3CD003;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularGsmGrrEventMeasCr> = 0x3CD009;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularGsmGprsConfig> = 0x3CD00C;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularWcdmaScellMeasurement> = 0x3CD102;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularWcdmaTxPower> = 0x3CD103;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularWcdmaSelReselCellInfo> = 0x3CD104;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularWcdmaNbrCellMeas> = 0x3CD105;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularWcdmaRrcConnectionState> = 0x3CD112;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularWcdmaRrcConfiguration> = 0x3CD113;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteServingCellMeasurement> = 0x3CD301;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteTxPower> = 0x3CD302;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteComponentCarrierInfo> = 0x3CD30B;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteSelReselCellInfo> = 0x3CD30E;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteNbrEutraCellMeas> = 0x3CD30F;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteNbrInterRatCellMeas> = 0x3CD310;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteCarrierAggregationStatus> = 0x3CD313;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularMmCommonInfo> = 0x3CD509;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularMmContext> = 0x3CD50A;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularGmmContext> = 0x3CD50B;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularEmmContext> = 0x3CD50C;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularActivatedBearerContexts> = 0x3CD50D;

/// A radio link failure on LTE: a metric without a message class.
inline constexpr std::int64_t kLteRadioLinkFailure = 0x3C4E25;

/// Triggers: the query of the SIM files, and what the handset raises by itself.
inline constexpr std::int64_t kSimFilesTrigger = 0x7F0013;
inline constexpr std::int64_t kHandoverTrigger = 0x7F0101;
inline constexpr std::int64_t kTechnologyChangeTrigger = 0x7F0102;

}  // namespace vesk::handset
