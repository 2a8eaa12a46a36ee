#include "diag/framing/checksum.h"

#include <array>
#include <cstddef>

namespace vesk::diag {

namespace {

constexpr std::uint16_t kReflectedPolynomial = 0x8408;
/// How many bytes are taken at once; a table each says what a byte does to the checksum from its place.
constexpr std::size_t kBytesAtOnce = 8;

using Tables = std::array<std::array<std::uint16_t, 256>, kBytesAtOnce>;

/// `checksum` once one more byte, 0, has followed.
constexpr std::uint16_t shifted(std::uint16_t checksum) {
  for (int bit = 0; bit < 8; ++bit)
    checksum = static_cast<std::uint16_t>(checksum >> 1 ^ (checksum & 1) * kReflectedPolynomial);
  return checksum;
}

constexpr Tables makeTables() {
  Tables tables{};
  for (std::size_t byte = 0; byte < 256; ++byte) {
    auto effect = static_cast<std::uint16_t>(byte);
    for (auto& table : tables)
      table[byte] = effect = shifted(effect);
  }
  return tables;
}

constexpr Tables kTables = makeTables();

}  // namespace

std::uint16_t checksum(std::span<const std::uint8_t> bytes) {
  std::uint32_t crc = 0xFFFF;
  for (; bytes.size() >= kBytesAtOnce; bytes = bytes.subspan(kBytesAtOnce)) {
    crc = kTables[7][bytes[0] ^ (crc & 0xFF)] ^ kTables[6][bytes[1] ^ crc >> 8] ^ kTables[5][bytes[2]] ^
          kTables[4][bytes[3]] ^ kTables[3][bytes[4]] ^ kTables[2][bytes[5]] ^ kTables[1][bytes[6]] ^
          kTables[0][bytes[7]];
  }
  for (const std::uint8_t byte : bytes)
    crc = crc >> 8 ^ kTables[0][(crc ^ byte) & 0xFF];
  return static_cast<std::uint16_t>(~crc);
}

}  // namespace vesk::diag
