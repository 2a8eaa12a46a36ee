#pragma once

#include <cstdint>
#include <optional>

namespace vesk::diag {

/// The band in whose downlink an EARFCN lies (3GPP TS 36.101); none when it lies in no band.
[[nodiscard]] std::optional<std::uint32_t> lteBandOf(std::uint32_t earfcn);

}  // namespace vesk::diag
