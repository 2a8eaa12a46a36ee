#pragma once

#include <optional>

#include "terminal/panels/cell_table.h"
#include "terminal/panels/list_window.h"
#include "terminal/panels/panel.h"

namespace vesk {

/// All cells heard, in an order to be chosen.
class CellsPanel : public Panel {
 public:
  explicit CellsPanel(const ShownDrive& drive) : drive_(drive) {}

  [[nodiscard]] std::string_view title() const override { return "Cells"; }
  [[nodiscard]] std::span<const Action> hints() const override;
  void draw(const Canvas& canvas) override;
  bool perform(Action action) override;
  void click(int column, int line) override;
  void scroll(int lines) override { window_.scroll(lines); }

 private:
  void refresh();

  const ShownDrive& drive_;
  /// Absent for the order by role, technology and level.
  std::optional<CellOrder> order_;
  std::vector<insight::HeardCell> cells_;
  /// The cell of the selected row.
  std::optional<insight::HeardKey> selected_;
  ListWindow window_;
  int height_ = 1;
  /// The table as it was drawn last.
  std::optional<CellTable> table_;
};

}  // namespace vesk
