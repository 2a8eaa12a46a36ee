#include "messages/registry/metric_utility.h"

#include <unordered_map>

#include "platform/system_log.h"

namespace vesk {

namespace {

/// Identifier to the label that the service's documents give it. Not every label is the name of a message
/// class.
using MetricLabels = std::unordered_map<std::uint64_t, std::string_view>;

const MetricLabels& metricLabels() {
  static const MetricLabels kLabels{
      {19972, "KCellularLteRrcState"},
      {19992, "KCellularLteCdrxConfig"},
      {20005, "KCellularLteRadioLinkFailure"},
      {16578, "KCellularLteScellInfo"},
      {54030, "KCellularLteSelReselCellInfo"},
      {54017, "KCellularLteServingCellMeasurement"},
      {54018, "KCellularLteTxPower"},
      {20330, "KCellularRsrpRsrqSinr"},
      {54540, "KCellularEmmContext"},
      {54027, "KCellularLteComponentCarrierInfo"},
      {54035, "KCellularLteCarrierAggregationStatus"},
      {54032, "KCellularLteNbrInterRatCellMeas"},
      {54031, "KCellularLteNbrEutraCellMeas"},
      {54537, "KCellularMmCommonInfo"},
      {54541, "KCellularActivatedBearerContexts"},
      {53522, "KCellularWcdmaRrcConnectionState"},
      {12300, "KCellularWcdmaCellInfo"},
      {53506, "KCellularWcdmaScellMeasurement"},
      {53507, "KCellularWcdmaTxPower"},
      {53509, "KCellularWcdmaNbrCellMeas"},
      {53508, "KCellularWcdmaSelReselCellInfo"},
      {53523, "KCellularWcdmaRrcConfiguration"},
      {54538, "KCellularMmContext"},
      {54539, "KCellularGmmContext"},
      {11788, "kCellularGsmScellInfo"},
      {53249, "kCellularGsmIdleConfig"},
      {53250, "kCellularGsmIdleScellMeasurement"},
      {53251, "kCellularGsmCsRfMeasurement"},
      {53257, "kCellularGsmGrrEventMeasCr"},
      {53260, "kCellularGsmGprsConfig"},
      {19, "kCellularSimCardFiles"},
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
