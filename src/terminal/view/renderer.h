#pragma once

#include "terminal/device/grid.h"
#include "terminal/view/picture.h"

namespace vesk {

/// Draws a picture. Below the smallest size it only says that the terminal is too small.
[[nodiscard]] Grid render(const Picture& picture);

/// The lines that the whole help takes on a terminal that wide.
[[nodiscard]] int helpLineCount(int columns);

}  // namespace vesk
