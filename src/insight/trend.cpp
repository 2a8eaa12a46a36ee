#include "insight/trend.h"

#include <algorithm>

namespace vesk::insight {

void Trend::take(const KpiReport& report, const Moment& moment) {
  for (const auto& [kpi, value] : report) {
    Points& points = points_[indexOf(kpi)];
    if (points.empty() || moment.position - points.back().position >= kWidth) {
      points.push_back({moment.position - moment.position % kWidth, moment.event, value, value, value, 1});
      if (points.size() > kMostPoints) points.pop_front();
      continue;
    }
    TrendPoint& point = points.back();
    point.lastEvent = moment.event;
    point.min = std::min(point.min, value);
    point.max = std::max(point.max, value);
    point.sum += value;
    ++point.count;
  }
}

}  // namespace vesk::insight
