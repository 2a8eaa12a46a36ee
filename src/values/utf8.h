#pragma once

#include <string>
#include <string_view>

namespace vesk {

/// Appends `bytes` as valid UTF-8: every byte that belongs to no well-formed character becomes U+FFFD.
/// Surrogates, over-long forms and values beyond U+10FFFF are not well-formed.
void appendUtf8(std::string& out, std::string_view bytes);

/// The number of bytes of the well-formed character that `bytes` starts with; 0 when it starts with none.
[[nodiscard]] std::size_t utf8CharacterSize(std::string_view bytes);

}  // namespace vesk
