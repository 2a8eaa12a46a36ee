#pragma once

#include <cstdint>
#include <span>

namespace vesk::diag {

/// CRC-16/X.25, which ends every frame: that of no bytes is 0x0000.
[[nodiscard]] std::uint16_t checksum(std::span<const std::uint8_t> bytes);

}  // namespace vesk::diag
