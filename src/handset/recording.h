#pragma once

#include <functional>
#include <string_view>

#include "handset/handset.h"

namespace vesk::handset {

/// Drives for `seconds` of simulated time and hands each metric event to `write`, as a line of a recording with its
/// line feed; false from `write` ends it. The SIM files come near the start, as they do where a client has asked for
/// them. Triggers are not recorded.
void recordDrive(Handset& handset, double seconds, const std::function<bool(std::string_view line)>& write);

}  // namespace vesk::handset
