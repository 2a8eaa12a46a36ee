#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "app/outcome.h"

namespace vesk {

struct ImportOptions {
  /// Of the capture; absent or "-" is standard input.
  std::optional<std::string> path;
  /// Which SIM; absent for all.
  std::optional<std::uint32_t> sim;
  /// A table of what the capture holds, instead of its events.
  bool countsOnly = false;
  /// A table of what can be read, and nothing is imported.
  bool layoutsOnly = false;
};

/// Writes the events of a capture of a modem's diagnostic port to standard output, as a recording. What cannot be read
/// is passed over, whatever it is; the user is told what was damaged.
[[nodiscard]] Outcome runImport(const ImportOptions& options);

}  // namespace vesk
