#pragma once

#include <vector>

#include "handset/model/propagation.h"

namespace vesk::handset {

/// Levels in dBm and qualities in dB, smoothed as layer 3 smooths its measurements.
struct LteSignal {
  const LteCell* cell;
  double rsrp;
  double rsrq;
  double sinr;
  /// Over the whole carrier.
  double rssi;
};

struct UmtsSignal {
  const UmtsCell* cell;
  double rscp;
  double ecNo;
  double rssi;
};

struct GsmSignal {
  const GsmCell* cell;
  double rxLev;
};

/// What the handset's receivers hear where it is.
class Radio {
 public:
  /// `network` must outlive the radio.
  Radio(const Network& network, double place, Random& random);

  /// `metres` on from the last place.
  void moveTo(double place, double metres, Random& random);

  /// The cells that are heard, strongest first.
  [[nodiscard]] const std::vector<LteSignal>& lte() const { return lte_; }
  [[nodiscard]] const std::vector<UmtsSignal>& umts() const { return umts_; }
  [[nodiscard]] const std::vector<GsmSignal>& gsm() const { return gsm_; }

  /// How `cell` is heard; null when it is not.
  [[nodiscard]] const LteSignal* of(const LteCell* cell) const;
  [[nodiscard]] const UmtsSignal* of(const UmtsCell* cell) const;
  [[nodiscard]] const GsmSignal* of(const GsmCell* cell) const;

  /// How much better the second receive chain hears than the first, in dB.
  [[nodiscard]] double secondChainGain() const { return secondChainGain_; }

 private:
  /// The level of a cell that was never heard.
  static constexpr double kUnheard = -150;

  /// Smoothed levels, in the order of the network's cells.
  struct Levels {
    Levels(std::size_t cells, std::size_t sites, Random& random)
        : shadowing(sites, random), smoothed(cells, kUnheard) {}

    Shadowing shadowing;
    std::vector<double> smoothed;
  };

  template <class Cell>
  void measure(const std::vector<Cell>& cells, Technology technology, double place, double smoothing, Levels& levels,
               Random& random);
  void measureAll(double place, double smoothing, Random& random);
  void hearLte(double place);
  void hearUmts(double place);
  void hearGsm(double place);

  const Network& network_;
  Levels lteLevels_;
  Levels umtsLevels_;
  Levels gsmLevels_;
  double secondChainGain_ = 0;
  std::vector<LteSignal> lte_;
  std::vector<UmtsSignal> umts_;
  std::vector<GsmSignal> gsm_;
};

}  // namespace vesk::handset
