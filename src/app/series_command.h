#pragma once

#include "app/outcome.h"
#include "app/recording_input.h"

namespace vesk {

/// Plays the recording and prints a line for each event that reports a KPI, with all that are known then: as text, or
/// as CSV with a header.
[[nodiscard]] Outcome runSeries(const RecordingInput& input, bool asCsv);

}  // namespace vesk
