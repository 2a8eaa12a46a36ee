#include "messages/registry/metric_classes.h"

#include <algorithm>
#include <array>

#include "messages/gsm/gsm.h"
#include "messages/lte/lte.h"
#include "messages/nas/nas.h"
#include "messages/wcdma/wcdma.h"

namespace vesk {

namespace {

using namespace metrics;

template <class MetricMessage>
constexpr MetricClass row(std::int64_t metricId) {
  return {metricId, MetricMessage::kClassName, &decodePayload<MetricMessage>};
}

/// In the order of their identifiers.
constexpr std::array kMetricClasses{
    row<KCellularSimCardFiles>(0x3C0013),
    row<KCellularGsmScellInfo>(0x3C2E0C),
    row<KCellularWcdmaCellInfo>(0x3C300C),
    row<KCellularLteScellInfo>(0x3C40C2),
    row<KCellularLteRrcState>(0x3C4E04),
    row<KCellularLteCdrxConfig>(0x3C4E18),
    row<KCellularLteRsrpRsrqSinr>(0x3C4F6A),
    row<KCellularGsmIdleConfig>(0x3CD001),
    row<KCellularGsmIdleScellMeasurement>(0x3CD002),
    row<KCellularGsmCsRfMeasurement>(0x3CD003),
    row<KCellularGsmGrrEventMeasCr>(0x3CD009),
    row<KCellularGsmGprsConfig>(0x3CD00C),
    row<KCellularWcdmaScellMeasurement>(0x3CD102),
    row<KCellularWcdmaTxPower>(0x3CD103),
    row<KCellularWcdmaSelReselCellInfo>(0x3CD104),
    row<KCellularWcdmaNbrCellMeas>(0x3CD105),
    row<KCellularWcdmaRrcConnectionState>(0x3CD112),
    row<KCellularWcdmaRrcConfiguration>(0x3CD113),
    row<KCellularLteServingCellMeasurement>(0x3CD301),
    row<KCellularLteTxPower>(0x3CD302),
    row<KCellularLteComponentCarrierInfo>(0x3CD30B),
    row<KCellularLteSelReselCellInfo>(0x3CD30E),
    row<KCellularLteNbrEutraCellMeas>(0x3CD30F),
    row<KCellularLteNbrInterRatCellMeas>(0x3CD310),
    row<KCellularLteCarrierAggregationStatus>(0x3CD313),
    row<KCellularMmCommonInfo>(0x3CD509),
    row<KCellularMmContext>(0x3CD50A),
    row<KCellularGmmContext>(0x3CD50B),
    row<KCellularEmmContext>(0x3CD50C),
    row<KCellularActivatedBearerContexts>(0x3CD50D),
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
