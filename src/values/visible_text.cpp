#include "values/visible_text.h"

#include <algorithm>

#include "values/ascii.h"
#include "values/utf8.h"

namespace vesk {

namespace {

/// Appends one well-formed character, or a byte that belongs to none.
void appendCharacter(std::string& out, std::string_view character) {
  const char32_t codePoint = utf8CharacterSize(character) == 0 ? U'\uFFFD' : codePointOf(character);
  if (!isControl(codePoint)) return appendUtf8(out, character);
  constexpr std::string_view kDigits = "0123456789ABCDEF";
  out += {'\\', 'x', kDigits[codePoint >> 4], kDigits[codePoint & 0x0F]};
}

}  // namespace

void appendVisible(std::string& out, std::string_view text) {
  while (!text.empty()) {
    const std::size_t printable = printableAsciiSize(text);
    out += text.substr(0, printable);
    text.remove_prefix(printable);
    if (text.empty()) return;
    const std::size_t size = std::max<std::size_t>(1, utf8CharacterSize(text));
    appendCharacter(out, text.substr(0, size));
    text.remove_prefix(size);
  }
}

}  // namespace vesk
