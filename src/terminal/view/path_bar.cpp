#include "terminal/view/path_bar.h"

#include <string_view>

#include "terminal/device/column_width.h"

namespace vesk {

PathBar layOutPath(const std::vector<std::string>& names, int width) {
  constexpr std::string_view kSeparator = " › ";
  constexpr int kSeparatorWidth = 3;

  std::size_t first = names.size();
  int used = 0;
  while (first > 0) {
    const int more = textWidth(names[first - 1]) + (used > 0 ? kSeparatorWidth : 0);
    const int dots = first > 1 ? 1 + kSeparatorWidth : 0;
    if (used > 0 && used + more + dots > width) break;
    used += more;
    --first;
  }
  PathBar bar;
  if (first > 0) bar.text = "…";
  int column = first > 0 ? 1 : 0;
  for (std::size_t index = first; index < names.size(); ++index) {
    if (index > 0) {
      bar.text += kSeparator;
      column += kSeparatorWidth;
    }
    const int end = column + textWidth(names[index]);
    bar.text += names[index];
    bar.segments.push_back({index + 1, column, end});
    column = end;
  }
  return bar;
}

}  // namespace vesk
