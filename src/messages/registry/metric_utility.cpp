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

/// The labels are for the reader of the table.
using MetricLabels = std::unordered_map<std::uint64_t, std::string_view>;

const MetricLabels& metricLabels() {
  static const MetricLabels kLabels{
      // Of two labels of one metric the first holds. These are not the names of message classes.
      {tagOf(K_LTE_RSRP_RSRQ_SINR), "KCellularRsrpRsrqSinr"},
      {tagOf(K_GSM_SCELL_INFO), "kCellularGsmScellInfo"},
      {tagOf(K_GSM_IDLE_CONFIG), "kCellularGsmIdleConfig"},
      {tagOf(K_GSM_IDLE_SCELL_MEAS), "kCellularGsmIdleScellMeasurement"},
      {tagOf(K_GSM_CS_RF_MEAS), "kCellularGsmCsRfMeasurement"},
      {tagOf(K_GSM_NCELL_MEAS), "kCellularGsmGrrEventMeasCr"},
      {tagOf(K_GSM_GPRS_CONFIG), "kCellularGsmGprsConfig"},
      {tagOf(K_SIM_FILE_INFO), "kCellularSimCardFiles"},
#define KNOWN_METRIC(constant, identifier, label) {tagOf(constant), label},
#include "messages/registry/metrics.def"
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
