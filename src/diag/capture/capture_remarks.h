#pragma once

#include <string>
#include <vector>

#include "diag/capture/capture_reader.h"

namespace vesk::diag {

/// What a user should know of a capture once it was read: what was damaged or cut off, cannot be read, or may be taken
/// amiss. One line each, with the capture's name in front.
[[nodiscard]] std::vector<std::string> remarksOn(const CaptureReader& capture);

}  // namespace vesk::diag
