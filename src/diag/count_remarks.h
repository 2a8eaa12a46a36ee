#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "diag/packet_counts.h"

namespace vesk::diag {

/// What a user should know of what came, from a port or in a capture; absent where there is nothing to say.

/// Where packets are of several SIMs.
[[nodiscard]] std::optional<std::string> remarkOnSims(const PacketCounts& counts);

/// Where so many frames are damaged that it is no accident; `advice` is what to do.
[[nodiscard]] std::optional<std::string> remarkOnFrames(std::uint64_t damaged, std::uint64_t all,
                                                        std::string_view advice);

}  // namespace vesk::diag
