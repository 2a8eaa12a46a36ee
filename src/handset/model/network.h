#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "handset/model/random.h"

namespace vesk::handset {

enum class Technology { lte, umts, gsm };

/// The test network: MCC 001, MNC 01.
inline constexpr std::uint32_t kMcc = 1;
inline constexpr std::uint32_t kMnc = 1;
inline constexpr std::uint32_t kMncDigits = 2;
inline constexpr std::uint32_t kRoutingAreaCode = 1;

/// The town's halves are areas of their own: a tracking area of LTE covers what a location area of the others does.
inline constexpr std::uint32_t kFirstTrackingArea = 10001;
inline constexpr std::uint32_t kFirstLocationArea = 2001;
[[nodiscard]] constexpr std::uint32_t locationAreaOf(std::uint32_t trackingAreaCode) {
  return trackingAreaCode - kFirstTrackingArea + kFirstLocationArea;
}

/// Where a cell's signal comes from.
struct Antenna {
  /// Index of the site among those of its technology.
  std::size_t site;
  /// Metres from the road's start, and from the road.
  double place;
  double offset;
  /// 1 ahead, -1 back along the road, 0 all round.
  int direction;
  /// Of the signal that the handset measures (reference signal, CPICH, BCCH carrier), what body and car take away
  /// already deducted.
  double powerDbm;
  double frequencyMhz;
  bool isInTunnel = false;
};

/// An LTE carrier that the network owns; FDD throughout.
struct LteCarrier {
  std::uint32_t earfcn;
  std::uint32_t band;
  std::uint32_t bandwidthMhz;
  /// 0 to 5, as the bandwidth is broadcast.
  std::uint32_t bandwidthCode;
  std::uint32_t resourceBlocks;
  double frequencyMhz;
  /// Of reselection, 7 the highest.
  std::uint32_t priority;
};

inline constexpr std::array<LteCarrier, 3> kLteCarriers{{
    {1300, 3, 20, 5, 100, 1815.0, 6},
    {100, 1, 10, 3, 50, 2120.0, 5},
    {2850, 7, 20, 5, 100, 2630.0, 5},
}};

/// Uplink channel numbers of FDD lie this far above the downlink's.
inline constexpr std::uint32_t kEarfcnUplinkOffset = 18000;

struct LteCell {
  Antenna antenna;
  const LteCarrier* carrier;
  std::uint32_t pci;
  /// 28 bits: base station and sector.
  std::uint32_t cellId;
  std::uint32_t trackingAreaCode;
  /// The share of its resources that others use.
  double load;
};

/// The UMTS carrier, in band VIII (900 MHz).
inline constexpr std::uint32_t kUarfcn = 3012;
inline constexpr std::uint32_t kUmtsBand = 8;

struct UmtsCell {
  Antenna antenna;
  std::uint32_t scramblingCode;
  /// 28 bits: controller and cell.
  std::uint32_t cellId;
  std::uint32_t locationAreaCode;
};

struct GsmCell {
  Antenna antenna;
  std::uint32_t arfcn;
  std::uint32_t bsic;
  std::uint32_t cellId;
  std::uint32_t locationAreaCode;
};

struct Network {
  std::vector<LteCell> lte;
  std::vector<UmtsCell> umts;
  std::vector<GsmCell> gsm;
};

/// The cells along the road. Their places, codes and loads differ from seed to seed.
[[nodiscard]] Network makeNetwork(Random& random);

}  // namespace vesk::handset
