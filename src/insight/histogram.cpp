#include "insight/histogram.h"

#include <algorithm>

namespace vesk::insight {

void Histogram::addOutside(double value) {
  const std::int64_t halves = halvesOf(value);
  if (counts_.empty()) first_ = halves;
  if (halves < first_) {
    counts_.insert(counts_.begin(), static_cast<std::size_t>(first_ - halves), 0);
    first_ = halves;
  }
  const auto place = static_cast<std::size_t>(halves - first_);
  counts_.resize(std::max(counts_.size(), place + 1));
  ++counts_[place];
}

std::optional<Stats> Histogram::stats() const {
  if (empty()) return std::nullopt;
  std::uint64_t count = 0;
  std::int64_t sum = 0;
  std::int64_t halves = first_;
  for (const std::uint64_t each : counts_) {
    count += each;
    sum += halves++ * static_cast<std::int64_t>(each);
  }
  return Stats{.count = count,
               .min = static_cast<double>(first_) / 2,
               .mean = static_cast<double>(sum) / 2 / static_cast<double>(count),
               .median = (valueAt((count - 1) / 2) + valueAt(count / 2)) / 2,
               .max = static_cast<double>(halves - 1) / 2};
}

double Histogram::valueAt(std::uint64_t place) const {
  std::int64_t halves = first_;
  for (const std::uint64_t each : counts_) {
    if (place < each) break;
    place -= each;
    ++halves;
  }
  return static_cast<double>(halves) / 2;
}

}  // namespace vesk::insight
