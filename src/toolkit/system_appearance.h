#pragma once

#include <compare>

namespace vesk {

struct PlatformVersion {
  int release = 0;
  int update = 0;

  friend auto operator<=>(const PlatformVersion&, const PlatformVersion&) = default;
};

/// The version of the platform whose toolkit this is: 13.0 unless another was set.
[[nodiscard]] PlatformVersion platformVersion();
/// For trying how screens behave on another version. Main queue only.
void setPlatformVersion(PlatformVersion version);

enum class Color {
  /// The system's standard background, which follows the light or dark appearance.
  SystemBackground,
};

}  // namespace vesk
