#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "insight/trend.h"

namespace vesk {

/// The part of a drive that a graph shows, in counted milliseconds, divided into slots of equal length.
struct TrendSpan {
  std::int64_t start = 0;
  std::int64_t step = 1000;
  int slots = 0;

  /// The span whose last slot has `now` in it. Slots begin at multiples of `step`, so that a graph moves by whole ones.
  [[nodiscard]] static TrendSpan endingAt(std::int64_t now, std::int64_t step, int slots);

  [[nodiscard]] std::int64_t length() const { return step * slots; }
  /// The slot of a position; absent for one outside.
  [[nodiscard]] std::optional<int> slotOf(std::int64_t position) const;
};

/// What is known of a KPI in some time.
struct TrendValues {
  double min;
  double max;
  double sum;
  std::uint64_t count;

  [[nodiscard]] double mean() const { return sum / static_cast<double>(count); }
  void add(const insight::TrendPoint& point);
};

/// Of each slot. One without a report shows the last value for as long as that is fresh, but not beyond a position in
/// `breaks`, which are in order: there values are forgotten.
[[nodiscard]] std::vector<std::optional<TrendValues>> slotValues(const insight::Trend::Points& points,
                                                                 const TrendSpan& span,
                                                                 const std::vector<insight::Moment>& breaks);

/// Of all that was reported from `start` on; absent when nothing was.
[[nodiscard]] std::optional<TrendValues> valuesSince(const insight::Trend::Points& points, std::int64_t start);

}  // namespace vesk
