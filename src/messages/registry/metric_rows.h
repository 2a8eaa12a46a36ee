#pragma once

#include <array>
#include <cstddef>
#include <cstdint>

namespace vesk {

/// Rows that are found by their `metricId`, each at the first look. Made when the program is compiled, which fails when
/// two have the same.
template <class Row, std::size_t count>
class MetricRows {
 public:
  consteval explicit MetricRows(const std::array<Row, count>& rows) : rows_(rows) {
    for (std::size_t index = 0; index < count; ++index)
      for (std::size_t other = 0; other < index; ++other)
        if (rows[index].metricId == rows[other].metricId) throw "two metrics of one identifier";
    while (!spread())
      multiplier_ += kNextMultiplier;
  }

  /// Null when no row has the identifier.
  [[nodiscard]] constexpr const Row* find(std::int64_t metricId) const {
    const Row& row = rows_[rowAtPlace_[placeOf(metricId)]];
    return row.metricId == metricId ? &row : nullptr;
  }

  [[nodiscard]] static constexpr std::size_t size() { return count; }

 private:
  static constexpr unsigned kPlaceBits = 7;
  static_assert(count <= 1U << kPlaceBits);
  /// Odd, and large: neighbouring identifiers come to lie far apart.
  static constexpr std::uint32_t kFirstMultiplier = 0x9E3779B9;
  /// Even, so that all multipliers are odd.
  static constexpr std::uint32_t kNextMultiplier = 0x3C6EF372;

  [[nodiscard]] constexpr std::size_t placeOf(std::int64_t metricId) const {
    return static_cast<std::uint32_t>(metricId) * multiplier_ >> (32 - kPlaceBits);
  }

  /// Whether the multiplier gives every row a place of its own; the first that does is kept.
  constexpr bool spread() {
    rowAtPlace_ = {};
    std::array<bool, 1U << kPlaceBits> isTaken{};
    for (std::size_t index = 0; index < count; ++index) {
      const std::size_t place = placeOf(rows_[index].metricId);
      if (isTaken[place]) return false;
      isTaken[place] = true;
      rowAtPlace_[place] = static_cast<std::uint8_t>(index);
    }
    return true;
  }

  std::array<Row, count> rows_;
  std::uint32_t multiplier_ = kFirstMultiplier;
  /// Which row may be meant, by the place of its identifier. An empty place names row 0, which find() then refuses.
  std::array<std::uint8_t, 1U << kPlaceBits> rowAtPlace_{};
};

}  // namespace vesk
