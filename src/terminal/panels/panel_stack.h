#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "terminal/panels/cells_panel.h"
#include "terminal/panels/overview_panel.h"
#include "terminal/panels/panel.h"
#include "terminal/panels/timeline_panel.h"
#include "terminal/panels/trend_panel.h"

namespace vesk {

/// The panels that lie over the table screens; the last one opened shows. Each kind is there once, so that it is found
/// again as it was left.
class PanelStack final : private PanelOpener {
 public:
  /// `insight` must outlive the stack. `goToEvent` may be empty.
  PanelStack(const insight::Present& drive, TimelinePanel::GoToEvent goToEvent, Signs signs);
  PanelStack(const PanelStack&) = delete;
  PanelStack& operator=(const PanelStack&) = delete;

  /// The panel that shows; null while none does.
  [[nodiscard]] Panel* top() const { return shown_.empty() ? nullptr : shown_.back(); }
  /// From the first one opened to the one that shows.
  [[nodiscard]] const std::vector<Panel*>& shown() const { return shown_; }
  /// Closes panels until `count` are left.
  void close(std::size_t count = 0);

  /// What a key does with panels: it opens one, or is for the one that shows. `rowKpi` is the KPI in the selected row
  /// of the table screen. False for a key that has nothing to do with panels.
  bool perform(Action action, std::optional<insight::Kpi> rowKpi);

  /// Holds what the panels show while the drive goes on.
  void setHeld(bool isHeld) { drive_.setHeld(isHeld); }

 private:
  void openTrend(insight::Kpi kpi) override;
  void openTimeline(std::optional<std::uint64_t> number) override;
  void openCells() override { show(cells_); }
  void show(Panel& panel);

  ShownDrive drive_;
  OverviewPanel overview_;
  TrendPanel trend_;
  TimelinePanel timeline_;
  CellsPanel cells_;
  std::vector<Panel*> shown_;
};

}  // namespace vesk
