#include "terminal/panels/overview_panel.h"

#include <algorithm>
#include <array>
#include <string>

#include "terminal/panels/cell_table.h"
#include "terminal/panels/cell_words.h"
#include "terminal/panels/connection_pane.h"
#include "terminal/panels/event_marks.h"
#include "terminal/panels/event_row.h"
#include "terminal/panels/frame.h"
#include "terminal/panels/kpi_look.h"
#include "terminal/panels/serving_pane.h"
#include "terminal/panels/trend_graph.h"

namespace vesk {

namespace {

constexpr std::int64_t kRecentLength = 60'000;
/// What the trend shows at least.
constexpr std::int64_t kTrendLength = 120'000;

}  // namespace

std::span<const Action> OverviewPanel::hints() const {
  static constexpr std::array kHints{Action::Help,     Action::Back,  Action::Area,   Action::Trend,
                                     Action::Timeline, Action::Cells, Action::Freeze, Action::Quit};
  return kHints;
}

std::optional<insight::Kpi> OverviewPanel::selectedKpi() const {
  const auto& technology = drive_.present().timeline().mobility().technology();
  if (!technology) return std::nullopt;
  const auto kpis = servingKpis(*technology);
  return kpis[std::min(selected_, kpis.size() - 1)];
}

void OverviewPanel::moveSelection(int step) {
  const auto& technology = drive_.present().timeline().mobility().technology();
  if (!technology) return;
  const auto last = static_cast<int>(servingKpis(*technology).size()) - 1;
  selected_ = static_cast<std::size_t>(std::clamp(std::min(static_cast<int>(selected_), last) + step, 0, last));
}

void OverviewPanel::draw(const Canvas& canvas) {
  layout_ = OverviewLayout::of({canvas.columns(), canvas.lines()});
  if (layout_.hasFrames) drawFrames(canvas);
  for (const Pane& pane : layout_.panes)
    drawPane(canvas.part(pane.inside()), pane.kind);
}

void OverviewPanel::drawFrames(const Canvas& canvas) const {
  Frame frame({canvas.columns(), canvas.lines()});
  for (const Pane& pane : layout_.panes)
    frame.add(pane.box);
  frame.draw(canvas);
  for (const Pane& pane : layout_.panes)
    drawTitle(canvas, pane);
  if (const auto now = drive_.present().now()) {
    canvas.writeRight(canvas.columns() - 2, 0, " " + dateText(*now) + " ", Role::Faint);
  }
}

void OverviewPanel::drawTitle(const Canvas& canvas, const Pane& pane) const {
  constexpr std::array<std::string_view, 6> kTitles{"SERVING",   "CONNECTION",  "TREND",
                                                    "LAST 60 s", "CELLS HEARD", "WHAT HAPPENED"};
  std::string title(kTitles[static_cast<std::size_t>(pane.kind)]);
  const auto& technology = drive_.present().timeline().mobility().technology();
  const auto kpi = selectedKpi();
  if (pane.kind == PaneKind::serving && technology) title += "  " + std::string(nameOf(*technology));
  if (pane.kind == PaneKind::trend && kpi) {
    const std::string_view unit = insight::descriptionOf(*kpi).quantity->unit;
    const TrendGraph graph{*kpi, GraphKind::bars, signs_, 0};
    const int slots = graph.slotsFor(pane.inside().columns);
    title = std::string(labelOf(*kpi)) + (unit.empty() ? "" : " " + std::string(unit)) + ", " +
            lastingText(roundStep(kTrendLength, slots) * slots);
  }
  canvas.write(pane.box.column + 2, pane.box.line, " " + title + " ", Role::Title,
               pane.box.column + pane.box.columns - 1);
}

void OverviewPanel::drawPane(const Canvas& canvas, PaneKind kind) {
  switch (kind) {
    case PaneKind::serving:
      return drawServing(canvas, drive_.present(), selectedKpi());
    case PaneKind::connection:
      return drawConnection(canvas, drive_.present());
    case PaneKind::trend:
      return drawTrend(canvas);
    case PaneKind::recent:
      return drawRecent(canvas);
    case PaneKind::cells:
      return drawCells(canvas);
    case PaneKind::happenings:
      return drawHappenings(canvas);
  }
}

void OverviewPanel::drawTrend(const Canvas& canvas) const {
  const auto kpi = selectedKpi();
  if (!kpi) return;
  TrendGraph graph{*kpi, GraphKind::bars, signs_, 0};
  graph.step = roundStep(kTrendLength, graph.slotsFor(canvas.columns()));
  graph.draw(canvas, drive_.present());
}

/// How often what is marked happened; what did not comes last.
void OverviewPanel::drawRecent(const Canvas& canvas) const {
  const std::int64_t start = drive_.present().position() - kRecentLength;
  int line = 0;
  for (const bool isCounted : {true, false}) {
    for (const EventMark& mark : eventMarks()) {
      const std::size_t count = countSince(drive_.present(), mark, start);
      if ((count > 0) != isCounted) continue;
      canvas.write(1, line, mark.sign, isCounted ? mark.role : Role::Faint);
      canvas.write(3, line, mark.meaning, isCounted ? Role::Plain : Role::Faint);
      canvas.writeRight(canvas.columns() - 1, line, std::to_string(count), isCounted ? mark.role : Role::Faint);
      ++line;
    }
  }
}

void OverviewPanel::drawCells(const Canvas& canvas) const {
  const CellTable table(canvas.columns());
  table.drawHeads(canvas, std::nullopt);
  int line = 1;
  const std::vector<insight::HeardCell> cells = drive_.present().cellsHeard();
  const CellNotes notes(drive_.present(), cells);
  for (const insight::HeardCell& cell : cells) {
    if (line == canvas.lines()) break;
    table.drawRow(canvas, line++, cell, notes, false);
  }
}

void OverviewPanel::drawHappenings(const Canvas& canvas) {
  const auto& happenings = drive_.present().happenings();
  shownEvents_.clear();
  for (std::size_t index = happenings.size(); index-- > 0 && static_cast<int>(shownEvents_.size()) < canvas.lines();) {
    const insight::TimelineEvent& event = happenings[index];
    if (!isNotable(event.kind)) continue;
    drawEventRow(canvas, static_cast<int>(shownEvents_.size()), event, false);
    shownEvents_.push_back(drive_.present().happenedBefore() + index);
  }
}

bool OverviewPanel::perform(Action action) {
  if (action == Action::Up) moveSelection(-1);
  if (action == Action::Down) moveSelection(+1);
  if (action != Action::Open && action != Action::Trend) return action != Action::Back;
  if (const auto kpi = selectedKpi()) opener_.openTrend(*kpi);
  return true;
}

void OverviewPanel::click(int column, int line) {
  for (const Pane& pane : layout_.panes) {
    const Rectangle inside = pane.inside();
    if (!inside.has(column, line)) continue;
    const int row = line - inside.line;
    switch (pane.kind) {
      case PaneKind::serving: {
        const auto& technology = drive_.present().timeline().mobility().technology();
        const auto count = technology ? static_cast<int>(servingKpis(*technology).size()) : 0;
        if (row >= kFirstKpiLine && row < kFirstKpiLine + count) {
          selected_ = static_cast<std::size_t>(row - kFirstKpiLine);
        }
        return;
      }
      case PaneKind::connection:
        return;
      case PaneKind::trend:
        perform(Action::Trend);
        return;
      case PaneKind::recent:
        return opener_.openTimeline(std::nullopt);
      case PaneKind::cells:
        return opener_.openCells();
      case PaneKind::happenings: {
        if (row < static_cast<int>(shownEvents_.size()))
          opener_.openTimeline(shownEvents_[static_cast<std::size_t>(row)]);
        return;
      }
    }
  }
}

}  // namespace vesk
