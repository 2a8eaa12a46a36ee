#include "app/program/metric_arrivals.h"

namespace vesk {

namespace {

/// The sources of lists, by the metric that changes them.
const std::unordered_multimap<std::int64_t, const CategorySource*>& lists() {
  static const auto kLists = [] {
    std::unordered_multimap<std::int64_t, const CategorySource*> lists;
    for (const CategorySource& source : categorySources())
      if (source.metric && source.list != nullptr) lists.emplace(*source.metric, &source);
    return lists;
  }();
  return kLists;
}

void count(Arrivals& arrivals, std::chrono::milliseconds time) {
  arrivals.last = time;
  ++arrivals.count;
}

}  // namespace

void MetricArrivals::note(std::int64_t metricId, const Record& record, std::chrono::milliseconds time) {
  count(ofMetrics_[metricId], time);
  const auto [first, end] = lists().equal_range(metricId);
  for (auto each = first; each != end; ++each)
    if (isFilledBy(*each->second, record)) count(ofLists_[each->second], time);
}

std::optional<Arrivals> MetricArrivals::of(std::string_view area, std::string_view category) const {
  const CategorySource& source = sourceOf(area, category);
  if (!source.metric) return std::nullopt;
  if (const auto found = ofLists_.find(&source); found != ofLists_.end()) return found->second;
  const auto found = ofMetrics_.find(*source.metric);
  if (found == ofMetrics_.end()) return Arrivals{};
  Arrivals arrivals = found->second;
  arrivals.isWithoutList = source.list != nullptr;
  return arrivals;
}

}  // namespace vesk
