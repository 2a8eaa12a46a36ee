#include "insight/visited_cells.h"

#include <algorithm>

namespace vesk::insight {

void VisitedCells::enter(Technology technology, const CellIdentity& identity) {
  auto place = std::find_if(cells_.begin(), cells_.end(), [&](const VisitedCell& each) {
    return each.technology == technology && !differ(each.identity, identity);
  });
  if (place == cells_.end()) {
    makeRoom();
    cells_.push_back({technology, identity});
    place = cells_.end() - 1;
  }
  place->identity.fillIn(identity);
  ++place->visits;
  serving_ = static_cast<std::size_t>(place - cells_.begin());
}

void VisitedCells::makeRoom() {
  if (cells_.size() < kMostCells) return;
  const auto shortest =
      std::min_element(cells_.begin(), cells_.end(),
                       [](const VisitedCell& one, const VisitedCell& other) { return one.time < other.time; });
  cells_.erase(shortest);
}

void VisitedCells::fillIn(const CellIdentity& identity) {
  if (serving_) cells_[*serving_].identity.fillIn(identity);
}

void VisitedCells::addTime(std::int64_t passed) {
  if (serving_) cells_[*serving_].time += passed;
}

void VisitedCells::take(const KpiReport& kpis) {
  if (!serving_) return;
  VisitedCell& cell = cells_[*serving_];
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
  for (const VisitedCell& cell : cells_)
    cells.push_back(&cell);
  std::stable_sort(cells.begin(), cells.end(),
                   [](const VisitedCell* one, const VisitedCell* other) { return one->time > other->time; });
  return cells;
}

}  // namespace vesk::insight
