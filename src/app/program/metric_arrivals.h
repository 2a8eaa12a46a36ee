#pragma once

#include <chrono>
#include <cstdint>
#include <optional>
#include <string_view>
#include <unordered_map>

#include "screens/category_sources.h"
#include "terminal/view/surroundings.h"

namespace vesk {

/// When what a category shows last arrived, and how often. Main queue only.
class MetricArrivals {
 public:
  /// One came at `time` of the drive.
  void note(std::int64_t metricId, const Record& record, std::chrono::milliseconds time);
  /// Of the metric that changes a category; of a list, only those that have it, unless none has. Absent for a category
  /// that no metric changes.
  [[nodiscard]] std::optional<Arrivals> of(std::string_view area, std::string_view category) const;

 private:
  std::unordered_map<std::int64_t, Arrivals> ofMetrics_;
  std::unordered_map<const CategorySource*, Arrivals> ofLists_;
};

}  // namespace vesk
