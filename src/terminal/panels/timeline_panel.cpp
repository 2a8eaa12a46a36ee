#include "terminal/panels/timeline_panel.h"

#include <algorithm>
#include <array>
#include <functional>
#include <utility>

#include "terminal/panels/cell_words.h"
#include "terminal/panels/event_fields.h"
#include "terminal/panels/event_row.h"
#include "values/ascii.h"

namespace vesk {

std::span<const Action> TimelinePanel::hints() const {
  static constexpr std::array kHints{Action::Help,   Action::Open,     Action::Back, Action::Filter,
                                     Action::Freeze, Action::Overview, Action::Quit};
  return kHints;
}

const insight::TimelineEvent& TimelinePanel::eventOf(std::uint64_t number) const {
  return drive_.present().happenings()[number - oldest_];
}

bool TimelinePanel::passesFilter(const insight::TimelineEvent& event) const {
  return filter_.empty() || containsIgnoringCase(lineOf(event), filter_);
}

/// Brings the rows in line with the drive. The selected event keeps its line while newer ones come.
void TimelinePanel::refresh() {
  const auto& happenings = drive_.present().happenings();
  oldest_ = drive_.present().happenedBefore();
  rows_.clear();
  for (std::uint64_t number = oldest_ + happenings.size(); number-- > oldest_;)
    if (passesFilter(eventOf(number))) rows_.push_back(number);
  const auto place =
      selected_ ? std::lower_bound(rows_.begin(), rows_.end(), *selected_, std::greater<>()) : rows_.begin();
  const int row = std::min(static_cast<int>(place - rows_.begin()), std::max(static_cast<int>(rows_.size()) - 1, 0));
  window_.shift(row - window_.selected());
  window_.resize(static_cast<int>(rows_.size()), height_);
}

void TimelinePanel::keepSelected() {
  const int row = window_.selected();
  selected_ = row == 0 || rows_.empty() ? std::nullopt : std::optional(rows_[static_cast<std::size_t>(row)]);
}

void TimelinePanel::draw(const Canvas& canvas) {
  // Of the list at least the selected event stays.
  constexpr int kDetailLines = 12;
  const int detailLines = hasDetails_ ? std::min(kDetailLines, canvas.lines() - 2) : 0;
  height_ = canvas.lines() - 1 - detailLines;
  refresh();
  std::string head = "Timeline, " + std::to_string(rows_.size());
  if (!filter_.empty()) head += " of " + std::to_string(drive_.present().happenings().size());
  const int headEnd = canvas.write(2, 0, head + (rows_.size() == 1 ? " event" : " events"), Role::Title);
  if (rows_.empty()) {
    canvas.write(2, 1, filter_.empty() ? "nothing happened yet" : "no event has this", Role::Faint);
    return;
  }
  const auto& selected = eventOf(rows_[static_cast<std::size_t>(window_.selected())]);
  canvas.write(headEnd + 2, 0, dateText(selected.moment.time), Role::Faint);
  for (int row = window_.top(); row < window_.end(); ++row)
    drawEventRow(canvas, 1 + row - window_.top(), eventOf(rows_[static_cast<std::size_t>(row)]),
                 row == window_.selected());
  if (hasDetails_) drawDetails(canvas.part({0, 1 + height_, canvas.columns(), detailLines}));
}

void TimelinePanel::drawDetails(const Canvas& canvas) const {
  canvas.fill(0, Role::PaneHeader);
  canvas.write(1, 0, goToEvent_ ? "Fields; Enter goes to this moment" : "Fields", Role::PaneHeader);
  auto fields = fieldsOf(eventOf(rows_[static_cast<std::size_t>(window_.selected())]));
  // Timestamp, number, kind and text, which the event's row tells, come last, where lines may be short.
  std::rotate(fields.begin(), fields.begin() + 4, fields.end());
  int keyWidth = 0;
  for (const auto& [key, value] : fields)
    keyWidth = std::max(keyWidth, textWidth(key));
  int line = 0;
  for (const auto& [key, value] : fields) {
    canvas.write(2, ++line, key, Role::Plain);
    canvas.write(2 + keyWidth + 2, line, value, Role::Value);
  }
}

void TimelinePanel::open() {
  if (rows_.empty()) return;
  keepSelected();
  // The newest stays the one that was opened, whatever comes.
  selected_ = rows_[static_cast<std::size_t>(window_.selected())];
  if (std::exchange(hasDetails_, true) && goToEvent_) {
    const insight::TimelineEvent event = eventOf(*selected_);
    goToEvent_(event);
  }
}

bool TimelinePanel::perform(Action action) {
  refresh();
  if (action == Action::Open) {
    open();
    return true;
  }
  if (action == Action::Back && (hasDetails_ || !filter_.empty())) {
    if (!std::exchange(hasDetails_, false)) setFilter({});
    return true;
  }
  if (!window_.perform(action)) return false;
  keepSelected();
  return true;
}

void TimelinePanel::click(int /*column*/, int line) {
  const int row = window_.top() + line - 1;
  if (line < 1 || line > height_ || row >= window_.end()) return;
  const bool isSelected = row == window_.selected();
  window_.select(row);
  keepSelected();
  if (!isSelected || !hasDetails_) hasDetails_ = true;
}

void TimelinePanel::scroll(int lines) {
  refresh();
  window_.scroll(lines);
  keepSelected();
}

void TimelinePanel::setFilter(std::string filter) {
  filter_ = std::move(filter);
}

}  // namespace vesk
