#pragma once

#include <string>

#include "insight/insight.h"

/// The summary of a drive for people and for scripts.
namespace vesk::insight {

/// One JSON object. Shares are 0 to 1, null where the whole is 0; statistics without values are null.
[[nodiscard]] std::string summaryJson(const Insight& insight);

/// Lines of at most 80 columns, `height` at most: what does not fit of the cells is left out.
[[nodiscard]] std::string summaryText(const Insight& insight, std::size_t height = 24);

}  // namespace vesk::insight
