#pragma once

#include <optional>
#include <string>

#include "diag/packet_counts.h"

namespace vesk::diag {

/// What a user should know of the SIMs that packets came of, where there are several.
[[nodiscard]] std::optional<std::string> remarkOnSims(const PacketCounts& counts);

}  // namespace vesk::diag
