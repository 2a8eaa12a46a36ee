#include "terminal/panels/cells_panel.h"

#include <algorithm>
#include <array>
#include <string>

namespace vesk {

namespace {

/// The title and the heads.
constexpr int kLinesBeforeCells = 2;

}  // namespace

std::span<const Action> CellsPanel::hints() const {
  static constexpr std::array kHints{Action::Help,   Action::Back,     Action::Sort,
                                     Action::Freeze, Action::Overview, Action::Quit};
  return kHints;
}

void CellsPanel::refresh() {
  cells_ = drive_.present().cellsHeard();
  if (order_) sortCells(cells_, *order_);
  window_.resize(static_cast<int>(cells_.size()), height_);
  const auto found =
      std::find_if(cells_.begin(), cells_.end(), [&](const insight::HeardCell& cell) { return cell.key == selected_; });
  if (found != cells_.end()) window_.select(static_cast<int>(found - cells_.begin()));
}

void CellsPanel::draw(const Canvas& canvas) {
  height_ = canvas.lines() - kLinesBeforeCells;
  refresh();
  canvas.write(2, 0, "Cells heard, all technologies, kept 30 s: " + std::to_string(cells_.size()), Role::Title);
  const Canvas space = canvas.part({0, 1, canvas.columns(), canvas.lines() - 1});
  table_.emplace(space.columns());
  table_->drawHeads(space, order_);
  const CellNotes notes(drive_.present(), cells_);
  for (int row = window_.top(); row < window_.end(); ++row)
    table_->drawRow(space, 1 + row - window_.top(), cells_[static_cast<std::size_t>(row)], notes,
                    row == window_.selected());
}

bool CellsPanel::perform(Action action) {
  if (action == Action::Sort) {
    order_ = orderAfter(order_);
    return true;
  }
  refresh();
  if (!window_.perform(action)) return false;
  if (!cells_.empty()) selected_ = cells_[static_cast<std::size_t>(window_.selected())].key;
  return true;
}

void CellsPanel::click(int column, int line) {
  if (line >= kLinesBeforeCells) {
    const int row = window_.top() + line - kLinesBeforeCells;
    if (row < window_.end()) selected_ = cells_[static_cast<std::size_t>(row)].key;
  } else if (const auto chosen = table_ ? table_->columnAt(column) : std::nullopt) {
    const bool isSame = order_ && order_->column == *chosen;
    order_ = isSame ? CellOrder{*chosen, !order_->isFalling} : naturalOrder(*chosen);
  }
}

}  // namespace vesk
