#pragma once

#include <string>

#include "terminal/device/capabilities.h"
#include "terminal/device/grid.h"

namespace vesk {

/// Appends the bytes that turn the picture `shown` into `wanted` on a terminal: nothing where they agree.
/// When the sizes differ, nothing is taken to be shown and the whole picture is written.
void appendDifference(std::string& out, const Grid& shown, const Grid& wanted, const Capabilities& terminal);

}  // namespace vesk
