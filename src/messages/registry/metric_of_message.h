#pragma once

#include <cstdint>

#include "messages/gsm/gsm.h"
#include "messages/lte/lte.h"
#include "messages/nas/nas.h"
#include "messages/registry/metric_identifiers.h"
#include "messages/wcdma/wcdma.h"

namespace vesk {

/// The identifier of the metric that a message class decodes; 0 for a class that is no metric of its own.
template <class MetricMessage>
inline constexpr std::int64_t kMetricId = 0;

template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularSimCardFiles> = K_SIM_FILE_INFO;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularGsmScellInfo> = K_GSM_SCELL_INFO;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularWcdmaCellInfo> = K_UMTS_SCELL_INFO;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteScellInfo> = K_LTE_SCELL_INFO;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteRrcState> = K_LTE_RRC_STATE;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteCdrxConfig> = K_LTE_CDRX_CONFIG;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteRsrpRsrqSinr> = K_LTE_RSRP_RSRQ_SINR;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularGsmIdleConfig> = K_GSM_IDLE_CONFIG;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularGsmIdleScellMeasurement> = K_GSM_IDLE_SCELL_MEAS;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularGsmCsRfMeasurement> = K_GSM_CS_RF_MEAS;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularGsmGrrEventMeasCr> = K_GSM_NCELL_MEAS;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularGsmGprsConfig> = K_GSM_GPRS_CONFIG;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularWcdmaScellMeasurement> = K_UMTS_SCELL_MEAS;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularWcdmaTxPower> = K_UMTS_TX_POWER;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularWcdmaSelReselCellInfo> = K_UMTS_SEL_RESEL_INFO;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularWcdmaNbrCellMeas> = K_UMTS_NCELL_MEAS;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularWcdmaRrcConnectionState> = K_UMTS_RRC_STATE;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularWcdmaRrcConfiguration> = K_UMTS_RRC_CONFIG;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteServingCellMeasurement> = K_LTE_SCELL_MEAS;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteTxPower> = K_LTE_TX_POWER;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteComponentCarrierInfo> = K_LTE_COMPCARR_INFO;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteSelReselCellInfo> = K_LTE_SEL_RESEL_INFO;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteNbrEutraCellMeas> = K_LTE_INTRARAT_MEAS;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteNbrInterRatCellMeas> = K_LTE_INTERRAT_MEAS;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularLteCarrierAggregationStatus> = K_LTE_CA_STATUS;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularMmCommonInfo> = K_CELLULAR_MM_INFO;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularMmContext> = K_CELLULAR_MM_CTXT;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularGmmContext> = K_CELLULAR_GMM_CTXT;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularEmmContext> = K_LTE_EMM_CTXT;
template <>
inline constexpr std::int64_t kMetricId<metrics::KCellularActivatedBearerContexts> = K_CELLULAR_ACTIVE_BEARER;

}  // namespace vesk
