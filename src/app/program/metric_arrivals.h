#pragma once

#include <chrono>
#include <cstdint>
#include <optional>
#include <string_view>
#include <unordered_map>

#include "terminal/view/surroundings.h"

namespace vesk {

/// When each kind of metric last arrived, and how often. Main queue only.
class MetricArrivals {
 public:
  /// One came at `time` of the drive.
  void note(std::int64_t metricId, std::chrono::milliseconds time);
  /// Of the metric that changes a category; absent for one that none changes.
  [[nodiscard]] std::optional<Arrivals> of(std::string_view area, std::string_view category) const;

 private:
  std::unordered_map<std::int64_t, Arrivals> arrivals_;
};

}  // namespace vesk
