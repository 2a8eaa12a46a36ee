#pragma once

#include <algorithm>
#include <array>
#include <cstdint>

namespace vesk {

/// Rows that are found by their `metricId`. Made when the program is compiled, which fails when two have the same.
template <class Row, std::size_t count>
class MetricRows {
 public:
  consteval explicit MetricRows(const std::array<Row, count>& rows) : rows_(rows) {
    std::sort(rows_.begin(), rows_.end(), [](const Row& a, const Row& b) { return a.metricId < b.metricId; });
    const auto isSame = [](const Row& a, const Row& b) { return a.metricId == b.metricId; };
    if (std::adjacent_find(rows_.begin(), rows_.end(), isSame) != rows_.end()) throw "two metrics of one identifier";
  }

  /// Null when no row has the identifier.
  [[nodiscard]] constexpr const Row* find(std::int64_t metricId) const {
    const auto found = std::lower_bound(rows_.begin(), rows_.end(), metricId,
                                        [](const Row& each, std::int64_t id) { return each.metricId < id; });
    return found != rows_.end() && found->metricId == metricId ? &*found : nullptr;
  }

  [[nodiscard]] static constexpr std::size_t size() { return count; }

 private:
  std::array<Row, count> rows_;
};

}  // namespace vesk
