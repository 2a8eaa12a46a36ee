#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <string_view>

#include "terminal/device/grid.h"

namespace vesk {

enum class ColorDepth {
  None,
  Sixteen,  ///< only the first eight are used, which every such terminal has
  TwoHundredFiftySix,
};

enum class Background {
  Unknown,  ///< colours are then chosen to be readable on both
  Light,
  Dark,
};

/// How a role looks. An absent colour is the terminal's own.
struct Look {
  std::optional<std::uint8_t> foreground{};
  std::optional<std::uint8_t> background{};
  bool isBold = false;
  bool isReversed = false;
  bool isUnderlined = false;

  friend bool operator==(const Look&, const Look&) = default;
};

using Palette = std::array<Look, kRoleCount>;

/// Every meaning of a colour has a second sign (bold, reverse, a mark in the text), so that none is lost
/// without colours.
[[nodiscard]] Palette makePalette(ColorDepth depth, Background background);

/// What the environment says of the background: COLORFGBG's last number, where a terminal sets it.
[[nodiscard]] Background backgroundOf(std::string_view colorfgbg);

/// `colors` is terminfo's number. A NO_COLOR that is not empty switches colours off.
[[nodiscard]] ColorDepth colorDepthOf(int colors, std::string_view noColor);

}  // namespace vesk
