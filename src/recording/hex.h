#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string_view>

#ifdef __SSE2__
#include <emmintrin.h>
#endif

namespace vesk {

namespace detail {

/// Beyond a byte, also when shifted by a digit.
inline constexpr std::uint16_t kNoDigit = 0x100;

consteval std::array<std::uint16_t, 256> makeHexDigits() {
  std::array<std::uint16_t, 256> table{};
  table.fill(kNoDigit);
  for (std::uint8_t value = 0; value < 16; ++value) {
    table[static_cast<std::uint8_t>("0123456789abcdef"[value])] = value;
    table[static_cast<std::uint8_t>("0123456789ABCDEF"[value])] = value;
  }
  return table;
}

inline constexpr std::array<std::uint16_t, 256> kHexDigits = makeHexDigits();

}  // namespace detail

/// The digit's value; 16 or more when `digit` is no hex digit.
[[nodiscard]] inline std::uint32_t hexDigit(char digit) {
  return detail::kHexDigits[static_cast<std::uint8_t>(digit)];
}

#ifdef __SSE2__
namespace detail {

/// All bits of each byte that is at most `most`, none of the others.
inline __m128i isAtMost(__m128i bytes, std::uint8_t most) {
  return _mm_cmpeq_epi8(_mm_min_epu8(bytes, _mm_set1_epi8(static_cast<char>(most))), bytes);
}

/// Writes eight bytes for sixteen digits; false when one is none.
inline bool decodeSixteenDigits(const char* digits, std::uint8_t* out) {
  const __m128i characters = _mm_loadu_si128(reinterpret_cast<const __m128i*>(digits));
  const __m128i fromZero = _mm_sub_epi8(characters, _mm_set1_epi8('0'));
  const __m128i fromA = _mm_sub_epi8(_mm_or_si128(characters, _mm_set1_epi8('a' - 'A')), _mm_set1_epi8('a'));
  const __m128i isDecimal = isAtMost(fromZero, 9);
  const __m128i isLetter = isAtMost(fromA, 5);
  const __m128i values =
      _mm_or_si128(_mm_and_si128(isDecimal, fromZero), _mm_and_si128(isLetter, _mm_add_epi8(fromA, _mm_set1_epi8(10))));
  // Two digits lie in each sixteen bits, the first in the lower byte, and come together there.
  const __m128i pairs = _mm_or_si128(_mm_slli_epi16(values, 4), _mm_srli_epi16(values, 8));
  const __m128i bytes = _mm_and_si128(pairs, _mm_set1_epi16(0xFF));
  _mm_storel_epi64(reinterpret_cast<__m128i*>(out), _mm_packus_epi16(bytes, bytes));
  return _mm_movemask_epi8(_mm_or_si128(isDecimal, isLetter)) == 0xFFFF;
}

}  // namespace detail
#endif

/// Writes one byte to `out` for every two digits, upper or lower case; an odd last digit is not looked at.
/// False when there is anything but digits; `out` then holds nothing of use.
[[nodiscard]] inline bool decodeHex(std::string_view digits, std::uint8_t* out) {
#ifdef __SSE2__
  for (; digits.size() >= 16; digits.remove_prefix(16), out += 8) {
    if (!detail::decodeSixteenDigits(digits.data(), out)) return false;
  }
#endif
  const std::uint8_t* const end = out + digits.size() / 2;
  std::uint32_t seen = 0;
  for (const char* pair = digits.data(); out != end; pair += 2) {
    const std::uint32_t byte = hexDigit(pair[0]) << 4 | hexDigit(pair[1]);
    seen |= byte;
    *out++ = static_cast<std::uint8_t>(byte);
  }
  return seen <= 0xFF;
}

}  // namespace vesk
