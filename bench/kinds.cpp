#include "bench/kinds.h"

#include <algorithm>
#include <array>

#include "bench/libprotobuf_operations.h"
#include "bench/our_operations.h"
#include "gsm/gsm.pb.h"
#include "lte/lte.pb.h"
#include "messages/registry/metric_of_message.h"
#include "nas/nas.pb.h"
#include "visits.h"
#include "wcdma/wcdma.pb.h"

namespace vesk::bench {

namespace {

template <std::uint64_t (*visit)(protozero::data_view)>
std::uint64_t visitPayload(Payload payload) {
  return visit({reinterpret_cast<const char*>(payload.data()), payload.size()});
}

template <class Ours, class Libprotobufs, std::uint64_t (*visit)(protozero::data_view)>
constexpr Kind kind() {
  return {kMetricId<Ours>, Ours::kClassName, ourOperations<Ours>(), libprotobufOperations<Libprotobufs>(),
          visitPayload<visit>};
}

// Each side calls the message by the same name, in its own namespace.
#define KIND(Message) kind<vesk::metrics::Message, ::metrics::Message, visits::visit##Message>()

/// In the order of their identifiers.
constexpr std::array kKinds{
    KIND(KCellularSimCardFiles),
    KIND(KCellularGsmScellInfo),
    KIND(KCellularWcdmaCellInfo),
    KIND(KCellularLteScellInfo),
    KIND(KCellularLteRrcState),
    KIND(KCellularLteCdrxConfig),
    KIND(KCellularLteRsrpRsrqSinr),
    KIND(KCellularGsmIdleConfig),
    KIND(KCellularGsmIdleScellMeasurement),
    KIND(KCellularGsmCsRfMeasurement),
    KIND(KCellularGsmGrrEventMeasCr),
    KIND(KCellularGsmGprsConfig),
    KIND(KCellularWcdmaScellMeasurement),
    KIND(KCellularWcdmaTxPower),
    KIND(KCellularWcdmaSelReselCellInfo),
    KIND(KCellularWcdmaNbrCellMeas),
    KIND(KCellularWcdmaRrcConnectionState),
    KIND(KCellularWcdmaRrcConfiguration),
    KIND(KCellularLteServingCellMeasurement),
    KIND(KCellularLteTxPower),
    KIND(KCellularLteComponentCarrierInfo),
    KIND(KCellularLteSelReselCellInfo),
    KIND(KCellularLteNbrEutraCellMeas),
    KIND(KCellularLteNbrInterRatCellMeas),
    KIND(KCellularLteCarrierAggregationStatus),
    KIND(KCellularMmCommonInfo),
    KIND(KCellularMmContext),
    KIND(KCellularGmmContext),
    KIND(KCellularEmmContext),
    KIND(KCellularActivatedBearerContexts),
};
#undef KIND

constexpr bool isBefore(const Kind& a, const Kind& b) {
  return a.metricId < b.metricId;
}
static_assert(std::is_sorted(kKinds.begin(), kKinds.end(), isBefore));

}  // namespace

const Kind* findKind(std::int64_t metricId) {
  const auto* found = std::lower_bound(kKinds.begin(), kKinds.end(), metricId,
                                       [](const Kind& each, std::int64_t id) { return each.metricId < id; });
  return found != kKinds.end() && found->metricId == metricId ? found : nullptr;
}

}  // namespace vesk::bench
