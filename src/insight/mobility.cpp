#include "insight/mobility.h"

#include <utility>

namespace vesk::insight {

namespace {

/// A cell left so soon for the one before it was not worth the change.
constexpr std::int64_t kPingPongStay = 10'000;

}  // namespace

std::optional<Technology> Mobility::takeTechnology(const Report& report, Step& step) {
  if (!report.technology || report.technology == technology_) return std::nullopt;
  const std::optional<Technology> left = std::exchange(technology_, report.technology);
  forgetCells();
  step.add(EventKind::technology, TechnologyChange{left, *technology_});
  return left;
}

void Mobility::forgetCells() {
  cell_.reset();
  previous_.reset();
  isConnectedMode_.reset();
}

void Mobility::forget() {
  technology_.reset();
  forgetCells();
  for (auto& area : areas_)
    area.reset();
}

void Mobility::take(const Report& report, const Connections& connections, const KnownKpis& kpis, Step& step) {
  if (report.isConnectedMode) isConnectedMode_ = report.isConnectedMode;
  if (report.servingCell) takeCell(*report.servingCell, connections, kpis, step);
  if (report.area) takeArea(*report.area, step);
}

void Mobility::takeCell(const ServingCellReport& report, const Connections& connections, const KnownKpis& kpis,
                        Step& step) {
  const auto& [technology, identity] = report;
  if (identity.isUnknown()) return;
  if (cell_ && !differ(cell_->identity, identity)) {
    cell_->identity.fillIn(identity);
    return;
  }
  const OptionalNumber<double> level = kpis.at(levelOf(technology), step.now());
  const std::optional<ServingCell> left = std::exchange(cell_, ServingCell{technology, identity, step.now()});
  if (!left) {
    step.add(EventKind::cell, CellChange{technology, CellEntry::first, std::nullopt, identity, level, std::nullopt});
    return;
  }
  const std::int64_t stay = step.now() - left->since;
  const auto [kind, how] = wayToNewCell(technology, connections);
  step.add(kind, CellChange{technology, how, left->identity, identity, level, stay});
  const std::optional<CellIdentity> before = std::exchange(previous_, left->identity);
  if (before && !differ(*before, identity) && stay <= kPingPongStay)
    step.add(EventKind::pingPong, PingPong{technology, identity, left->identity, stay});
}

Mobility::Way Mobility::wayToNewCell(Technology technology, const Connections& connections) const {
  constexpr Way kHandover{EventKind::handover};
  constexpr Way kReselection{EventKind::reselection};
  constexpr Way kUnknown{EventKind::cell, CellEntry::unknown};
  const std::optional<Text>& state = connections.state(technology);
  const auto meaning = state ? rrcClassOf(technology, *state) : std::nullopt;
  switch (technology) {
    case Technology::lte:
      if (connections.isReestablishing()) return {EventKind::cell, CellEntry::reestablishment};
      break;
    case Technology::umts:
      // In CELL_FACH and the PCH states the phone chooses the cell itself, as in idle mode.
      if (state) return state == "KWCDMA_RRC_CONN_STATE_CELL_DCH"_text ? kHandover : kReselection;
      if (isConnectedMode_) return *isConnectedMode_ ? kHandover : kReselection;
      break;
    case Technology::gsm:
      break;
  }
  if (!meaning) return kUnknown;
  return meaning == RrcClass::connected ? kHandover : kReselection;
}

void Mobility::takeArea(const AreaReport& report, Step& step) {
  std::optional<AreaIdentity>& known = areas_[static_cast<std::size_t>(report.area)];
  if (known == report.identity) return;
  step.add(EventKind::area, AreaChange{report.area, known, report.identity});
  known = report.identity;
}

}  // namespace vesk::insight
