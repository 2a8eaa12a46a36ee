#include "terminal/panels/trend_span.h"

#include <algorithm>

namespace vesk {

namespace {

/// For how long a value is shown on where nothing newer was reported, milliseconds.
constexpr std::int64_t kFresh = 10'000;

auto firstFrom(const insight::Trend::Points& points, std::int64_t position) {
  return std::lower_bound(points.begin(), points.end(), position,
                          [](const insight::TrendPoint& point, std::int64_t start) { return point.position < start; });
}

}  // namespace

TrendSpan TrendSpan::endingAt(std::int64_t now, std::int64_t step, int slots) {
  return {(now / step + 1) * step - step * slots, step, slots};
}

std::optional<int> TrendSpan::slotOf(std::int64_t position) const {
  if (position < start || position >= start + length()) return std::nullopt;
  return static_cast<int>((position - start) / step);
}

void TrendValues::add(const insight::TrendPoint& point) {
  min = count == 0 ? point.min : std::min(min, point.min);
  max = count == 0 ? point.max : std::max(max, point.max);
  sum += point.sum;
  count += point.count;
}

std::vector<std::optional<TrendValues>> slotValues(const insight::Trend::Points& points, const TrendSpan& span,
                                                   const std::vector<insight::Moment>& breaks) {
  std::vector<std::optional<TrendValues>> slots(static_cast<std::size_t>(span.slots));
  for (auto point = firstFrom(points, span.start - kFresh); point != points.end(); ++point) {
    if (const auto slot = span.slotOf(point->position)) {
      auto& values = slots[static_cast<std::size_t>(*slot)];
      if (!values) values = TrendValues{};
      values->add(*point);
    }
    std::int64_t end = point->position + kFresh;
    // What a value is reported with, it does not end.
    const auto cut =
        std::upper_bound(breaks.begin(), breaks.end(), point->lastEvent,
                         [](std::uint64_t event, const insight::Moment& each) { return event < each.event; });
    if (cut != breaks.end()) end = std::min(end, cut->position);
    // The slot of the next report is that report's.
    const auto next = std::next(point);
    if (next != points.end()) end = std::min(end, next->position - next->position % span.step);
    const double value = point->mean();
    const std::int64_t after = point->position < span.start ? 0 : (point->position - span.start) / span.step + 1;
    for (auto slot = after; slot < span.slots && span.start + slot * span.step < end; ++slot)
      slots[static_cast<std::size_t>(slot)] = TrendValues{value, value, value, 1};
  }
  return slots;
}

std::optional<TrendValues> valuesSince(const insight::Trend::Points& points, std::int64_t start) {
  std::optional<TrendValues> values;
  for (auto point = firstFrom(points, start); point != points.end(); ++point) {
    if (!values) values = TrendValues{};
    values->add(*point);
  }
  return values;
}

}  // namespace vesk
