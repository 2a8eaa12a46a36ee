#include "terminal/device/difference.h"

#include <array>
#include <string_view>

namespace vesk {

namespace {

struct Stand {
  std::string_view glyph;
  char ascii;
};

/// What a terminal for ASCII shows in the place of this program's own signs.
constexpr std::array kAsciiStands{
    Stand{"›", '>'}, Stand{"•", '*'}, Stand{"…", '~'}, Stand{"·", '-'}, Stand{"↑", '^'}, Stand{"↓", 'v'},
    Stand{"│", '|'}, Stand{"█", '#'}, Stand{"×", 'x'}, Stand{"▏", '_'}, Stand{"–", '-'}, Stand{"░", '.'},
    Stand{"▸", '>'}, Stand{"─", '-'}, Stand{"┆", ':'}, Stand{"┌", '+'}, Stand{"┐", '+'}, Stand{"└", '+'},
    Stand{"┘", '+'}, Stand{"├", '+'}, Stand{"┤", '+'}, Stand{"┬", '+'}, Stand{"┴", '+'}, Stand{"┼", '+'},
    Stand{"▶", '>'}, Stand{"▮", '|'},
};

/// Writes cells to a terminal whose cursor and look it keeps track of.
class Pen {
 public:
  Pen(std::string& out, const Capabilities& terminal) : out_(out), terminal_(terminal) {}

  void draw(const Grid& grid, int column, int line) {
    const Cell& cell = grid.at(column, line);
    if (line != line_ || column != column_) out_ += terminal_.move(column, line);
    if (last_ == nullptr || last_->role != cell.role) {
      out_ += terminal_.plain;
      out_ += terminal_.looks[static_cast<std::size_t>(cell.role)];
    }
    last_ = &cell;
    const bool isWide = column + 1 < grid.size().columns && grid.at(column + 1, line).isRightHalf();
    appendGlyph(cell.glyph(), isWide);
    line_ = line;
    column_ = column + (isWide ? 2 : 1);
    // Where the cursor stands after the last column differs between terminals.
    if (column_ >= grid.size().columns) column_ = -1;
  }

  void finish() {
    if (last_ != nullptr) out_ += terminal_.plain;
  }

 private:
  void appendGlyph(std::string_view glyph, bool isWide) {
    if (terminal_.showsUtf8 || glyph.size() == 1) {
      out_ += glyph;
      return;
    }
    char shown = '?';
    for (const Stand& stand : kAsciiStands) {
      if (stand.glyph == glyph) shown = stand.ascii;
    }
    out_.append(isWide ? 2 : 1, shown);
  }

  std::string& out_;
  const Capabilities& terminal_;
  const Cell* last_ = nullptr;
  int column_ = -1;
  int line_ = -1;
};

}  // namespace

void appendDifference(std::string& out, const Grid& shown, const Grid& wanted, const Capabilities& terminal) {
  const bool isNew = shown.size() != wanted.size();
  const Grid cleared(isNew ? wanted.size() : Size{});
  const Grid& present = isNew ? cleared : shown;
  if (isNew) {
    out += terminal.plain;
    out += terminal.clear;
  }
  if (present == wanted) return;
  Pen pen(out, terminal);
  for (int line = 0; line < wanted.size().lines; ++line) {
    for (int column = 0; column < wanted.size().columns; ++column) {
      const Cell& cell = wanted.at(column, line);
      if (!cell.isRightHalf() && cell != present.at(column, line)) pen.draw(wanted, column, line);
    }
  }
  pen.finish();
}

}  // namespace vesk
