#include "terminal/panels/panel_stack.h"

#include <utility>

namespace vesk {

PanelStack::PanelStack(const insight::Present& drive, TimelinePanel::GoToEvent goToEvent, Signs signs)
    : drive_(drive),
      overview_(drive_, signs, *this),
      trend_(drive_, signs),
      timeline_(drive_, std::move(goToEvent)),
      cells_(drive_) {}

void PanelStack::close(std::size_t count) {
  if (shown_.size() > count) shown_.resize(count);
}

void PanelStack::show(Panel& panel) {
  std::erase(shown_, &panel);
  shown_.push_back(&panel);
}

void PanelStack::openTrend(insight::Kpi kpi) {
  trend_.show(kpi);
  show(trend_);
}

void PanelStack::openTimeline(std::optional<std::uint64_t> number) {
  timeline_.select(number);
  show(timeline_);
}

bool PanelStack::perform(Action action, std::optional<insight::Kpi> rowKpi) {
  switch (action) {
    case Action::Overview:
      show(overview_);
      return true;
    case Action::Timeline:
      if (top() != &timeline_) openTimeline(std::nullopt);
      return true;
    case Action::Cells:
      openCells();
      return true;
    case Action::Trend: {
      if (top() == &overview_) return top()->perform(action);
      const auto technology = drive_.present().timeline().mobility().technology();
      if (top() != &trend_) openTrend(rowKpi.value_or(levelOf(technology.value_or(insight::Technology::lte))));
      return true;
    }
    case Action::Back:
      if (top() == nullptr) return false;
      if (!top()->perform(action)) close(shown_.size() - 1);
      return true;
    case Action::Open:
    case Action::Sort:
    case Action::Up:
    case Action::Down:
    case Action::PageUp:
    case Action::PageDown:
    case Action::First:
    case Action::Last:
    case Action::NextSection:
      if (top() != nullptr) top()->perform(action);
      return top() != nullptr;
    case Action::Help:
    case Action::Filter:
    case Action::Freeze:
    case Action::Backward:
    case Action::Forward:
    case Action::Faster:
    case Action::Slower:
    case Action::Readings:
    case Action::Diagnostics:
    case Action::OlderLines:
    case Action::NewerLines:
    case Action::Area:
    case Action::Quit:
      return false;
  }
  return false;
}

}  // namespace vesk
