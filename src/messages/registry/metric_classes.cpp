#include "messages/registry/metric_classes.h"

#include <array>

#include "messages/registry/metric_of_message.h"
#include "messages/registry/metric_rows.h"

namespace vesk {

namespace {

template <class MetricMessage>
constexpr MetricClass row() {
  return {kMetricId<MetricMessage>, MetricMessage::kClassName, &decodePayload<MetricMessage>,
          &appendPayloadJson<MetricMessage>, &decodeMessage<MetricMessage>};
}

constexpr MetricRows kMetricClasses(std::array{
#define DECODED_METRIC(constant, identifier, Message, record) row<metrics::Message>(),
#include "messages/registry/metrics.def"
});

}  // namespace

const MetricClass* findMetricClass(std::int64_t metricId) {
  return kMetricClasses.find(metricId);
}

}  // namespace vesk
