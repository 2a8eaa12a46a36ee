#include "insight/drive_clock.h"

namespace vesk::insight {

namespace {

/// In the year 2286: what lies behind it is no time.
constexpr std::int64_t kLastTime = 9'999'999'999'999;
constexpr std::int64_t kLongestPause = 60'000;
/// Events of one moment may come a little out of order.
constexpr std::int64_t kLongestStepBack = 5'000;

}  // namespace

std::optional<DriveClock::Step> DriveClock::take(OptionalNumber<std::int64_t> timestamp) {
  const bool isTime = timestamp && *timestamp >= 1 && *timestamp <= kLastTime;
  if (!now_) {
    if (!isTime) return std::nullopt;
    first_ = now_ = timestamp;
    stretches_ = 1;
    return Step{};
  }
  if (!isTime) return Step{};
  const std::int64_t passed = *timestamp - *now_;
  if (passed > kLongestPause || passed < -kLongestStepBack) {
    const Gap gap{*now_, *timestamp};
    now_ = timestamp;
    ++stretches_;
    return Step{0, gap};
  }
  if (passed <= 0) return Step{};
  now_ = timestamp;
  counted_ += passed;
  return Step{passed};
}

}  // namespace vesk::insight
