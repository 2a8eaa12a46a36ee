#include "bench/kinds.h"

#include <array>

#include "bench/libprotobuf_operations.h"
#include "bench/our_operations.h"
#include "gsm/gsm.pb.h"
#include "lte/lte.pb.h"
#include "messages/registry/metric_of_message.h"
#include "messages/registry/metric_rows.h"
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
constexpr MetricRows kKinds(std::array{
#define DECODED_METRIC(constant, identifier, Message, record) \
  kind<vesk::metrics::Message, ::metrics::Message, visits::visit##Message>(),
#include "messages/registry/metrics.def"
});

}  // namespace

const Kind* findKind(std::int64_t metricId) {
  return kKinds.find(metricId);
}

}  // namespace vesk::bench
