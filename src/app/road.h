#pragma once

#include <functional>
#include <optional>
#include <string>

#include "app/outcome.h"
#include "toolkit/navigation_controller.h"

namespace vesk {

/// Plays the recording at `path` ("-" is standard input) through the whole program as fast as it can be taken in, and
/// calls `use` with the root of the screens when the last event is in the stores. Without a path nothing is played.
/// Nothing is printed but what `use` prints; lines that are no event are told to the user, and make the outcome failed.
[[nodiscard]] Outcome playRecording(const std::optional<std::string>& path,
                                    const std::function<void(NavigationController& root)>& use);

/// Whether the metric configuration ships with the program, without which no service delivers anything. Tells the user
/// when it does not.
[[nodiscard]] bool hasMetricConfiguration();

}  // namespace vesk
