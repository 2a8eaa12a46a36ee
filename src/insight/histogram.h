#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

namespace vesk::insight {

struct Stats {
  std::uint64_t count;
  double min;
  double mean;
  double median;
  double max;
};

/// How often each value was reported. Values are multiples of 0.5 within a few hundred, so that memory stays small
/// whatever their number.
class Histogram {
 public:
  void add(double value) {
    const std::int64_t place = halvesOf(value) - first_;
    if (place >= 0 && place < std::ssize(counts_)) [[likely]] {
      ++counts_[static_cast<std::size_t>(place)];
    } else {
      addOutside(value);
    }
  }
  [[nodiscard]] bool empty() const { return counts_.empty(); }

  /// Absent without values.
  [[nodiscard]] std::optional<Stats> stats() const;

 private:
  [[nodiscard]] static std::int64_t halvesOf(double value) {
    return static_cast<std::int64_t>(value * 2 + (value < 0 ? -0.5 : 0.5));
  }
  /// Adds a value below the least or above the greatest.
  void addOutside(double value);
  /// The value at that place of all values in order.
  [[nodiscard]] double valueAt(std::uint64_t place) const;

  /// Of each value from the least to the greatest.
  std::vector<std::uint64_t> counts_;
  /// The least value, in halves.
  std::int64_t first_ = 0;
};

}  // namespace vesk::insight
