#pragma once

#include <cstddef>
#include <cstdint>
#include <span>

namespace vesk::diag {

/// The unsigned number whose bytes stand at `offset`, the lowest first; they must lie within `bytes`.
template <class Unsigned>
[[nodiscard]] inline Unsigned readLittleEndian(std::span<const std::uint8_t> bytes, std::size_t offset) {
  Unsigned value = 0;
  for (std::size_t index = 0; index < sizeof(Unsigned); ++index)
    value = static_cast<Unsigned>(value | static_cast<Unsigned>(Unsigned{bytes[offset + index]} << (8 * index)));
  return value;
}

}  // namespace vesk::diag
