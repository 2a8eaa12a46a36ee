#include "terminal/panels/kpi_look.h"

#include <algorithm>
#include <array>

#include "insight/text_forms.h"

namespace vesk {

using insight::Kpi;

namespace {

struct KpiLook {
  Kpi kpi;
  std::string_view label;
  /// The ends of its level bar: empty, full.
  double low;
  double high;
};

// clang-format off
constexpr std::array<KpiLook, insight::kKpiCount> kLooks{{
    {Kpi::lteRsrp, "RSRP", -130, -70},
    {Kpi::lteRsrq, "RSRQ", -20, -5},
    {Kpi::lteSinr, "SINR", -10, 30},
    {Kpi::ltePuschTxPower, "Tx PUSCH", -40, 24},
    {Kpi::ltePucchTxPower, "Tx PUCCH", -40, 24},
    {Kpi::lteSccRsrp, "SCC RSRP", -130, -70},
    {Kpi::lteNbrRsrp, "best neighbour RSRP", -130, -70},
    {Kpi::umtsRscp, "RSCP", -120, -60},
    {Kpi::umtsEcNo, "Ec/N0", -24, 0},
    {Kpi::umtsRssi, "RSSI", -110, -50},
    {Kpi::umtsTxPower, "Tx", -50, 24},
    {Kpi::gsmRxLev, "RxLev", -110, -50},
    {Kpi::gsmRxQual, "RxQual", 7, 0},
    {Kpi::gsmTxPower, "Tx", 0, 33},
}};

struct KpiRow {
  std::string_view area;
  std::string_view category;
  std::string_view key;
  Kpi kpi;
};

constexpr std::array kRows{
    KpiRow{"LTE", "Serving Cell Meas", "rsrp0", Kpi::lteRsrp},
    KpiRow{"LTE", "Serving Cell Meas", "rsrp1", Kpi::lteRsrp},
    KpiRow{"LTE", "Serving Cell Meas", "rsrq0", Kpi::lteRsrq},
    KpiRow{"LTE", "Serving Cell Meas", "rsrq1", Kpi::lteRsrq},
    KpiRow{"LTE", "Serving Cell Meas", "sinr0", Kpi::lteSinr},
    KpiRow{"LTE", "Serving Cell Meas", "sinr1", Kpi::lteSinr},
    KpiRow{"LTE", "Tx Power", "pusch_tx_power", Kpi::ltePuschTxPower},
    KpiRow{"LTE", "Tx Power", "pucch_tx_power", Kpi::ltePucchTxPower},
    KpiRow{"LTE", "CA Status", "rsrp", Kpi::lteSccRsrp},
    KpiRow{"LTE", "LTE Neighbor Cell Meas", "nbr_rsrp", Kpi::lteNbrRsrp},
    KpiRow{"UMTS", "Serving Cell Meas", "rsrp_range", Kpi::umtsRscp},
    KpiRow{"UMTS", "Serving Cell Meas", "rsrq_range", Kpi::umtsEcNo},
    KpiRow{"UMTS", "Serving Cell Meas", "rssi", Kpi::umtsRssi},
    KpiRow{"UMTS", "Tx Power", "pusch_tx_power", Kpi::umtsTxPower},
    KpiRow{"GSM", "Idle Serv Cell Meas", "idle_rxlev_dBm", Kpi::gsmRxLev},
    KpiRow{"GSM", "Connected Serv Cell Meas", "cs_rxlev_sub", Kpi::gsmRxLev},
    KpiRow{"GSM", "Connected Serv Cell Meas", "cs_rxqual_sub", Kpi::gsmRxQual},
    KpiRow{"GSM", "Connected Serv Cell Meas", "cs_tx_pwr", Kpi::gsmTxPower},
};
// clang-format on

const insight::Quantity& quantityOf(Kpi kpi) {
  return *insight::descriptionOf(kpi).quantity;
}

}  // namespace

std::string_view labelOf(Kpi kpi) {
  return kLooks[indexOf(kpi)].label;
}

std::string valueText(Kpi kpi, double value) {
  const std::string_view unit = quantityOf(kpi).unit;
  return insight::numberText(value) + (unit.empty() ? "" : " " + std::string(unit));
}

Role roleOf(Kpi kpi, double value) {
  constexpr std::array kGradeRoles{Role::Poor, Role::Fair, Role::Good, Role::Excellent};
  if (const auto grade = gradeOf(quantityOf(kpi), value)) return kGradeRoles[static_cast<std::size_t>(*grade)];
  return quantityOf(kpi).high && value >= *quantityOf(kpi).high ? Role::Poor : Role::Value;
}

std::string gradeText(Kpi kpi, double value) {
  const insight::Quantity& quantity = quantityOf(kpi);
  if (quantity.high && value >= *quantity.high) return "high";
  const auto grade = gradeOf(quantity, value);
  if (!grade) return {};
  const bool isFloor = quantity.floor && value >= quantity.floor->low && value <= quantity.floor->high;
  return (isFloor ? "or below, " : "") + std::string(nameOf(*grade));
}

double levelShare(Kpi kpi, double value) {
  const KpiLook& look = kLooks[indexOf(kpi)];
  return std::clamp((value - look.low) / (look.high - look.low), 0.0, 1.0);
}

std::optional<Kpi> kpiOfRow(std::string_view area, std::string_view category, std::string_view key) {
  const auto* found = std::find_if(kRows.begin(), kRows.end(), [&](const KpiRow& row) {
    return row.area == area && row.category == category && row.key == key;
  });
  return found == kRows.end() ? std::nullopt : std::optional(found->kpi);
}

}  // namespace vesk
