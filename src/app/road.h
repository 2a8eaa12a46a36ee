#pragma once

#include <functional>
#include <optional>
#include <string>

#include "app/outcome.h"
#include "toolkit/navigation_controller.h"

namespace vesk {

/// Plays the recording at `path` ("-" is standard input) through the whole program as fast as it can be taken in, and
/// calls `use` with the root of the screens when the last event is in the stores, or not at all when none can be read.
/// Without a path nothing is played.
/// Nothing is printed but what `use` prints; lines that are no event are told to the user, and make the outcome failed.
[[nodiscard]] Outcome playRecording(const std::optional<std::string>& path,
                                    const std::function<void(NavigationController& root)>& use);

/// What to tell the user when the service has not taken the metric configuration; absent when it has.
[[nodiscard]] std::optional<std::string> whyNoMetricArrives(const NavigationController& root);

}  // namespace vesk
