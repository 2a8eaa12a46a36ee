#include "handset/model/radio.h"

#include <algorithm>
#include <array>
#include <cmath>

#include "handset/model/drive.h"

namespace vesk::handset {

namespace {

/// Thermal noise with a noise figure of 7 dB: in one LTE subcarrier, and in a UMTS carrier.
constexpr double kLteNoiseDbm = -125;
constexpr double kUmtsNoiseDbm = -101;
/// Below these nothing is found.
constexpr double kLteFloor = -130;
constexpr double kUmtsFloor = -118;
constexpr double kGsmFloor = -109;

/// What a moderately loaded UMTS cell sends in all, as a multiple of its CPICH.
constexpr double kUmtsPowerToCpich = 4;
/// Of one measurement, in dB.
constexpr double kMeasurementDeviation = 1.5;
/// The weight of the newest measurement in the smoothed one.
constexpr double kSmoothing = 0.3;

template <class Cell>
bool isWithinHorizon(const Cell& cell, double place) {
  return std::abs(metresAhead(cell.antenna.place, place)) < kHorizon;
}

template <class Signal, class Cell>
const Signal* find(const std::vector<Signal>& signals, const Cell* cell) {
  const auto found =
      std::find_if(signals.begin(), signals.end(), [cell](const Signal& signal) { return signal.cell == cell; });
  return found == signals.end() ? nullptr : &*found;
}

template <class Signal>
void sortByLevel(std::vector<Signal>& signals, double Signal::*level) {
  std::stable_sort(signals.begin(), signals.end(),
                   [level](const Signal& a, const Signal& b) { return a.*level > b.*level; });
}

template <class Cell>
std::size_t siteCount(const std::vector<Cell>& cells) {
  return cells.back().antenna.site + 1;
}

}  // namespace

Radio::Radio(const Network& network, double place, Random& random)
    : network_(network),
      lteLevels_(network.lte.size(), siteCount(network.lte), random),
      umtsLevels_(network.umts.size(), siteCount(network.umts), random),
      gsmLevels_(network.gsm.size(), siteCount(network.gsm), random) {
  measureAll(place, 1, random);
}

void Radio::moveTo(double place, double metres, Random& random) {
  lteLevels_.shadowing.move(metres, random);
  umtsLevels_.shadowing.move(metres, random);
  gsmLevels_.shadowing.move(metres, random);
  secondChainGain_ = 0.98 * secondChainGain_ + 0.4 * random.normal();
  measureAll(place, kSmoothing, random);
}

void Radio::measureAll(double place, double smoothing, Random& random) {
  measure(network_.lte, Technology::lte, place, smoothing, lteLevels_, random);
  measure(network_.umts, Technology::umts, place, smoothing, umtsLevels_, random);
  measure(network_.gsm, Technology::gsm, place, smoothing, gsmLevels_, random);
  hearLte(place);
  hearUmts(place);
  hearGsm(place);
}

template <class Cell>
void Radio::measure(const std::vector<Cell>& cells, Technology technology, double place, double smoothing,
                    Levels& levels, Random& random) {
  for (std::size_t index = 0; index < cells.size(); ++index) {
    const Antenna& antenna = cells[index].antenna;
    if (!isWithinHorizon(cells[index], place)) continue;
    const double measured = receivedPower(antenna, technology, place) + levels.shadowing.gain(antenna.site) +
                            kMeasurementDeviation * random.normal();
    levels.smoothed[index] += smoothing * (measured - levels.smoothed[index]);
  }
}

void Radio::hearLte(double place) {
  lte_.clear();
  const double noise = fromDecibels(kLteNoiseDbm);
  // Per carrier: what all its cells send into one subcarrier, in mW, idle resources counted as silent.
  std::array<double, kLteCarriers.size()> received{};
  for (std::size_t index = 0; index < network_.lte.size(); ++index) {
    const LteCell& cell = network_.lte[index];
    if (!isWithinHorizon(cell, place)) continue;
    const double level = lteLevels_.smoothed[index];
    received[static_cast<std::size_t>(cell.carrier - kLteCarriers.data())] += cell.load * fromDecibels(level);
    if (level > kLteFloor) lte_.push_back({&cell, level, 0, 0, 0});
  }
  for (LteSignal& signal : lte_) {
    const double all = received[static_cast<std::size_t>(signal.cell->carrier - kLteCarriers.data())];
    const double own = fromDecibels(signal.rsrp);
    signal.sinr = decibels(own / (std::max(all - signal.cell->load * own, 0.0) + noise));
    const double resourceBlock = 12 * (all + noise);
    signal.rsrq = decibels(own / resourceBlock);
    signal.rssi = decibels(resourceBlock * signal.cell->carrier->resourceBlocks);
  }
  sortByLevel(lte_, &LteSignal::rsrp);
}

void Radio::hearUmts(double place) {
  umts_.clear();
  double received = fromDecibels(kUmtsNoiseDbm);
  for (std::size_t index = 0; index < network_.umts.size(); ++index) {
    const UmtsCell& cell = network_.umts[index];
    if (!isWithinHorizon(cell, place)) continue;
    const double level = umtsLevels_.smoothed[index];
    received += kUmtsPowerToCpich * fromDecibels(level);
    if (level > kUmtsFloor) umts_.push_back({&cell, level, 0, 0});
  }
  for (UmtsSignal& signal : umts_) {
    signal.rssi = decibels(received);
    signal.ecNo = signal.rscp - signal.rssi;
  }
  sortByLevel(umts_, &UmtsSignal::rscp);
}

void Radio::hearGsm(double place) {
  gsm_.clear();
  for (std::size_t index = 0; index < network_.gsm.size(); ++index) {
    const double level = gsmLevels_.smoothed[index];
    if (isWithinHorizon(network_.gsm[index], place) && level > kGsmFloor) {
      gsm_.push_back({&network_.gsm[index], level});
    }
  }
  sortByLevel(gsm_, &GsmSignal::rxLev);
}

const LteSignal* Radio::of(const LteCell* cell) const {
  return find(lte_, cell);
}

const UmtsSignal* Radio::of(const UmtsCell* cell) const {
  return find(umts_, cell);
}

const GsmSignal* Radio::of(const GsmCell* cell) const {
  return find(gsm_, cell);
}

}  // namespace vesk::handset
