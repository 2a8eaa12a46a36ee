#pragma once

#include <cstdint>
#include <optional>
#include <string_view>
#include <unordered_map>

#include "system/clock.h"
#include "terminal/view/surroundings.h"

namespace vesk {

/// When each kind of metric last arrived, and how often. Main queue only.
class MetricArrivals {
 public:
  explicit MetricArrivals(const Clock& clock) : clock_(clock) {}

  void note(std::int64_t metricId);
  /// Of the metric that changes a category; absent for one that none changes.
  [[nodiscard]] std::optional<Arrivals> of(std::string_view area, std::string_view category) const;

 private:
  const Clock& clock_;
  std::unordered_map<std::int64_t, Arrivals> arrivals_;
};

}  // namespace vesk
