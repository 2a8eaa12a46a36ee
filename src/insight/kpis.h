#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string_view>

#include "insight/quantities.h"
#include "insight/technology.h"
#include "values/optional_number.h"

namespace vesk::insight {

/// The figures that a drive is judged by, in the order of a series' columns.
enum class Kpi : std::uint8_t {
  lteRsrp,
  lteRsrq,
  lteSinr,
  ltePuschTxPower,
  ltePucchTxPower,
  lteSccRsrp,
  lteNbrRsrp,
  umtsRscp,
  umtsEcNo,
  umtsRssi,
  umtsTxPower,
  gsmRxLev,
  gsmRxQual,
  gsmTxPower,
};

inline constexpr std::size_t kKpiCount = 14;

struct KpiDescription {
  Kpi kpi;
  std::string_view name;
  Technology technology;
  const Quantity* quantity;
  bool isGraded = false;
  bool isTransmitPower = false;
};

/// RXQUAL, a code of bit error rates.
inline constexpr Quantity kRxQual{"", 0, 7};

// clang-format off
inline constexpr std::array<KpiDescription, kKpiCount> kKpis{{
    {Kpi::lteRsrp, "lte.rsrp", Technology::lte, &kRsrp, true},
    {Kpi::lteRsrq, "lte.rsrq", Technology::lte, &kRsrq, true},
    {Kpi::lteSinr, "lte.sinr", Technology::lte, &kSinr, true},
    {Kpi::ltePuschTxPower, "lte.tx_power.pusch", Technology::lte, &kTxPower, false, true},
    {Kpi::ltePucchTxPower, "lte.tx_power.pucch", Technology::lte, &kTxPower, false, true},
    {Kpi::lteSccRsrp, "lte.scc.rsrp", Technology::lte, &kRsrp},
    {Kpi::lteNbrRsrp, "lte.nbr.rsrp", Technology::lte, &kRsrp},
    {Kpi::umtsRscp, "umts.rscp", Technology::umts, &kRscp, true},
    {Kpi::umtsEcNo, "umts.ecno", Technology::umts, &kEcNo, true},
    {Kpi::umtsRssi, "umts.rssi", Technology::umts, &kRssi},
    {Kpi::umtsTxPower, "umts.tx_power", Technology::umts, &kTxPower, false, true},
    {Kpi::gsmRxLev, "gsm.rxlev", Technology::gsm, &kRxLev, true},
    {Kpi::gsmRxQual, "gsm.rxqual", Technology::gsm, &kRxQual},
    {Kpi::gsmTxPower, "gsm.tx_power", Technology::gsm, &kTxPower, false, true},
}};
// clang-format on

[[nodiscard]] constexpr std::size_t indexOf(Kpi kpi) {
  return static_cast<std::size_t>(kpi);
}
[[nodiscard]] constexpr const KpiDescription& descriptionOf(Kpi kpi) {
  return kKpis[indexOf(kpi)];
}
/// The level of the serving cell: RSRP, RSCP or RxLev.
[[nodiscard]] constexpr Kpi levelOf(Technology technology) {
  constexpr std::array kLevels{Kpi::lteRsrp, Kpi::umtsRscp, Kpi::gsmRxLev};
  return kLevels[indexOf(technology)];
}
/// Its quality: RSRQ or Ec/N0; GSM has none.
[[nodiscard]] constexpr std::optional<Kpi> qualityOf(Technology technology) {
  constexpr std::array<std::optional<Kpi>, kTechnologies.size()> kQualities{Kpi::lteRsrq, Kpi::umtsEcNo, std::nullopt};
  return kQualities[indexOf(technology)];
}

struct KpiValue {
  Kpi kpi;
  double value;
};

/// What one event reports.
class KpiReport {
 public:
  /// Nothing for an absent value.
  void add(Kpi kpi, OptionalNumber<double> value) {
    if (value) values_[size_++] = {kpi, *value};
  }
  void clear() { size_ = 0; }

  [[nodiscard]] bool empty() const { return size_ == 0; }
  [[nodiscard]] const KpiValue* begin() const { return values_.data(); }
  [[nodiscard]] const KpiValue* end() const { return values_.data() + size_; }
  [[nodiscard]] OptionalNumber<double> find(Kpi kpi) const {
    for (const KpiValue& each : *this)
      if (each.kpi == kpi) return each.value;
    return std::nullopt;
  }

 private:
  /// No kind of metric reports more.
  static constexpr std::size_t kMost = 3;

  std::array<KpiValue, kMost> values_{};
  std::size_t size_ = 0;
};

/// The value of each KPI and when it was reported. A value is known for half a minute.
class KnownKpis {
 public:
  static constexpr std::int64_t kKnownFor = 30'000;

  void take(const KpiReport& report, std::int64_t now) {
    for (const auto& [kpi, value] : report) {
      values_[indexOf(kpi)] = value;
      times_[indexOf(kpi)] = now;
    }
  }
  void forget() { times_ = kNoTimes; }
  void forget(Technology technology) {
    for (const KpiDescription& each : kKpis)
      if (each.technology == technology) times_[indexOf(each.kpi)] = kNever;
  }

  [[nodiscard]] bool isKnown(Kpi kpi, std::int64_t now) const { return now - times_[indexOf(kpi)] <= kKnownFor; }
  [[nodiscard]] OptionalNumber<double> at(Kpi kpi, std::int64_t now) const {
    return isKnown(kpi, now) ? OptionalNumber(values_[indexOf(kpi)]) : std::nullopt;
  }
  /// How long ago, in milliseconds, the value was reported, also when it is no longer known.
  [[nodiscard]] OptionalNumber<std::int64_t> age(Kpi kpi, std::int64_t now) const {
    const std::int64_t time = times_[indexOf(kpi)];
    return time == kNever ? std::nullopt : OptionalNumber(now - time);
  }

 private:
  /// No time: at 0 and later, a value of then is no longer known.
  static constexpr std::int64_t kNever = -kKnownFor - 1;

  static constexpr auto kNoTimes = [] {
    std::array<std::int64_t, kKpiCount> times{};
    times.fill(kNever);
    return times;
  }();

  std::array<double, kKpiCount> values_{};
  /// When each was reported.
  std::array<std::int64_t, kKpiCount> times_ = kNoTimes;
};

}  // namespace vesk::insight
