#include "intake/metric_table.h"

#include <array>

#include "messages/gsm/gsm.h"
#include "messages/lte/lte.h"
#include "messages/nas/nas.h"
#include "messages/registry/metric_rows.h"
#include "messages/wcdma/wcdma.h"

namespace vesk {

namespace {

using enum StepOrder;

constexpr MetricRows kHandledMetrics(std::array{
#define HANDLED_METRIC(constant, identifier, Message, record, logText, order, extraStep) \
  HandledMetric{constant, decodePayload<metrics::Message>, &Stores::record, logText, order, extraStep},
#include "messages/registry/metrics.def"
});

}  // namespace

const HandledMetric* findHandledMetric(std::int64_t metricId) {
  return kHandledMetrics.find(metricId);
}

}  // namespace vesk
