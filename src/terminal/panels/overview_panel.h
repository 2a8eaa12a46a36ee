#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

#include "terminal/panels/overview_layout.h"
#include "terminal/panels/panel.h"

namespace vesk {

/// Where the phone is and how it is doing, on one screen.
class OverviewPanel : public Panel {
 public:
  /// `opener` must outlive the panel.
  OverviewPanel(const ShownDrive& drive, Signs signs, PanelOpener& opener)
      : drive_(drive), signs_(signs), opener_(opener) {}

  [[nodiscard]] std::string_view title() const override { return "Overview"; }
  [[nodiscard]] std::span<const Action> hints() const override;
  void draw(const Canvas& canvas) override;
  bool perform(Action action) override;
  void click(int column, int line) override;
  void scroll(int lines) override { moveSelection(lines < 0 ? -1 : +1); }

 private:
  /// Absent while the technology is unknown.
  [[nodiscard]] std::optional<insight::Kpi> selectedKpi() const;
  void moveSelection(int step);
  void drawPane(const Canvas& canvas, PaneKind kind);
  void drawFrames(const Canvas& canvas) const;
  void drawTitle(const Canvas& canvas, const Pane& pane) const;
  void drawTrend(const Canvas& canvas) const;
  void drawRecent(const Canvas& canvas) const;
  void drawCells(const Canvas& canvas) const;
  void drawHappenings(const Canvas& canvas);

  const ShownDrive& drive_;
  Signs signs_;
  PanelOpener& opener_;
  /// Among the KPIs of the serving cell.
  std::size_t selected_ = 0;
  /// As it was drawn last.
  OverviewLayout layout_;
  /// The numbers of the events that were drawn, from above.
  std::vector<std::uint64_t> shownEvents_;
};

}  // namespace vesk
