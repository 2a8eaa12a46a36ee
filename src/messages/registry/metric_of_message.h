#pragma once

#include <cstdint>

#include "messages/gsm/gsm.h"
#include "messages/lte/lte.h"
#include "messages/nas/nas.h"
#include "messages/registry/metric_identifiers.h"
#include "messages/wcdma/wcdma.h"

namespace vesk {

/// The identifier of the metric that a message class decodes.
template <class MetricMessage>
inline constexpr std::int64_t kMetricId = [] {
  static_assert(sizeof(MetricMessage) == 0, "this class is no metric of its own");
  return std::int64_t{};
}();

#define DECODED_METRIC(constant, identifier, Message, record) \
  template <>                                                 \
  inline constexpr std::int64_t kMetricId<metrics::Message> = constant;
#include "messages/registry/metrics.def"

}  // namespace vesk
