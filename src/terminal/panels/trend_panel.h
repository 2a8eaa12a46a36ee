#pragma once

#include <cstddef>

#include "terminal/panels/panel.h"

namespace vesk {

/// A KPI's course over the whole screen.
class TrendPanel : public Panel {
 public:
  TrendPanel(const ShownDrive& drive, Signs signs) : drive_(drive), signs_(signs) {}

  void show(insight::Kpi kpi) { kpi_ = kpi; }

  [[nodiscard]] std::string_view title() const override { return "Trend"; }
  [[nodiscard]] std::span<const Action> hints() const override;
  void draw(const Canvas& canvas) override;
  bool perform(Action action) override;
  void click(int /*column*/, int /*line*/) override {}
  void scroll(int lines) override;

 private:
  void moveToKpi(int step);
  void lengthen(int step);
  void drawFigures(const Canvas& canvas, std::int64_t start) const;

  const ShownDrive& drive_;
  Signs signs_;
  insight::Kpi kpi_ = insight::Kpi::lteRsrp;
  /// Which of the lengths of time shows.
  std::size_t length_ = 2;
};

}  // namespace vesk
