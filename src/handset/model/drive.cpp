#include "handset/model/drive.h"

#include <algorithm>

namespace vesk::handset {

namespace {

constexpr double kSlowest = 12;
constexpr double kFastest = 17;
/// Metres per second that the speed wanders in one.
constexpr double kRestlessness = 0.5;

}  // namespace

double metresAhead(double place, double from) {
  const double ahead = place - from;
  if (ahead > kRingLength / 2) return ahead - kRingLength;
  if (ahead < -kRingLength / 2) return ahead + kRingLength;
  return ahead;
}

void Drive::advance(double seconds, Random& random) {
  speed_ = std::clamp(speed_ + kRestlessness * seconds * random.normal(), kSlowest, kFastest);
  place_ += speed_ * seconds;
  if (place_ >= kRingLength) place_ -= kRingLength;
}

}  // namespace vesk::handset
