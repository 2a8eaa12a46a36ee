#include "insight/trend.h"

#include <algorithm>

namespace vesk::insight {

void Trend::take(const KpiReport& report, std::int64_t position, std::int64_t time) {
  for (const auto& [kpi, value] : report) {
    std::deque<TrendPoint>& points = points_[indexOf(kpi)];
    if (points.empty() || position - points.back().position >= kWidth) {
      points.push_back({position - position % kWidth, time, value, value, value, 1});
      if (points.size() > kMostPoints) points.pop_front();
      continue;
    }
    TrendPoint& point = points.back();
    point.min = std::min(point.min, value);
    point.max = std::max(point.max, value);
    point.sum += value;
    ++point.count;
  }
}

}  // namespace vesk::insight
