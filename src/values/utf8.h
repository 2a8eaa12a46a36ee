#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace vesk {

/// Appends `bytes` as valid UTF-8: every byte that belongs to no well-formed character becomes U+FFFD.
/// Surrogates, over-long forms and values beyond U+10FFFF are not well-formed.
void appendUtf8(std::string& out, std::string_view bytes);

/// The number of bytes of the well-formed character that `bytes` starts with; 0 when it starts with none.
[[nodiscard]] std::size_t utf8CharacterSize(std::string_view bytes);

/// The code point of one well-formed character.
[[nodiscard]] char32_t codePointOf(std::string_view character);

/// Appends the character of `codePoint`, at most U+10FFFF.
void appendCodePoint(std::string& out, char32_t codePoint);

/// How many bytes the byte order mark takes that `bytes` starts with; 0 when it starts with none.
[[nodiscard]] constexpr std::size_t byteOrderMarkSize(std::string_view bytes) {
  constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";
  return bytes.starts_with(kByteOrderMark) ? kByteOrderMark.size() : 0;
}

/// Whether `codePoint` acts on a terminal instead of being shown: U+0000 to U+001F, U+007F to U+009F.
[[nodiscard]] constexpr bool isControl(char32_t codePoint) {
  return codePoint < 0x20 || (0x7F <= codePoint && codePoint < 0xA0);
}

}  // namespace vesk
