#include "handset/model/network.h"

#include "handset/model/drive.h"

namespace vesk::handset {

namespace {

constexpr std::size_t kLteSites = 20;
constexpr std::size_t kUmtsSites = 10;
constexpr std::size_t kGsmSites = 6;
/// One LTE site in so many has no carrier of the first layer, so that handovers cross frequencies.
constexpr std::size_t kSecondLayerOnly = 4;

constexpr double kLtePower = 12;
constexpr double kUmtsPower = 26;
constexpr double kGsmPower = 36;
constexpr double kTunnelPower = -4;
/// Metres: the middle of the tunnel.
constexpr double kTunnelSite = 540;

constexpr std::uint32_t kTunnelArfcn = 88;
constexpr double kGsmFrequency = 950;
constexpr double kUmtsFrequency = 942.4;

std::uint32_t areaCode(double place, std::uint32_t first) {
  return place < kRingLength / 2 ? first : first + 1;
}

Antenna makeSite(std::size_t index, std::size_t count, Random& random) {
  const double spacing = kRingLength / static_cast<double>(count);
  Antenna site{};
  site.site = index;
  site.place = spacing * (static_cast<double>(index) + random.between(0.0, 0.15));
  site.offset = random.between(40, 140);
  return site;
}

constexpr int kDirections[] = {1, -1};

void addLteSite(std::vector<LteCell>& cells, std::size_t index, std::uint32_t firstPci, Random& random) {
  const Antenna site = makeSite(index, kLteSites, random);
  for (std::uint32_t layer = 0; layer < kLteCarriers.size(); ++layer) {
    if (layer == 0 && index % kSecondLayerOnly == 2) continue;
    for (std::uint32_t sector = 0; sector < 2; ++sector) {
      LteCell cell{};
      cell.antenna = site;
      cell.antenna.direction = kDirections[sector];
      cell.antenna.powerDbm = kLtePower;
      cell.antenna.frequencyMhz = kLteCarriers[layer].frequencyMhz;
      cell.carrier = &kLteCarriers[layer];
      // Each layer has a third of the 504 codes; 5 is prime to the 56 groups of three in it, so that none recurs.
      cell.pci = 168 * layer + 3 * ((firstPci + 5 * static_cast<std::uint32_t>(index)) % 56) + sector;
      cell.cellId = (0x1A000 + static_cast<std::uint32_t>(index)) << 8 | (16 * layer + sector + 1);
      cell.trackingAreaCode = areaCode(site.place, kFirstTrackingArea);
      cell.load = random.between(0.25, 0.6);
      cells.push_back(cell);
    }
  }
}

void addUmtsSite(std::vector<UmtsCell>& cells, std::size_t index, std::uint32_t firstCode, Random& random) {
  const Antenna site = makeSite(index, kUmtsSites, random);
  for (std::uint32_t sector = 0; sector < 2; ++sector) {
    UmtsCell cell{};
    cell.antenna = site;
    cell.antenna.direction = kDirections[sector];
    cell.antenna.powerDbm = kUmtsPower;
    cell.antenna.frequencyMhz = kUmtsFrequency;
    cell.scramblingCode = 8 * ((firstCode + 11 * static_cast<std::uint32_t>(index)) % 64) + sector;
    cell.cellId = 0x21U << 16 | (1000 + 10 * static_cast<std::uint32_t>(index) + sector + 1);
    cell.locationAreaCode = areaCode(site.place, kFirstLocationArea);
    cells.push_back(cell);
  }
}

void addGsmSite(std::vector<GsmCell>& cells, std::size_t index, Random& random) {
  const Antenna site = makeSite(index, kGsmSites, random);
  for (std::uint32_t sector = 0; sector < 2; ++sector) {
    GsmCell cell{};
    cell.antenna = site;
    cell.antenna.direction = kDirections[sector];
    cell.antenna.powerDbm = kGsmPower;
    cell.antenna.frequencyMhz = kGsmFrequency;
    cell.arfcn = 60 + 4 * static_cast<std::uint32_t>(index) + 2 * sector;
    cell.bsic = 5 * 8 + static_cast<std::uint32_t>(index);
    cell.cellId = 20000 + 10 * static_cast<std::uint32_t>(index) + sector + 1;
    cell.locationAreaCode = areaCode(site.place, kFirstLocationArea);
    cells.push_back(cell);
  }
}

/// A small cell on a radiating cable.
GsmCell makeTunnelCell() {
  GsmCell cell{};
  cell.antenna = {kGsmSites, kTunnelSite, 20, 0, kTunnelPower, kGsmFrequency, true};
  cell.arfcn = kTunnelArfcn;
  cell.bsic = 5 * 8 + 7;
  cell.cellId = 20901;
  cell.locationAreaCode = areaCode(kTunnelSite, kFirstLocationArea);
  return cell;
}

}  // namespace

Network makeNetwork(Random& random) {
  Network network;
  const std::uint32_t firstPci = random.below(56);
  for (std::size_t index = 0; index < kLteSites; ++index)
    addLteSite(network.lte, index, firstPci, random);
  const std::uint32_t firstCode = random.below(64);
  for (std::size_t index = 0; index < kUmtsSites; ++index)
    addUmtsSite(network.umts, index, firstCode, random);
  for (std::size_t index = 0; index < kGsmSites; ++index)
    addGsmSite(network.gsm, index, random);
  network.gsm.push_back(makeTunnelCell());
  return network;
}

}  // namespace vesk::handset
