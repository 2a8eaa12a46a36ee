#pragma once

#include <optional>
#include <string>

#include "terminal/view/surroundings.h"

namespace vesk {

/// "2 s ago, 14 times", "never".
struct Freshness {
  std::string text;
  /// How long until the text will be another one, in the drive's time; absent for never.
  std::optional<std::chrono::milliseconds> untilChange{};
};

[[nodiscard]] Freshness freshnessOf(const Arrivals& arrivals, std::chrono::milliseconds now);
/// The age alone: "2 s", or nothing.
[[nodiscard]] Freshness ageOf(const Arrivals& arrivals, std::chrono::milliseconds now);

}  // namespace vesk
