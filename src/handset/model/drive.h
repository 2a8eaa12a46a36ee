#pragma once

#include "handset/model/random.h"

namespace vesk::handset {

/// The road is a ring; places on it are metres from its start.
inline constexpr double kRingLength = 9000;

/// How far `place` lies ahead of `from`, the shorter way round: metres, negative when it lies behind.
[[nodiscard]] double metresAhead(double place, double from);

/// A car in town traffic, round and round.
class Drive {
 public:
  /// Moves on for `seconds`.
  void advance(double seconds, Random& random);

  [[nodiscard]] double place() const { return place_; }
  /// Metres per second.
  [[nodiscard]] double speed() const { return speed_; }

 private:
  double place_ = 0;
  double speed_ = 14;
};

}  // namespace vesk::handset
