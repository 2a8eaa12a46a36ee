#pragma once

#include <cstdio>
#include <string_view>

namespace vesk::bench {

/// Writes one measured figure as a line of tab-separated words: the row, the recording's number of events, the
/// quantity, the figure. table.awk makes the table of such lines.
inline void writeFact(std::string_view row, std::size_t events, std::string_view quantity, double figure) {
  std::printf("%.*s\t%zu\t%.*s\t%.6g\n", static_cast<int>(row.size()), row.data(), events,
              static_cast<int>(quantity.size()), quantity.data(), figure);
}

}  // namespace vesk::bench
