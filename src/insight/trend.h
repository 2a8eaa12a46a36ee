#pragma once

#include <array>
#include <cstdint>
#include <deque>

#include "insight/kpis.h"
#include "insight/moment.h"
#include "values/recycled_memory.h"

namespace vesk::insight {

/// What was reported of a KPI in one second.
struct TrendPoint {
  /// When the second began, in counted time of the drive, without its gaps: milliseconds.
  std::int64_t position;
  /// Which of the drive's metric events reported it last.
  std::uint64_t lastEvent;
  double min;
  double max;
  double sum;
  std::uint64_t count;

  [[nodiscard]] double mean() const { return sum / static_cast<double>(count); }
};

/// The course of every KPI over the last hour of a drive.
class Trend {
 public:
  using Points = std::deque<TrendPoint, RecyclingAllocator<TrendPoint>>;

  void take(const KpiReport& report, const Moment& moment);
  /// In the order of time.
  [[nodiscard]] const Points& points(Kpi kpi) const { return points_[indexOf(kpi)]; }

 private:
  static constexpr std::int64_t kWidth = 1000;
  static constexpr std::size_t kMostPoints = 3600;

  std::array<Points, kKpiCount> points_;
};

}  // namespace vesk::insight
