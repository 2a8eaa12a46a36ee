#include "terminal/panels/trend_panel.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <string>
#include <vector>

#include "insight/text_forms.h"
#include "terminal/panels/cell_words.h"
#include "terminal/panels/kpi_look.h"
#include "terminal/panels/trend_graph.h"

namespace vesk {

namespace {

/// What a graph may show at least, in milliseconds.
constexpr std::array<std::int64_t, 6> kLengths{60'000, 120'000, 300'000, 600'000, 1'800'000, 3'600'000};
constexpr int kLinesForLegend = 12;

/// What the signs stand for that the graph bears.
void drawLegend(const Canvas& canvas, int line, const std::vector<const EventMark*>& marks) {
  int column = TrendGraph::kScaleColumns;
  for (const EventMark& mark : eventMarks()) {
    if (std::find(marks.begin(), marks.end(), &mark) == marks.end()) continue;
    if (column + textWidth(mark.meaning) + 2 > canvas.columns()) return;
    column = canvas.write(column, line, mark.sign, mark.role) + 1;
    column = canvas.write(column, line, mark.meaning, Role::Faint) + 2;
  }
}

}  // namespace

std::span<const Action> TrendPanel::hints() const {
  static constexpr std::array kHints{Action::Help,     Action::Back,   Action::Down,     Action::PageUp,
                                     Action::PageDown, Action::Freeze, Action::Overview, Action::Quit};
  return kHints;
}

void TrendPanel::draw(const Canvas& canvas) {
  const insight::Present& drive = drive_.present();
  const bool hasLegend = canvas.lines() >= kLinesForLegend;
  TrendGraph graph{kpi_, GraphKind::line, signs_, 1000};
  graph.step = roundStep(kLengths[length_], graph.slotsFor(canvas.columns() - 1));
  const TrendSpan span = graph.spanOf(drive, canvas.columns() - 1);
  const auto& description = insight::descriptionOf(kpi_);
  const int end = canvas.write(2, 0, labelOf(kpi_), Role::Title);
  const int nameEnd = canvas.write(end + 2, 0, description.name, Role::Faint);
  if (drive.now()) canvas.write(nameEnd + 2, 0, dateText(*drive.now()), Role::Faint);
  drawFigures(canvas, span.start);
  const int graphLines = canvas.lines() - 3 - (hasLegend ? 1 : 0);
  graph.draw(canvas.part({0, 2, canvas.columns() - 1, graphLines}), drive);
  const int axis = 2 + graphLines;
  canvas.write(TrendGraph::kScaleColumns, axis, "-" + lastingText(span.length()), Role::Faint);
  canvas.writeRight(canvas.columns() - 1, axis, "now", Role::Faint);
  if (hasLegend) drawLegend(canvas, axis + 1, graph.marks(drive, canvas.columns() - 1));
}

void TrendPanel::drawFigures(const Canvas& canvas, std::int64_t start) const {
  const insight::Present& drive = drive_.present();
  int column = 2;
  if (const auto value = drive.value(kpi_)) {
    const std::string grade = gradeText(kpi_, *value);
    column =
        canvas.write(column, 1, valueText(kpi_, *value) + (grade.empty() ? "" : ", " + grade), roleOf(kpi_, *value)) +
        3;
  }
  const auto values = valuesSince(drive.trend().points(kpi_), start);
  if (!values) return;
  const std::string mean = insight::numberText(std::round(values->mean() * 10) / 10);
  canvas.write(column, 1,
               "min " + insight::numberText(values->min) + "  mean " + mean + "  max " +
                   insight::numberText(values->max) + "  of " + std::to_string(values->count),
               Role::Plain);
}

/// To the next KPI that has values, round in a circle.
void TrendPanel::moveToKpi(int step) {
  constexpr int kCount = static_cast<int>(insight::kKpiCount);
  for (int moved = 1; moved < kCount; ++moved) {
    const int index = (static_cast<int>(indexOf(kpi_)) + step * moved + kCount * kCount) % kCount;
    const auto kpi = static_cast<insight::Kpi>(index);
    if (drive_.present().trend().points(kpi).empty()) continue;
    kpi_ = kpi;
    return;
  }
}

void TrendPanel::lengthen(int step) {
  const int last = static_cast<int>(kLengths.size()) - 1;
  length_ = static_cast<std::size_t>(std::clamp(static_cast<int>(length_) + step, 0, last));
}

bool TrendPanel::perform(Action action) {
  if (action == Action::Up) moveToKpi(-1);
  if (action == Action::Down) moveToKpi(+1);
  if (action == Action::PageUp) lengthen(+1);
  if (action == Action::PageDown) lengthen(-1);
  return action != Action::Back;
}

void TrendPanel::scroll(int lines) {
  lengthen(lines < 0 ? +1 : -1);
}

}  // namespace vesk
