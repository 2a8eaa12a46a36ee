#include "terminal/view/diagnostics_pane.h"

#include <algorithm>

#include "terminal/view/wrapping.h"

namespace vesk {

void DiagnosticsPane::changeHeight() {
  bottom_.reset();
  switch (height_) {
    case PaneHeight::None:
      height_ = PaneHeight::Third;
      return;
    case PaneHeight::Third:
      height_ = PaneHeight::Half;
      return;
    case PaneHeight::Half:
      height_ = PaneHeight::None;
      return;
  }
}

/// The line must be one that is kept.
std::vector<std::string_view> DiagnosticsPane::wrapped(std::uint64_t number, int columns) const {
  return wrapText(lines_->lines()[number - (lines_->total() - lines_->lines().size()) - 1], columns);
}

/// False at the oldest line.
bool DiagnosticsPane::moveUp(Place& place, int columns) const {
  if (place.below + 1 < static_cast<int>(wrapped(place.number, columns).size())) {
    ++place.below;
    return true;
  }
  if (place.number <= lines_->total() - lines_->lines().size() + 1) return false;
  place = {place.number - 1, 0};
  return true;
}

/// False at the newest line.
bool DiagnosticsPane::moveDown(Place& place, int columns) const {
  if (place.below > 0) {
    --place.below;
    return true;
  }
  if (place.number == lines_->total()) return false;
  ++place.number;
  place.below = static_cast<int>(wrapped(place.number, columns).size()) - 1;
  return true;
}

void DiagnosticsPane::scroll(int lines, Size room) {
  if (lines_ == nullptr || lines_->lines().empty()) return;
  const std::uint64_t total = lines_->total();
  const std::uint64_t oldest = total - lines_->lines().size() + 1;
  Place bottom = bottom_.value_or(Place{total, 0});
  if (bottom.number < oldest) bottom = {oldest, 0};
  // Another width may have left it fewer.
  bottom.below = std::min(bottom.below, static_cast<int>(wrapped(bottom.number, room.columns).size()) - 1);
  for (; lines < 0 && moveUp(bottom, room.columns); ++lines) {
  }
  for (; lines > 0 && moveDown(bottom, room.columns); --lines) {
  }
  // The oldest line is never below the top.
  Place top = bottom;
  for (int line = 1; line < room.lines; ++line)
    if (!moveUp(top, room.columns) && !moveDown(bottom, room.columns)) break;
  bottom_ = bottom.number == total && bottom.below == 0 ? std::nullopt : std::optional(bottom);
}

DiagnosticsPane::Shown DiagnosticsPane::shown(Size room) {
  if (lines_ == nullptr || lines_->lines().empty()) return {};
  scroll(0, room);
  const auto [end, below] = bottom_.value_or(Place{lines_->total(), 0});
  Shown shown{{}, end, lines_->total()};
  const std::uint64_t oldest = shown.total - lines_->lines().size() + 1;
  auto hidden = static_cast<std::ptrdiff_t>(below);
  const auto wanted = static_cast<std::size_t>(std::max(room.lines, 0));
  for (std::uint64_t number = end; number >= oldest && shown.lines.size() < wanted; --number) {
    const std::vector<std::string_view> lines = wrapped(number, room.columns);
    shown.lines.insert(shown.lines.begin(), lines.begin(), lines.end() - hidden);
    hidden = 0;
  }
  if (shown.lines.size() > wanted)
    shown.lines.erase(shown.lines.begin(), shown.lines.end() - static_cast<std::ptrdiff_t>(wanted));
  return shown;
}

}  // namespace vesk
