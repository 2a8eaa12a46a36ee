#include "values/visible_text.h"

#include <algorithm>
#include <cstdint>
#include <cstring>

#include "values/utf8.h"

namespace vesk {

namespace {

constexpr std::uint8_t kSpace = 0x20;
constexpr std::uint8_t kDelete = 0x7F;
/// U+0080 to U+009F are written C2 80 to C2 9F.
constexpr std::uint8_t kLeadOfC1 = 0xC2;
constexpr std::uint8_t kLastC1 = 0x9F;

bool isPlain(char character) {
  const auto byte = static_cast<std::uint8_t>(character);
  return byte >= kSpace && byte < kDelete;
}

/// Whether all eight characters are plain. A borrow or a carry into the next byte comes only from one that is
/// not.
bool areEightPlain(const char* characters) {
  constexpr std::uint64_t kEach = 0x0101010101010101;
  std::uint64_t eight = 0;
  std::memcpy(&eight, characters, sizeof eight);
  return (((eight - kSpace * kEach) | (eight + kEach) | eight) & (0x80 * kEach)) == 0;
}

/// The number of plain characters that `text` starts with.
std::size_t plainSize(std::string_view text) {
  std::size_t size = 0;
  while (text.size() - size >= 8 && areEightPlain(text.data() + size))
    size += 8;
  while (size < text.size() && isPlain(text[size]))
    ++size;
  return size;
}

void appendNumber(std::string& out, std::uint8_t control) {
  constexpr std::string_view kDigits = "0123456789ABCDEF";
  out += "\\x";
  out += kDigits[control >> 4];
  out += kDigits[control & 0x0F];
}

/// One well-formed character or one byte that belongs to none.
void appendCharacter(std::string& out, std::string_view character) {
  const auto lead = static_cast<std::uint8_t>(character[0]);
  if (lead < kSpace || lead == kDelete) {
    appendNumber(out, lead);
  } else if (lead == kLeadOfC1 && character.size() == 2 && static_cast<std::uint8_t>(character[1]) <= kLastC1) {
    appendNumber(out, static_cast<std::uint8_t>(character[1]));
  } else {
    appendUtf8(out, character);
  }
}

}  // namespace

void appendVisible(std::string& out, std::string_view text) {
  while (!text.empty()) {
    const std::size_t plain = plainSize(text);
    out += text.substr(0, plain);
    text.remove_prefix(plain);
    if (text.empty()) return;
    const std::size_t size = std::max<std::size_t>(1, utf8CharacterSize(text));
    appendCharacter(out, text.substr(0, size));
    text.remove_prefix(size);
  }
}

}  // namespace vesk
