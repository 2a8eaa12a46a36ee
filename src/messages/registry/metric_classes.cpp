#include "messages/registry/metric_classes.h"

#include <algorithm>
#include <array>

#include "messages/registry/metric_of_message.h"

namespace vesk {

namespace {

using namespace metrics;

template <class MetricMessage>
constexpr MetricClass row() {
  return {kMetricId<MetricMessage>, MetricMessage::kClassName, &decodePayload<MetricMessage>,
          &appendPayloadJson<MetricMessage>, &decodeMessage<MetricMessage>};
}

/// In the order of their identifiers.
constexpr std::array kMetricClasses{
    row<KCellularSimCardFiles>(),
    row<KCellularGsmScellInfo>(),
    row<KCellularWcdmaCellInfo>(),
    row<KCellularLteScellInfo>(),
    row<KCellularLteRrcState>(),
    row<KCellularLteCdrxConfig>(),
    row<KCellularLteRsrpRsrqSinr>(),
    row<KCellularGsmIdleConfig>(),
    row<KCellularGsmIdleScellMeasurement>(),
    row<KCellularGsmCsRfMeasurement>(),
    row<KCellularGsmGrrEventMeasCr>(),
    row<KCellularGsmGprsConfig>(),
    row<KCellularWcdmaScellMeasurement>(),
    row<KCellularWcdmaTxPower>(),
    row<KCellularWcdmaSelReselCellInfo>(),
    row<KCellularWcdmaNbrCellMeas>(),
    row<KCellularWcdmaRrcConnectionState>(),
    row<KCellularWcdmaRrcConfiguration>(),
    row<KCellularLteServingCellMeasurement>(),
    row<KCellularLteTxPower>(),
    row<KCellularLteComponentCarrierInfo>(),
    row<KCellularLteSelReselCellInfo>(),
    row<KCellularLteNbrEutraCellMeas>(),
    row<KCellularLteNbrInterRatCellMeas>(),
    row<KCellularLteCarrierAggregationStatus>(),
    row<KCellularMmCommonInfo>(),
    row<KCellularMmContext>(),
    row<KCellularGmmContext>(),
    row<KCellularEmmContext>(),
    row<KCellularActivatedBearerContexts>(),
};

constexpr bool isBefore(const MetricClass& a, const MetricClass& b) {
  return a.metricId < b.metricId;
}
static_assert(std::is_sorted(kMetricClasses.begin(), kMetricClasses.end(), isBefore));

}  // namespace

const MetricClass* findMetricClass(std::int64_t metricId) {
  const auto* found = std::lower_bound(kMetricClasses.begin(), kMetricClasses.end(), metricId,
                                       [](const MetricClass& each, std::int64_t id) { return each.metricId < id; });
  return found != kMetricClasses.end() && found->metricId == metricId ? found : nullptr;
}

}  // namespace vesk
