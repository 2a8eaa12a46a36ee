#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string_view>

namespace corvik {

namespace detail {

inline constexpr std::uint8_t kNoDigit = 0x80;

consteval std::array<std::uint8_t, 256> makeHexDigits() {
  std::array<std::uint8_t, 256> table{};
  table.fill(kNoDigit);
  for (std::uint8_t value = 0; value < 16; ++value) {
    table[static_cast<std::uint8_t>("0123456789abcdef"[value])] = value;
    table[static_cast<std::uint8_t>("0123456789ABCDEF"[value])] = value;
  }
  return table;
}

inline constexpr std::array<std::uint8_t, 256> kHexDigits = makeHexDigits();

}  // namespace detail

/// The digit's value; 16 or more when `digit` is no hex digit.
[[nodiscard]] inline std::uint8_t hexDigit(char digit) {
  return detail::kHexDigits[static_cast<std::uint8_t>(digit)];
}

/// Writes one byte to `out` for every two digits, upper or lower case; an odd last digit is not looked at.
/// False when there is anything but digits; `out` then holds nothing of use.
[[nodiscard]] inline bool decodeHex(std::string_view digits, std::uint8_t* out) {
  std::uint8_t seen = 0;
  for (std::size_t index = 0; index + 1 < digits.size(); index += 2) {
    const std::uint8_t high = hexDigit(digits[index]);
    const std::uint8_t low = hexDigit(digits[index + 1]);
    seen = static_cast<std::uint8_t>(seen | high | low);
    *out++ = static_cast<std::uint8_t>(high << 4 | low);
  }
  return seen < 16;
}

}  // namespace corvik
