#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "terminal/device/grid.h"
#include "terminal/device/palette.h"
#include "terminal/device/signs.h"

namespace vesk {

/// What a user wants otherwise than it is usual on the terminal.
struct Appearance {
  std::optional<Signs> signs{};
  std::vector<std::pair<Role, Look>> looks{};
};

/// "faint", "section-header", "selected".
[[nodiscard]] std::optional<Role> roleNamed(std::string_view name);
/// All of them, with commas between.
[[nodiscard]] std::string roleNames();

/// "bold white on blue", "245", "reverse", "plain"; colours are the eight names or 0 to 255. Absent when it is none.
[[nodiscard]] std::optional<Look> parseLook(std::string_view text);

/// "ascii", "block", "braille".
[[nodiscard]] std::optional<Signs> signsNamed(std::string_view name);

/// `palette` with the looks of `appearance`, as far as a terminal of `colors` colours has theirs.
[[nodiscard]] Palette withLooksOf(const Appearance& appearance, Palette palette, int colors);

}  // namespace vesk
