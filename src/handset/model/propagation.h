#pragma once

#include <cstddef>
#include <vector>

#include "handset/model/network.h"

namespace vesk::handset {

[[nodiscard]] double decibels(double ratio);
[[nodiscard]] double fromDecibels(double decibels);

/// Beyond this many metres along the road a cell is not heard.
inline constexpr double kHorizon = 2200;

/// What reaches the road at `place` on average, in dBm; shadows not counted.
[[nodiscard]] double receivedPower(const Antenna& antenna, Technology technology, double place);

/// Shadows of buildings: normal in decibels, one value for each site, correlated along the road.
class Shadowing {
 public:
  Shadowing(std::size_t sites, Random& random);

  void move(double metres, Random& random);
  /// Decibels, of either sign.
  [[nodiscard]] double gain(std::size_t site) const { return gains_[site]; }

 private:
  std::vector<double> gains_;
};

}  // namespace vesk::handset
