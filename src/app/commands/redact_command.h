#pragma once

#include "app/output/outcome.h"
#include "app/source/recording_input.h"

namespace vesk {

/// Writes the recording to standard output without identities. Events that nobody can decode are left out, and their
/// number is told to the user.
[[nodiscard]] Outcome runRedact(const RecordingInput& input);

}  // namespace vesk
