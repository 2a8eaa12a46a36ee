#pragma once

#include <cstddef>
#include <string>
#include <vector>

namespace vesk {

/// A screen's name on the bar: clicking the columns from `column` up to `end` goes back to it.
struct PathSegment {
  std::size_t depth;  ///< screens of the stack up to and including this one
  int column;
  int end;
};

/// The way to the present screen as it fits into some columns.
struct PathBar {
  std::string text;
  std::vector<PathSegment> segments;
};

/// "Vesk › LTE › Tx Power". When it does not fit, names are left out from the left, for "… › Tx Power"; the
/// last one always stays, and is cut by whoever draws it.
[[nodiscard]] PathBar layOutPath(const std::vector<std::string>& names, int width);

}  // namespace vesk
