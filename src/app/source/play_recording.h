#pragma once

#include <functional>
#include <optional>
#include <string>

#include "app/output/outcome.h"
#include "app/source/recording_input.h"
#include "toolkit/navigation_controller.h"

namespace vesk {

/// Plays the recording through the whole program as fast as it can be taken in, and calls `use` with the root of the
/// screens when the last event is in the stores, or not at all when none can be read. Without a recording nothing is
/// played. `beforePlaying` is called once the program has started, before the first event: for whoever watches the
/// events come in. A watched pipe's event is taken in as soon as its line is complete.
/// Nothing is printed but what these print; lines that are no event are told to the user, and make the outcome failed.
[[nodiscard]] Outcome playRecording(const RecordingInput& input,
                                    const std::function<void(NavigationController& root)>& use,
                                    const std::function<void()>& beforePlaying = {});

/// What to tell the user when the service has not taken the metric configuration; absent when it has.
[[nodiscard]] std::optional<std::string> whyNoMetricArrives(const NavigationController& root);

}  // namespace vesk
