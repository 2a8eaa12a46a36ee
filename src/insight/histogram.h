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
  void add(double value);
  [[nodiscard]] bool empty() const { return bins_.empty(); }

  /// Absent without values.
  [[nodiscard]] std::optional<Stats> stats() const;

 private:
  struct Bin {
    std::int32_t halves;
    std::uint64_t count;
  };

  /// The value at that place of all values in order.
  [[nodiscard]] double valueAt(std::uint64_t place) const;

  /// In order.
  std::vector<Bin> bins_;
  /// The bin of the last value.
  std::size_t last_ = 0;
};

}  // namespace vesk::insight
