#pragma once

#include <functional>
#include <string>

#include "app/output/outcome.h"
#include "app/source/recording_input.h"
#include "recording/recorded_event.h"

namespace vesk {

/// Writes one line to standard output for each event of the recording; `append` appends it, without its line feed. An
/// event is written before the next one is waited for. Lines that are no event are told to the user and passed over.
[[nodiscard]] Outcome writeEventLines(const RecordingInput& input,
                                      std::function<void(std::string& out, const RecordedEvent& event)> append);

}  // namespace vesk
