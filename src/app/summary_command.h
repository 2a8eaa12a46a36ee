#pragma once

#include "app/outcome.h"
#include "app/recording_input.h"

namespace vesk {

/// Plays the recording and prints what the whole drive was: as at most 24 lines of 80 columns, or as one JSON object.
[[nodiscard]] Outcome runSummary(const RecordingInput& input, bool asJson);

}  // namespace vesk
