#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>

#include "insight/present.h"
#include "terminal/device/signs.h"
#include "terminal/input/key_bindings.h"
#include "terminal/panels/canvas.h"
#include "terminal/panels/shown_drive.h"

namespace vesk {

/// A screen over the table screens, of what the drive comes to. It draws itself into the space between bar and hints.
class Panel {
 public:
  Panel() = default;
  virtual ~Panel() = default;
  Panel(const Panel&) = delete;
  Panel& operator=(const Panel&) = delete;

  /// For the path.
  [[nodiscard]] virtual std::string_view title() const = 0;
  /// The keys that the line of hints names.
  [[nodiscard]] virtual std::span<const Action> hints() const = 0;

  virtual void draw(const Canvas& canvas) = 0;

  /// False for a key that means nothing here.
  virtual bool perform(Action action) = 0;
  /// At a place of what was drawn last.
  virtual void click(int column, int line) = 0;
  virtual void scroll(int lines) = 0;

  /// Null for a panel that has none.
  [[nodiscard]] virtual const std::string* filter() const { return nullptr; }
  // NOLINTNEXTLINE(performance-unnecessary-value-param): a panel that has one moves it
  virtual void setFilter(std::string /*filter*/) {}
};

/// What opens a panel from another one.
class PanelOpener {
 public:
  virtual void openTrend(insight::Kpi kpi) = 0;
  /// With the event selected that has that number; absent for the newest.
  virtual void openTimeline(std::optional<std::uint64_t> number) = 0;
  virtual void openCells() = 0;

 protected:
  ~PanelOpener() = default;
};

}  // namespace vesk
