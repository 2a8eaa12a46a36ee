#include "app/program/metric_arrivals.h"

#include "screens/category_sources.h"

namespace vesk {

void MetricArrivals::note(std::int64_t metricId) {
  Arrivals& arrivals = arrivals_[metricId];
  arrivals.last = clock_.now();
  ++arrivals.count;
}

std::optional<Arrivals> MetricArrivals::of(std::string_view area, std::string_view category) const {
  const std::optional<std::int64_t> metric = sourceOf(area, category).metric;
  if (!metric) return std::nullopt;
  const auto found = arrivals_.find(*metric);
  return found == arrivals_.end() ? Arrivals{} : found->second;
}

}  // namespace vesk
