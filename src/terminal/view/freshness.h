#pragma once

#include <optional>
#include <string>

#include "terminal/view/surroundings.h"

namespace vesk {

/// "2 s ago, 14 times", "never".
struct Freshness {
  std::string text;
  /// When the text will be another one by the passing of time.
  std::optional<Clock::Instant> nextChange{};
};

[[nodiscard]] Freshness freshnessOf(const Arrivals& arrivals, Clock::Instant now);

}  // namespace vesk
