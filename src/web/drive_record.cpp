#include "web/drive_record.h"

#include <algorithm>
#include <variant>

namespace vesk::web {

namespace {

std::optional<Mark> markOf(const insight::TimelineEvent& event) {
  using insight::EventKind;
  if (event.kind == EventKind::drop) return Mark::drop;
  if (event.kind == EventKind::reestablished) return Mark::reestablishment;
  if (event.kind == EventKind::technology) return Mark::technologyChange;
  const auto* change = std::get_if<insight::CellChange>(&event.fields);
  return change != nullptr && change->from ? std::optional(Mark::cellChange) : std::nullopt;
}

}  // namespace

void MeasuredPoint::absorb(const MeasuredPoint& later) {
  if (later.least < least) {
    least = later.least;
    leastAt = later.leastAt;
  }
  if (later.greatest > greatest) {
    greatest = later.greatest;
    greatestAt = later.greatestAt;
  }
}

DriveRecord::DriveRecord(const RecordLimits& limits)
    : limits_(limits),
      stretches_(limits.stretches),
      courses_(insight::kKpiCount, Thinned<MeasuredPoint>(limits.points, limits.whole)),
      serving_(limits.changes, limits.whole),
      marks_(kMarkCount, Thinned<MarkPoint>(limits.changes, limits.whole)) {}

void DriveRecord::take(const insight::Insight& insight, const insight::Report& report, const insight::Step& step) {
  hasTaken_ = true;
  const std::int64_t position = insight.clock().counted();
  if (insight.clock().stretches() != stretchCount_) {
    stretchCount_ = insight.clock().stretches();
    stretches_.add({position, insight.now().value_or(0)});
  }
  for (const auto& [kpi, value] : report.kpis)
    courses_[insight::indexOf(kpi)].add({position, position, value, position, value});
  takeServing(insight.timeline().mobility().cell(), position);
  for (const insight::TimelineEvent& event : step)
    takeEvent(event);
}

void DriveRecord::takeServing(const std::optional<insight::ServingCell>& cell, std::int64_t position) {
  if (!cell) {
    if (servingNow_) serving_.add({position, std::nullopt});
    servingNow_.reset();
    return;
  }
  if (servingNow_ && servingNow_->first == cell->technology && servingNow_->second == cell->identity) return;
  servingNow_ = {cell->technology, cell->identity};
  serving_.add({position, numberOf(*cell)});
}

std::optional<std::size_t> DriveRecord::numberOf(const insight::ServingCell& cell) {
  const std::string name = insight::textOf(cell.technology, cell.identity, true);
  if (const auto known = cellNumbers_.find(name); known != cellNumbers_.end()) return known->second;
  if (cells_.size() == kMostCells) return std::nullopt;
  cellNumbers_.emplace(name, cells_.size());
  cells_.push_back(name);
  return cells_.size() - 1;
}

void DriveRecord::takeEvent(const insight::TimelineEvent& event) {
  if (const auto mark = markOf(event)) marks_[static_cast<std::size_t>(*mark)].add({event.moment.position});
  auto& ofKind = events_[static_cast<std::size_t>(event.kind)];
  if (ofKind.size() == limits_.eventsOfKind) ofKind.pop_front();
  ofKind.push_back({eventCount_++, event});
}

void DriveRecord::clear() {
  hasTaken_ = false;
  stretches_.clear();
  for (Thinned<MeasuredPoint>& course : courses_)
    course.clear();
  serving_.clear();
  firstNewCell_ = cells_.size();
  for (Thinned<MarkPoint>& mark : marks_)
    mark.clear();
  for (auto& ofKind : events_)
    ofKind.clear();
}

std::vector<const DriveRecord::Event*> DriveRecord::events() const {
  std::vector<const Event*> all;
  for (const auto& ofKind : events_)
    for (const Event& each : ofKind)
      all.push_back(&each);
  std::sort(all.begin(), all.end(), [](const Event* one, const Event* other) { return one->number < other->number; });
  return all;
}

}  // namespace vesk::web
