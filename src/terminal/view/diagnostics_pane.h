#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

#include "terminal/device/grid.h"
#include "terminal/view/diagnostic_lines.h"

namespace vesk {

/// How much of the terminal the pane takes.
enum class PaneHeight { None, Third, Half };

/// Where a user looks in the diagnostic lines. Long ones are wrapped; a place that was scrolled to is kept while newer
/// lines come.
class DiagnosticsPane {
 public:
  /// `lines` may be null, and must outlive the pane.
  explicit DiagnosticsPane(const DiagnosticLines* lines) : lines_(lines) {}

  struct Shown {
    /// Good until the next line comes.
    std::vector<std::string_view> lines{};
    /// The number of the last line that shows, counted from 1, and of the last one there is.
    std::uint64_t end = 0;
    std::uint64_t total = 0;
  };

  [[nodiscard]] PaneHeight height() const { return height_; }
  /// From none to a third, from there to half, from there to none.
  void changeHeight();
  /// By wrapped lines, to newer ones when positive, in a pane with that room for them.
  void scroll(int lines, Size room);
  [[nodiscard]] Shown shown(Size room);

 private:
  /// A wrapped line, from the bottom: how many of that line's stand below it.
  struct Place {
    std::uint64_t number;
    int below;
  };

  [[nodiscard]] std::vector<std::string_view> wrapped(std::uint64_t number, int columns) const;
  [[nodiscard]] bool moveUp(Place& place, int columns) const;
  [[nodiscard]] bool moveDown(Place& place, int columns) const;

  const DiagnosticLines* lines_;
  PaneHeight height_ = PaneHeight::None;
  /// The lowest wrapped line that shows; absent while the newest one does.
  std::optional<Place> bottom_;
};

}  // namespace vesk
