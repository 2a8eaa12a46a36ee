#pragma once

#include "app/outcome.h"
#include "app/recording_input.h"

namespace vesk {

/// Writes the recording to standard output without identities. Events that nobody can decode are left out, and their
/// number is told to the user.
[[nodiscard]] Outcome runRedact(const RecordingInput& input);

}  // namespace vesk
