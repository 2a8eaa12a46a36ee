#pragma once

#include "app/output/outcome.h"

namespace vesk {

/// Reads the program's arguments and runs the command that they name.
[[nodiscard]] Outcome runCommandLine(int argc, const char* const* argv);

}  // namespace vesk
