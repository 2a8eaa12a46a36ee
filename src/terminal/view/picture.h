#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "terminal/panels/panel.h"
#include "terminal/view/diagnostics_pane.h"
#include "terminal/view/path_bar.h"
#include "terminal/view/table_browser.h"

namespace vesk {

/// The smallest terminal that screens are shown on.
inline constexpr Size kSmallestSize{40, 10};

/// Which lines of the terminal are what. `end` is the line after the last one.
struct Regions {
  struct Lines {
    int start = 0;
    int end = 0;

    [[nodiscard]] int count() const { return end - start; }
    [[nodiscard]] bool has(int line) const { return start <= line && line < end; }
  };

  /// Where a panel draws: the title's line and the list's.
  [[nodiscard]] Rectangle panel(int columns) const { return {0, title, columns, list.end - title}; }

  int bar = 0;
  int title = 1;
  Lines list;
  Lines pane;  ///< with its header line; empty when there is none
  int hints = 0;
  int listColumns = 0;  ///< of the list's lines, without the scroll bar

  [[nodiscard]] static Regions of(Size size, PaneHeight paneHeight);
};

/// The columns of the bar before the path and after the status.
inline constexpr int kBarMargin = 1;

/// Where the status starts on the bar; the column after the bar's text when there is none. The path ends one
/// column before.
[[nodiscard]] int statusColumn(int columns, int statusWidth);

/// All that one drawing of the terminal needs, and nothing that looks further. Views are good as long as the
/// presenter is told nothing.
struct Picture {
  Size size{};
  PathBar path{};
  std::string status{};
  std::string title{};
  std::string freshness{};
  bool isFrozen = false;

  std::vector<ListLine> lines{};
  ScrollExtent extent{};

  /// What shows in the place of title and list; null for a table screen.
  Panel* panel = nullptr;
  std::vector<Action> hints{};

  /// In the place of the hints; empty for none.
  std::string notice{};

  std::string filter{};
  bool isTypingFilter = false;

  /// The first line of the help that shows; absent when the list does.
  std::optional<int> helpStart{};

  PaneHeight paneHeight = PaneHeight::None;
  DiagnosticsPane::Shown pane{};
};

}  // namespace vesk
