#include "terminal/panels/trend_graph.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <span>
#include <string>

#include "insight/text_forms.h"
#include "terminal/panels/event_marks.h"
#include "terminal/panels/kpi_look.h"

namespace vesk {

namespace {

using Slots = std::vector<std::optional<TrendValues>>;

constexpr int kDotColumns = 2;
constexpr int kDotRows = 4;

constexpr std::array<std::string_view, 9> kEighths{" ", "▁", "▂", "▃", "▄", "▅", "▆", "▇", "█"};
constexpr std::array<std::string_view, 3> kHalves{" ", "▄", "█"};
constexpr std::array<std::string_view, 2> kWhole{" ", "█"};

/// How a cell looks that is filled from below, from empty to full.
std::span<const std::string_view> fillings(Signs signs) {
  switch (signs) {
    case Signs::ascii:
      return kWhole;
    case Signs::blocks:
      return kHalves;
    case Signs::braille:
      break;
  }
  return kEighths;
}

void drawBars(const Canvas& canvas, const Slots& slots, const TrendScale& scale, insight::Kpi kpi, Signs signs) {
  const auto signsOfFilling = fillings(signs);
  const int full = static_cast<int>(signsOfFilling.size()) - 1;
  for (std::size_t slot = 0; slot < slots.size(); ++slot) {
    if (!slots[slot]) continue;
    const double value = slots[slot]->mean();
    // Even the lowest value shows.
    int height = std::max(static_cast<int>(std::lround((value - scale.low) / scale.step * full)), 1);
    for (int row = canvas.lines() - 1; row >= 0 && height > 0; --row, height -= full) {
      canvas.write(static_cast<int>(slot), row, signsOfFilling[static_cast<std::size_t>(std::min(height, full))],
                   roleOf(kpi, value));
    }
  }
}

/// Dots of Braille patterns, two by four a cell.
class DotField {
 public:
  DotField(int columns, int lines)
      : columns_(columns), lines_(lines), cells_(static_cast<std::size_t>(columns) * static_cast<std::size_t>(lines)) {}

  /// `row` counts dots from below.
  void set(int column, int row) {
    // The bits of a pattern, by row from above, for the left and the right column.
    constexpr std::array<std::array<unsigned, kDotColumns>, kDotRows> kBits{
        {{0x01, 0x08}, {0x02, 0x10}, {0x04, 0x20}, {0x40, 0x80}}};
    const int fromAbove = std::clamp(lines_ * kDotRows - 1 - row, 0, lines_ * kDotRows - 1);
    const int cell = fromAbove / kDotRows * columns_ + column / kDotColumns;
    cells_[static_cast<std::size_t>(cell)] |=
        kBits[static_cast<std::size_t>(fromAbove % kDotRows)][static_cast<std::size_t>(column % kDotColumns)];
  }

  template <class RoleOfRow>
  void draw(const Canvas& canvas, RoleOfRow roleOfRow) const {
    std::size_t cell = 0;
    for (int line = 0; line < lines_; ++line) {
      for (int column = 0; column < columns_; ++column, ++cell) {
        if (cells_[cell] == 0) continue;
        // U+2800 and the bits above it, in UTF-8.
        const std::array<char, 3> pattern{'\xE2', static_cast<char>(0xA0 | cells_[cell] >> 6),
                                          static_cast<char>(0x80 | (cells_[cell] & 0x3F))};
        canvas.write(column, line, {pattern.data(), pattern.size()}, roleOfRow(line));
      }
    }
  }

 private:
  int columns_;
  int lines_;
  std::vector<unsigned> cells_;
};

/// `cuts` are the slots that no line leads to from the one before.
void drawDots(const Canvas& canvas, const Slots& slots, const std::vector<bool>& cuts, const TrendScale& scale,
              insight::Kpi kpi) {
  DotField dots(canvas.columns(), canvas.lines());
  const auto rowOf = [&](double value) {
    return static_cast<int>(std::floor((value - scale.low) / scale.step * kDotRows));
  };
  std::optional<int> before;
  for (std::size_t slot = 0; slot < slots.size(); ++slot) {
    if (!slots[slot] || cuts[slot]) before.reset();
    if (!slots[slot]) continue;
    const int mean = rowOf(slots[slot]->mean());
    const int low = std::min(rowOf(slots[slot]->min), before ? std::min(*before, mean) : mean);
    const int high = std::max(rowOf(slots[slot]->max), before ? std::max(*before, mean) : mean);
    for (int row = low; row <= high; ++row)
      dots.set(static_cast<int>(slot), row);
    before = mean;
  }
  dots.draw(canvas, [&](int line) { return roleOf(kpi, scale.low + (canvas.lines() - line - 0.5) * scale.step); });
}

/// `first` is what the lowest row is labelled with.
void drawScale(const Canvas& canvas, double first, double step, int rows) {
  constexpr int kMostLabels = 14;
  const int every = rows / kMostLabels + 1;
  for (int row = 0; row < rows; row += every) {
    const std::string label = insight::numberText(first + row * step);
    canvas.writeRight(TrendGraph::kScaleColumns - 1, rows - 1 - row, label, Role::Faint);
  }
}

void drawMarks(const Canvas& canvas, int line, const std::vector<const EventMark*>& marks) {
  for (std::size_t place = 0; place < marks.size(); ++place)
    if (const EventMark* mark = marks[place])
      canvas.write(TrendGraph::kScaleColumns + static_cast<int>(place), line, mark->sign, mark->role);
}

}  // namespace

TrendScale TrendScale::covering(double min, double max, int rows) {
  constexpr std::array kSteps{1.0, 2.0, 5.0, 10.0, 20.0, 50.0, 100.0};
  for (const double step : kSteps) {
    const double low = std::ceil(min / step - 1) * step;
    if (low + rows * step >= max) {
      // What is left over is divided between above and below.
      const double spare = std::floor((low + rows * step - max) / step / 2) * step;
      return {low - spare, step};
    }
  }
  return {std::floor(min), std::ceil((max - min + 1) / std::max(rows, 1))};
}

std::int64_t roundStep(std::int64_t length, int slots) {
  constexpr std::array<std::int64_t, 9> kSteps{1000, 2000, 5000, 10'000, 15'000, 30'000, 60'000, 120'000, 300'000};
  const auto* found =
      std::find_if(kSteps.begin(), kSteps.end(), [&](std::int64_t step) { return step * slots >= length; });
  return found == kSteps.end() ? kSteps.back() : *found;
}

int TrendGraph::slotsFor(int columns) const {
  return std::max(columns - kScaleColumns, 1) * (isDotted() ? kDotColumns : 1);
}

TrendSpan TrendGraph::spanOf(const insight::Present& drive, int columns) const {
  return TrendSpan::endingAt(drive.position(), step, slotsFor(columns));
}

std::vector<const EventMark*> TrendGraph::marks(const insight::Present& drive, int columns) const {
  return marksOf(drive, spanOf(drive, columns), isDotted() ? kDotColumns : 1);
}

void TrendGraph::draw(const Canvas& canvas, const insight::Present& drive) const {
  const TrendSpan span = spanOf(drive, canvas.columns());
  const int rows = canvas.lines() - 1;
  if (rows < 1) return;
  drawMarks(canvas, rows, marks(drive, canvas.columns()));
  const std::vector<insight::Moment> breaks = breaksOf(drive);
  const Slots slots = slotValues(drive.trend().points(kpi), span, breaks);
  std::optional<TrendValues> range;
  for (const auto& values : slots) {
    if (!values) continue;
    if (!range) range = *values;
    range->min = std::min(range->min, values->min);
    range->max = std::max(range->max, values->max);
  }
  if (!range) {
    canvas.write(kScaleColumns, rows / 2, "no value in this time", Role::Faint);
    return;
  }
  const TrendScale scale = TrendScale::covering(range->min, range->max, rows);
  // A bar has the label's value where it fills the row, a line where it enters the row.
  drawScale(canvas, isDotted() ? scale.low : scale.low + scale.step, scale.step, rows);
  const Canvas field = canvas.part({kScaleColumns, 0, canvas.columns() - kScaleColumns, rows});
  if (isDotted()) {
    std::vector<bool> cuts(slots.size());
    for (const insight::Moment& each : breaks)
      if (const auto slot = span.slotOf(each.position)) cuts[static_cast<std::size_t>(*slot)] = true;
    drawDots(field, slots, cuts, scale, kpi);
  } else {
    drawBars(field, slots, scale, kpi, signs);
  }
}

}  // namespace vesk
