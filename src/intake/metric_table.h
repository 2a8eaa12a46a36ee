#pragma once

#include <cstdint>
#include <string_view>

#include "intake/metric_validator.h"
#include "messages/registry/metric_classes.h"

namespace vesk {

/// In which order a stored record's timestamp is formatted, its line is printed and its extra step is run.
enum class StepOrder {
  timestampLogExtra,
  timestampExtraLog,
  logTimestampExtra,
  /// The stored timestamp stays a number.
  logExtra,
};

/// What is done with one kind of metric.
struct HandledMetric {
  std::int64_t id;
  DecodePayload decode;
  MetricValidator::LatestRecord MetricValidator::*record;
  /// Printed before the record.
  std::string_view logText;
  StepOrder order;
  /// Null for none.
  void (*extraStep)(MetricValidator&);
};

/// Null for a metric that is not handled.
[[nodiscard]] const HandledMetric* findHandledMetric(std::int64_t id);

}  // namespace vesk
