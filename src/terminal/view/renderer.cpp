#include "terminal/view/renderer.h"

#include <algorithm>
#include <array>

#include "terminal/device/column_width.h"
#include "terminal/input/key_bindings.h"
#include "terminal/view/wrapping.h"
#include "values/text_form.h"

namespace vesk {

namespace {

struct HelpLine {
  std::string keys;
  std::string_view meaning;
};

std::vector<HelpLine> makeHelp() {
  std::vector<HelpLine> help;
  for (const KeyBinding& binding : keyBindings())
    help.push_back({namesOf(binding), binding.help});
  for (const TypingBinding& binding : typingBindings())
    help.push_back({std::string(binding.name), binding.help});
  help.push_back({"click", "select and open a row; on the path: go back; on the scroll bar: go there"});
  help.push_back({"wheel, drag", "scroll"});
  return help;
}

const std::vector<HelpLine>& help() {
  static const std::vector<HelpLine> lines = makeHelp();
  return lines;
}

/// Where the meanings start.
int helpIndent() {
  int keysWidth = 0;
  for (const HelpLine& each : help())
    keysWidth = std::max(keysWidth, textWidth(each.keys));
  return kRowGutter + keysWidth + 2;
}

/// The help with its meanings wrapped; the keys stand at the first line of theirs.
std::vector<HelpLine> helpLines(int columns) {
  std::vector<HelpLine> lines;
  for (const HelpLine& each : help()) {
    const std::size_t first = lines.size();
    for (const std::string_view line : wrapText(each.meaning, columns - helpIndent()))
      lines.push_back({{}, line});
    lines[first].keys = each.keys;
  }
  return lines;
}

/// Draws one picture into one grid.
class Renderer {
 public:
  explicit Renderer(const Picture& picture)
      : picture_(picture), regions_(Regions::of(picture.size, picture.paneHeight)), grid_(picture.size) {}

  Grid run() {
    if (width() < kSmallestSize.columns || picture_.size.lines < kSmallestSize.lines) {
      drawTooSmall();
      return std::move(grid_);
    }
    drawBar();
    if (picture_.helpStart) {
      drawTitle();
      drawHelp();
    } else if (picture_.panel != nullptr) {
      picture_.panel->draw(Canvas(grid_, regions_.panel(width())));
      drawFrozenMark();
    } else {
      drawTitle();
      drawList();
      drawScrollBar();
    }
    drawPane();
    drawHints();
    return std::move(grid_);
  }

 private:
  [[nodiscard]] int width() const { return picture_.size.columns; }

  int writeCut(int column, int line, std::string_view text, Role role, int end) {
    return grid_.writeCut(column, line, text, role, end);
  }

  void drawTooSmall() { grid_.write(0, 0, "too small", Role::Plain, width()); }

  void drawBar() {
    const int line = regions_.bar;
    grid_.fill(0, line, Role::Bar, width());
    const int status = statusColumn(width(), textWidth(picture_.status));
    writeCut(status, line, picture_.status, Role::BarStatus, width() - kBarMargin);
    writeCut(kBarMargin, line, picture_.path.text, Role::Bar, status - 1);
  }

  void drawTitle() {
    const int line = regions_.title;
    const int end = drawFrozenMark();
    const std::string_view title = picture_.helpStart ? "Keys" : std::string_view(picture_.title);
    const int freshnessWidth = picture_.freshness.empty() ? 0 : textWidth(picture_.freshness) + 2;
    const int titleEnd = std::max(end - freshnessWidth, kRowGutter + 8);
    const int column = writeCut(kRowGutter, line, title, Role::Title, titleEnd);
    if (!picture_.helpStart) writeCut(column + 2, line, picture_.freshness, Role::Faint, end);
  }

  /// Where the columns before the mark end.
  int drawFrozenMark() {
    constexpr std::string_view kMark = " HELD ";
    const int end = width() - 1;
    if (!picture_.isFrozen) return end;
    const int start = end - static_cast<int>(kMark.size());
    grid_.write(start, regions_.title, kMark, Role::FrozenMark, end);
    return start - 1;
  }

  void drawList() {
    int line = regions_.list.start;
    for (const ListLine& each : picture_.lines) {
      if (each.isHeader) {
        writeCut(1, line, each.text.name, Role::SectionHeader, regions_.listColumns);
      } else {
        drawRowLine(line, each);
      }
      ++line;
    }
    if (picture_.lines.empty() && !picture_.filter.empty()) {
      grid_.write(kRowGutter, line, "no row has this", Role::Faint, regions_.listColumns);
    }
  }

  void drawRowLine(int line, const ListLine& row) {
    Role name = Role::Plain;
    Role value = row.isChanged ? Role::Changed : Role::Value;
    Role aside = Role::Faint;
    if (row.isSelected) {
      name = Role::Selected;
      value = row.isChanged ? Role::SelectedChanged : Role::Selected;
      aside = Role::Selected;
      grid_.fill(0, line, Role::Selected, regions_.listColumns);
    }
    const int columns = row.hasDisclosure ? std::min(regions_.listColumns, kWidestPair) : regions_.listColumns;
    const int end = rowTextEnd(columns, row.hasDisclosure);
    if (row.isFirstOfRow && row.isChanged) grid_.write(0, line, "•", value, end);
    if (row.isFirstOfRow && row.hasDisclosure) grid_.write(end + 1, line, "›", name, end + 2);
    if (row.text.valueIndent) {
      writeRowText(kRowGutter + *row.text.valueIndent, line, row.text.value, value, end, row.text.isCut);
    } else if (row.text.value.empty()) {
      writeRowText(kRowGutter, line, row.text.name, name, end, row.text.isCut);
      if (!row.note.empty()) grid_.write(end - textWidth(row.note), line, row.note, aside, end);
    } else {
      drawNameAndValue(line, row.text, name, value, row.text.valueEnd.value_or(end));
      if (!row.text.reading.empty()) grid_.write(*row.text.valueEnd + kRowGap, line, row.text.reading, aside, end);
    }
  }

  /// A value that fits stands at the right; one that does not follows its name, which gets at most half.
  void drawNameAndValue(int line, const RowLine& text, Role name, Role value, int end) {
    if (!text.isCut) {
      grid_.write(kRowGutter, line, text.name, name, end);
      grid_.write(end - textWidth(text.value), line, text.value, value, end);
      return;
    }
    const int nameEnd = writeCut(kRowGutter, line, text.name, name, (kRowGutter + end) / 2);
    writeCut(nameEnd + 2, line, text.value, value, end);
  }

  void writeRowText(int column, int line, std::string_view text, Role role, int end, bool isCut) {
    if (!isCut) {
      writeCut(column, line, text, role, end);
      return;
    }
    column = grid_.write(column, line, text, role, end - 1);
    grid_.write(column, line, "…", role, end);
  }

  void drawScrollBar() {
    const ScrollExtent& extent = picture_.extent;
    if (extent.total <= extent.shown) return;
    const int height = regions_.list.count();
    const int thumb = extent.thumb(height);
    const int start = extent.thumbStart(height);
    for (int line = 0; line < height; ++line) {
      const bool isThumb = start <= line && line < start + thumb;
      grid_.write(regions_.listColumns, regions_.list.start + line, isThumb ? "█" : "│", Role::Faint, width());
    }
  }

  void drawHelp() {
    int line = regions_.list.start;
    const std::vector<HelpLine> lines = helpLines(width());
    for (auto index = static_cast<std::size_t>(*picture_.helpStart); index < lines.size() && line < regions_.list.end;
         ++index, ++line) {
      grid_.write(kRowGutter, line, lines[index].keys, Role::Key, width());
      grid_.write(helpIndent(), line, lines[index].meaning, Role::Plain, width());
    }
  }

  void drawPane() {
    if (regions_.pane.count() == 0) return;
    int line = regions_.pane.start;
    grid_.fill(0, line, Role::PaneHeader, width());
    std::string count;
    if (picture_.pane.end < picture_.pane.total) {
      appendDecimal(count, picture_.pane.end);
      count += " of ";
    }
    appendDecimal(count, picture_.pane.total);
    count += picture_.pane.total == 1 ? " line" : " lines";
    grid_.write(kBarMargin, line, "Diagnostics", Role::PaneHeader, width());
    grid_.write(width() - kBarMargin - textWidth(count), line, count, Role::PaneHeader, width());
    for (const std::string_view each : picture_.pane.lines)
      writeCut(kBarMargin, ++line, each, Role::Plain, width());
  }

  void drawHints() {
    const int line = regions_.hints;
    int column = kBarMargin;
    // What is being typed is to be seen.
    if (!picture_.notice.empty() && !picture_.isTypingFilter) {
      writeCut(column, line, picture_.notice, Role::Alarm, width());
      return;
    }
    if (picture_.isTypingFilter || !picture_.filter.empty()) {
      column = grid_.write(column, line, "/", Role::Prompt, width());
      column = grid_.write(column, line, endOf(picture_.filter, width() / 2 - column), Role::Prompt, width() / 2);
      if (picture_.isTypingFilter) {
        column = grid_.write(column, line, "▏", Role::Prompt, width()) + 1;
        column = drawHint(column, "Enter", "keep");
        drawHint(column, "Esc", "clear");
        return;
      }
      column += 2;
    }
    for (const Action action : picture_.hints) {
      const KeyBinding& binding = bindingOf(action);
      const bool letsGo = action == Action::Freeze && picture_.isFrozen;
      column = drawHint(column, nameOf(*binding.keys.begin()), letsGo ? "go on" : binding.hint);
    }
  }

  /// As much of the end of `text` as fits, where one types, with an ellipsis before it.
  static std::string endOf(std::string_view text, int columns) {
    if (textWidth(text) <= columns) return std::string(text);
    while (textWidth(text) >= columns)
      takeGlyph(text);
    return "…" + std::string(text);
  }

  /// The column after the hint, or the width when it did not fit and nothing after it shall.
  int drawHint(int column, std::string_view key, std::string_view hint) {
    const int line = regions_.hints;
    if (column + textWidth(key) + 1 + textWidth(hint) > width()) return width();
    column = grid_.write(column, line, key, Role::Key, width());
    return grid_.write(column + 1, line, hint, Role::Faint, width()) + 2;
  }

  const Picture& picture_;
  const Regions regions_;
  Grid grid_;
};

}  // namespace

Regions Regions::of(Size size, PaneHeight height) {
  constexpr int kSmallestPane = 3;
  constexpr int kTallestThird = 12;
  Regions regions;
  regions.hints = size.lines - 1;
  const int third = std::clamp(size.lines / 3, kSmallestPane, kTallestThird);
  const int paneHeight =
      height == PaneHeight::Half ? std::max(size.lines / 2, third) : (height == PaneHeight::Third ? third : 0);
  regions.pane = {regions.hints - paneHeight, regions.hints};
  regions.list = {regions.title + 1, regions.pane.start};
  regions.listColumns = size.columns - 1;
  return regions;
}

int statusColumn(int columns, int statusWidth) {
  constexpr int kLeastPath = 14;
  const int end = columns - kBarMargin;
  return statusWidth > 0 ? std::max(end - statusWidth, kBarMargin + kLeastPath + 1) : end + 1;
}

Grid render(const Picture& picture) {
  return Renderer(picture).run();
}

int helpLineCount(int columns) {
  return static_cast<int>(helpLines(columns).size());
}

}  // namespace vesk
