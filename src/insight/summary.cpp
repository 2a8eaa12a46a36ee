#include "insight/summary.h"

#include <variant>

namespace vesk::insight {

namespace {

/// Those of which counts for how long their values were known.
constexpr std::array kKpisOfTime{Kpi::lteRsrp,         Kpi::lteRsrq,   Kpi::lteSinr,  Kpi::ltePuschTxPower,
                                 Kpi::ltePucchTxPower, Kpi::umtsRscp,  Kpi::umtsEcNo, Kpi::umtsTxPower,
                                 Kpi::gsmRxLev,        Kpi::gsmTxPower};

/// Under which of the KPI's times the value counts; 0, which nobody reads, for one that is neither graded nor a power.
std::uint8_t placeOfTime(const KpiDescription& kpi, double value) {
  if (kpi.isTransmitPower) return value >= kHighTxPower ? KpiSummary::kHigh : KpiSummary::kNotHigh;
  const auto grade = gradeOf(*kpi.quantity, value);
  return grade ? static_cast<std::uint8_t>(*grade) : 0;
}

}  // namespace

void Summary::pass(std::int64_t passed, std::int64_t from, const Timeline& timeline) {
  const auto& technology = timeline.mobility().technology();
  times_[technology ? indexOf(*technology) : kTechnologies.size()] += passed;
  cells_.addTime(passed);
  passKpis(passed, from, timeline.kpis());
  if (!timeline.carriers().configured().empty()) carriersConfigured_ += passed;
  if (timeline.carriers().isAnyActivated()) carriersActivated_ += passed;
  if (timeline.registrations().noServiceSince()) noService_ += passed;
}

void Summary::passKpis(std::int64_t passed, std::int64_t from, const KnownKpis& known) {
  for (const Kpi kpi : kKpisOfTime)
    if (known.isKnown(kpi, from)) kpis_[indexOf(kpi)].times[placeOfTime_[indexOf(kpi)]] += passed;
}

void Summary::takeGap(const Gap& gap) {
  if (gaps_.size() < kMostGaps) gaps_.push_back(gap);
  cells_.leave();
}

void Summary::take(const Report& report, const Step& step, const Timeline& timeline) {
  for (const TimelineEvent& event : step) {
    ++kinds_[static_cast<std::size_t>(event.kind)];
    takeCellEvent(event);
  }
  for (const auto& [kpi, value] : report.kpis) {
    kpis_[indexOf(kpi)].values.add(value);
    placeOfTime_[indexOf(kpi)] = placeOfTime(descriptionOf(kpi), value);
  }
  const auto& serving = timeline.mobility().cell();
  if (!serving) return;
  if (report.servingCell) cells_.fillIn(serving->identity);
  if (!report.kpis.empty() && isOfServingCell(report, serving->identity)) cells_.take(report.kpis);
}

void Summary::takeCellEvent(const TimelineEvent& event) {
  if (event.kind == EventKind::technology) cells_.leave();
  if (const auto* pingPong = std::get_if<PingPong>(&event.fields)) ++mobility_[indexOf(pingPong->technology)].pingPongs;
  const auto* change = std::get_if<CellChange>(&event.fields);
  if (change == nullptr) return;
  MobilityCounts& counts = mobility_[indexOf(change->technology)];
  if (event.kind == EventKind::handover) ++counts.handovers;
  if (event.kind == EventKind::reselection) ++counts.reselections;
  if (change->how == CellEntry::reestablishment) ++counts.reestablishments;
  if (change->how == CellEntry::unknown) ++counts.unknown;
  cells_.enter(change->technology, change->to);
}

std::int64_t Summary::time(const std::optional<Technology>& technology) const {
  return times_[technology ? indexOf(*technology) : kTechnologies.size()];
}

}  // namespace vesk::insight
