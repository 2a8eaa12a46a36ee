#pragma once

#include <functional>
#include <string_view>
#include <vector>

#include "bench/corpus.h"

namespace vesk::bench {

/// One thing that is measured in this process.
struct Row {
  std::string_view name;
  /// Takes every event of the corpus once.
  std::function<void()> pass;
};

/// All rows over `corpus`, which must outlive them.
[[nodiscard]] std::vector<Row> rowsOver(const Corpus& corpus);

}  // namespace vesk::bench
