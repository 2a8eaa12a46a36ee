#include "handset/model/propagation.h"

#include <algorithm>
#include <cmath>

#include "handset/model/drive.h"

namespace vesk::handset {

namespace {

/// Where the road leaves what a technology covers: losses rise over the first metres and fall over the last.
struct Obstacle {
  Technology technology;
  double begin;
  double end;
  double lossDb;
};

/// A cutting that takes the higher frequencies of LTE, in the midst of it a tunnel; and elsewhere an underpass.
constexpr Obstacle kObstacles[] = {
    {Technology::lte, 220, 860, 60},
    {Technology::umts, 400, 680, 50},
    {Technology::gsm, 400, 680, 25},
    {Technology::lte, 5000, 5400, 60},
};
constexpr double kRamp = 50;
/// What the tunnel's walls keep inside, in dB.
constexpr double kTunnelWalls = 30;

/// 0 outside, 1 inside, in between on the ramps.
double depth(const Obstacle& obstacle, double place) {
  return std::clamp(std::min(place - obstacle.begin, obstacle.end - place) / kRamp, 0.0, 1.0);
}

double obstacleLoss(const Antenna& antenna, Technology technology, double place) {
  double loss = 0;
  for (const Obstacle& obstacle : kObstacles) {
    if (obstacle.technology != technology) continue;
    const double inside = depth(obstacle, place);
    loss += antenna.isInTunnel ? kTunnelWalls * (1 - inside) : obstacle.lossDb * inside;
  }
  return loss;
}

/// The macro cell model of 3GPP TR 36.942, antennas 15 m above the roofs.
double pathLoss(double metres, double frequencyMhz) {
  return 58.8 + 37.6 * std::log10(metres / 1000) + 21 * std::log10(frequencyMhz);
}

/// 0 dB in the direction of the beam, -10 dB beside it, -20 dB behind.
double antennaGain(int direction, double cosine) {
  return direction == 0 ? 0 : -10 * (1 - direction * cosine);
}

constexpr double kShadowDeviation = 4;
/// Metres in which the correlation falls to 1/e.
constexpr double kShadowLength = 50;

}  // namespace

double decibels(double ratio) {
  return 10 * std::log10(ratio);
}

double fromDecibels(double decibels) {
  return std::pow(10, decibels / 10);
}

double receivedPower(const Antenna& antenna, Technology technology, double place) {
  // Seen from the antenna, the handset is at -ahead.
  const double ahead = metresAhead(antenna.place, place);
  const double distance = std::sqrt(ahead * ahead + antenna.offset * antenna.offset);
  return antenna.powerDbm + antennaGain(antenna.direction, -ahead / distance) -
         pathLoss(distance, antenna.frequencyMhz) - obstacleLoss(antenna, technology, place);
}

Shadowing::Shadowing(std::size_t sites, Random& random) {
  for (std::size_t site = 0; site < sites; ++site)
    gains_.push_back(kShadowDeviation * random.normal());
}

void Shadowing::move(double metres, Random& random) {
  const double kept = std::exp(-metres / kShadowLength);
  const double renewed = kShadowDeviation * std::sqrt(1 - kept * kept);
  for (double& gain : gains_)
    gain = kept * gain + renewed * random.normal();
}

}  // namespace vesk::handset
