#pragma once

#include <array>
#include <cstddef>
#include <string_view>

namespace vesk::insight {

enum class Technology { lte, umts, gsm };

inline constexpr std::array kTechnologies{Technology::lte, Technology::umts, Technology::gsm};

[[nodiscard]] constexpr std::size_t indexOf(Technology technology) {
  return static_cast<std::size_t>(technology);
}

/// "LTE", "UMTS", "GSM".
[[nodiscard]] constexpr std::string_view nameOf(Technology technology) {
  constexpr std::array<std::string_view, kTechnologies.size()> kNames{"LTE", "UMTS", "GSM"};
  return kNames[indexOf(technology)];
}

}  // namespace vesk::insight
