#pragma once

#include <cstdint>

#include "app/output/outcome.h"

namespace vesk {

struct SimulateOptions {
  std::uint64_t seed = 1;
  double seconds = 60;
};

/// Writes a drive of the simulated handset to standard output, as a recording. The drive always begins at the same
/// instant: the same seed writes the same bytes.
[[nodiscard]] Outcome runSimulate(const SimulateOptions& options);

}  // namespace vesk
