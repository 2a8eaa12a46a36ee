#pragma once

#include <cstddef>
#include <string_view>

namespace vesk {

/// How many printable ASCII characters `text` starts with: U+0020 to U+007E.
[[nodiscard]] std::size_t printableAsciiSize(std::string_view text);

/// The small letter of a capital one of ASCII; any other byte as it is.
[[nodiscard]] constexpr char lowerAscii(char character) {
  return 'A' <= character && character <= 'Z' ? static_cast<char>(character - 'A' + 'a') : character;
}

/// Whether `part` stands in `text`, small and capital letters of ASCII alike.
[[nodiscard]] bool containsIgnoringCase(std::string_view text, std::string_view part);

}  // namespace vesk
