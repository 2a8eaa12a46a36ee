#pragma once

#include <cstdint>

namespace vesk::diag {

/// A number in a packet: of the little-endian word of `bytes` bytes at offset `at`, the `width` bits from `bit` on, bit
/// 0 being the least significant.
struct Field {
  std::uint16_t at;
  std::uint8_t bytes;
  std::uint8_t bit;
  std::uint8_t width;
};

/// How the tables of layouts write their fields: w(16) is the 32-bit word at offset 16, h(16) the 16-bit one, b(16) the
/// byte, and w(16, 10, 12) the 12 bits from bit 10 on of that word.
namespace notation {

constexpr Field b(std::uint16_t at, std::uint8_t bit = 0, std::uint8_t width = 8) {
  return {at, 1, bit, width};
}
constexpr Field h(std::uint16_t at, std::uint8_t bit = 0, std::uint8_t width = 16) {
  return {at, 2, bit, width};
}
constexpr Field w(std::uint16_t at, std::uint8_t bit = 0, std::uint8_t width = 32) {
  return {at, 4, bit, width};
}

}  // namespace notation

}  // namespace vesk::diag
