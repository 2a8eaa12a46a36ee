#pragma once

#include <cstdint>
#include <string_view>

#include "intake/extra_steps.h"
#include "intake/stores.h"
#include "messages/registry/metric_classes.h"
#include "messages/registry/metric_identifiers.h"

namespace vesk {

/// In which order a stored record's timestamp is formatted, its line is printed and its extra step is run.
enum class StepOrder {
  timestampLogExtra,
  timestampExtraLog,
  logTimestampExtra,
  /// The stored timestamp stays a number.
  logExtra,
};

/// What is done with one kind of metric: a row of the table of metrics.
struct HandledMetric {
  std::int64_t metricId;
  DecodePayload decode;
  LatestRecord Stores::*record;
  /// Printed before the record.
  std::string_view logText;
  StepOrder order;
  /// Null for none.
  ExtraStep extraStep;
};

/// Null for a metric that is not handled.
[[nodiscard]] const HandledMetric* findHandledMetric(std::int64_t metricId);

/// How many kinds of metric are handled.
inline constexpr std::size_t kHandledMetricCount =
    std::initializer_list<int>{
#define HANDLED_METRIC(...) 0,
#include "messages/registry/metrics.def"
    }
        .size();

/// The metric whose latest record a member of Stores is.
template <LatestRecord Stores::*record>
inline constexpr std::int64_t kMetricOfRecord = [] {
  static_assert(record == nullptr, "no metric is handled whose record this is");
  return std::int64_t{};
}();

#define HANDLED_METRIC(constant, identifier, Message, record, ...) \
  template <>                                                      \
  inline constexpr std::int64_t kMetricOfRecord<&Stores::record> = constant;
#include "messages/registry/metrics.def"

}  // namespace vesk
