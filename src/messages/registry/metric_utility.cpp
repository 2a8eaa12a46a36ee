#include "messages/registry/metric_utility.h"

#include <unordered_map>

#include "messages/registry/metric_identifiers.h"
#include "system/system_log.h"

namespace vesk {

namespace {

/// An identifier as a field number: without the byte that all have in common.
constexpr std::uint64_t tagOf(std::int64_t metricId) {
  return static_cast<std::uint64_t>(metricId) & 0xFFFF;
}

/// The labels are for the reader of the table. Not every one is the name of a message class.
using MetricLabels = std::unordered_map<std::uint64_t, std::string_view>;

const MetricLabels& metricLabels() {
  static const MetricLabels kLabels{
      {tagOf(K_LTE_RRC_STATE), "KCellularLteRrcState"},
      {tagOf(K_LTE_CDRX_CONFIG), "KCellularLteCdrxConfig"},
      {tagOf(K_LTE_RLF), "KCellularLteRadioLinkFailure"},
      {tagOf(K_LTE_SCELL_INFO), "KCellularLteScellInfo"},
      {tagOf(K_LTE_SEL_RESEL_INFO), "KCellularLteSelReselCellInfo"},
      {tagOf(K_LTE_SCELL_MEAS), "KCellularLteServingCellMeasurement"},
      {tagOf(K_LTE_TX_POWER), "KCellularLteTxPower"},
      {tagOf(K_LTE_RSRP_RSRQ_SINR), "KCellularRsrpRsrqSinr"},
      {tagOf(K_LTE_EMM_CTXT), "KCellularEmmContext"},
      {tagOf(K_LTE_COMPCARR_INFO), "KCellularLteComponentCarrierInfo"},
      {tagOf(K_LTE_CA_STATUS), "KCellularLteCarrierAggregationStatus"},
      {tagOf(K_LTE_INTERRAT_MEAS), "KCellularLteNbrInterRatCellMeas"},
      {tagOf(K_LTE_INTRARAT_MEAS), "KCellularLteNbrEutraCellMeas"},
      {tagOf(K_CELLULAR_MM_INFO), "KCellularMmCommonInfo"},
      {tagOf(K_CELLULAR_ACTIVE_BEARER), "KCellularActivatedBearerContexts"},
      {tagOf(K_UMTS_RRC_STATE), "KCellularWcdmaRrcConnectionState"},
      {tagOf(K_UMTS_SCELL_INFO), "KCellularWcdmaCellInfo"},
      {tagOf(K_UMTS_SCELL_MEAS), "KCellularWcdmaScellMeasurement"},
      {tagOf(K_UMTS_TX_POWER), "KCellularWcdmaTxPower"},
      {tagOf(K_UMTS_NCELL_MEAS), "KCellularWcdmaNbrCellMeas"},
      {tagOf(K_UMTS_SEL_RESEL_INFO), "KCellularWcdmaSelReselCellInfo"},
      {tagOf(K_UMTS_RRC_CONFIG), "KCellularWcdmaRrcConfiguration"},
      {tagOf(K_CELLULAR_MM_CTXT), "KCellularMmContext"},
      {tagOf(K_CELLULAR_GMM_CTXT), "KCellularGmmContext"},
      {tagOf(K_GSM_SCELL_INFO), "kCellularGsmScellInfo"},
      {tagOf(K_GSM_IDLE_CONFIG), "kCellularGsmIdleConfig"},
      {tagOf(K_GSM_IDLE_SCELL_MEAS), "kCellularGsmIdleScellMeasurement"},
      {tagOf(K_GSM_CS_RF_MEAS), "kCellularGsmCsRfMeasurement"},
      {tagOf(K_GSM_NCELL_MEAS), "kCellularGsmGrrEventMeasCr"},
      {tagOf(K_GSM_GPRS_CONFIG), "kCellularGsmGprsConfig"},
      {tagOf(K_SIM_FILE_INFO), "kCellularSimCardFiles"},
  };
  return kLabels;
}

}  // namespace

bool KBBMetricUtility::isValidMetricIdTag(std::uint64_t tag, std::string_view /*messageClass*/) {
  if (!metricLabels().contains(tag)) return false;
  SystemLog::write("valid metricId tag");
  return true;
}

}  // namespace vesk
