#include "insight/histogram.h"

#include <algorithm>

namespace vesk::insight {

void Histogram::add(double value) {
  const auto halves = static_cast<std::int32_t>(value * 2 + (value < 0 ? -0.5 : 0.5));
  // Reports tend to repeat.
  if (last_ < bins_.size() && bins_[last_].halves == halves) {
    ++bins_[last_].count;
    return;
  }
  auto bin = std::lower_bound(bins_.begin(), bins_.end(), halves,
                              [](const Bin& each, std::int32_t other) { return each.halves < other; });
  if (bin == bins_.end() || bin->halves != halves) bin = bins_.insert(bin, {halves, 0});
  ++bin->count;
  last_ = static_cast<std::size_t>(bin - bins_.begin());
}

std::optional<Stats> Histogram::stats() const {
  if (bins_.empty()) return std::nullopt;
  std::uint64_t count = 0;
  std::int64_t sum = 0;
  for (const Bin& bin : bins_) {
    count += bin.count;
    sum += bin.halves * static_cast<std::int64_t>(bin.count);
  }
  return Stats{.count = count,
               .min = bins_.front().halves / 2.0,
               .mean = static_cast<double>(sum) / 2.0 / static_cast<double>(count),
               .median = (valueAt((count - 1) / 2) + valueAt(count / 2)) / 2,
               .max = bins_.back().halves / 2.0};
}

double Histogram::valueAt(std::uint64_t place) const {
  const auto bin = std::find_if(bins_.begin(), bins_.end(), [&](const Bin& each) {
    if (place < each.count) return true;
    place -= each.count;
    return false;
  });
  return bin->halves / 2.0;
}

}  // namespace vesk::insight
