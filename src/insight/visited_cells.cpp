#include "insight/visited_cells.h"

#include <algorithm>

namespace vesk::insight {

void VisitedCells::enter(Technology technology, const CellIdentity& identity) {
  const auto place = std::find_if(cells_.begin(), cells_.end(), [&](const auto& each) {
    return each->technology == technology && !differ(each->identity, identity);
  });
  if (place == cells_.end()) {
    makeRoom();
    serving_ = cells_.emplace_back(std::make_unique<VisitedCell>(VisitedCell{technology, identity})).get();
  } else {
    serving_ = place->get();
  }
  serving_->identity.fillIn(identity);
  ++serving_->visits;
}

void VisitedCells::makeRoom() {
  if (cells_.size() < kMostCells) return;
  cells_.erase(std::min_element(cells_.begin(), cells_.end(),
                                [](const auto& one, const auto& other) { return one->time < other->time; }));
}

void VisitedCells::fillIn(const CellIdentity& identity) {
  if (serving_ != nullptr) serving_->identity.fillIn(identity);
}

void VisitedCells::addTime(std::int64_t passed) {
  if (serving_ != nullptr) serving_->time += passed;
}

void VisitedCells::take(const KpiReport& kpis) {
  if (serving_ == nullptr) return;
  VisitedCell& cell = *serving_;
  for (const auto& [kpi, value] : kpis) {
    if (kpi == levelOf(cell.technology)) {
      cell.level.add(value);
    } else if (kpi == qualityOf(cell.technology)) {
      cell.quality.add(value);
    } else if (kpi == Kpi::lteSinr && cell.technology == Technology::lte) {
      cell.sinr.add(value);
    }
  }
}

std::vector<const VisitedCell*> VisitedCells::byTime() const {
  std::vector<const VisitedCell*> cells;
  cells.reserve(cells_.size());
  for (const auto& cell : cells_)
    cells.push_back(cell.get());
  std::stable_sort(cells.begin(), cells.end(),
                   [](const VisitedCell* one, const VisitedCell* other) { return one->time > other->time; });
  return cells;
}

}  // namespace vesk::insight
