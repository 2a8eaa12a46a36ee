#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "insight/present.h"
#include "terminal/device/signs.h"
#include "terminal/panels/canvas.h"
#include "terminal/panels/event_marks.h"
#include "terminal/panels/trend_span.h"

namespace vesk {

/// Which values the rows of a graph stand for: the lowest from `low` to `low + step`.
struct TrendScale {
  double low;
  double step;

  /// Of round numbers, such that `rows` rows have all values from `min` to `max`.
  [[nodiscard]] static TrendScale covering(double min, double max, int rows);
};

enum class GraphKind {
  /// A column for every slot, up to its mean.
  bars,
  /// The range of every slot, joined to a line. Only braille signs can; others draw bars.
  line,
};

/// A graph of a KPI up to now, with its scale at the left and marks of what happened below.
struct TrendGraph {
  insight::Kpi kpi;
  GraphKind kind;
  Signs signs;
  /// What one slot is; milliseconds.
  std::int64_t step;

  /// The columns that the scale takes.
  static constexpr int kScaleColumns = 6;

  /// Slots for a graph that takes `columns` with its scale.
  [[nodiscard]] int slotsFor(int columns) const;
  [[nodiscard]] TrendSpan spanOf(const insight::Present& drive, int columns) const;
  /// What stands below it, by column; null where nothing does.
  [[nodiscard]] std::vector<const EventMark*> marks(const insight::Present& drive, int columns) const;
  void draw(const Canvas& canvas, const insight::Present& drive) const;

 private:
  [[nodiscard]] bool isDotted() const { return kind == GraphKind::line && signs == Signs::braille; }
};

/// Of round lengths, the shortest step with which `slots` slots show at least `length`.
[[nodiscard]] std::int64_t roundStep(std::int64_t length, int slots);

}  // namespace vesk
