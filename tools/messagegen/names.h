#pragma once

#include <set>
#include <string>
#include <string_view>

namespace messagegen {

/// The words of a text with blanks between them.
[[nodiscard]] std::set<std::string, std::less<>> wordsOf(std::string_view text);

/// Whether C++ keeps the word for itself.
[[nodiscard]] bool isKeyword(std::string_view name);

/// Whether a declaration of the generated code can be called that: it is an identifier that neither C++ nor the codec,
/// whose names the generated code uses and inherits, has taken.
[[nodiscard]] bool isFreeName(std::string_view name);

}  // namespace messagegen
