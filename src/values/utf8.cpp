#include "values/utf8.h"

#include <array>
#include <cstdint>

namespace vesk {

namespace {

/// What a first byte allows: the size of its character and the range of its second byte. The other bytes of a
/// character are 80 to BF.
struct LeadingBytes {
  std::uint8_t first;
  std::uint8_t last;
  std::uint8_t size;
  std::uint8_t secondFirst;
  std::uint8_t secondLast;
};

constexpr std::array<LeadingBytes, 8> kLeadingBytes{{
    {0xC2, 0xDF, 2, 0x80, 0xBF},
    {0xE0, 0xE0, 3, 0xA0, 0xBF},
    {0xE1, 0xEC, 3, 0x80, 0xBF},
    {0xED, 0xED, 3, 0x80, 0x9F},
    {0xEE, 0xEF, 3, 0x80, 0xBF},
    {0xF0, 0xF0, 4, 0x90, 0xBF},
    {0xF1, 0xF3, 4, 0x80, 0xBF},
    {0xF4, 0xF4, 4, 0x80, 0x8F},
}};

std::uint8_t byteAt(std::string_view bytes, std::size_t index) {
  return static_cast<std::uint8_t>(bytes[index]);
}

bool isWithin(std::uint8_t byte, std::uint8_t first, std::uint8_t last) {
  return first <= byte && byte <= last;
}

}  // namespace

std::size_t utf8CharacterSize(std::string_view bytes) {
  if (bytes.empty()) return 0;
  const std::uint8_t lead = byteAt(bytes, 0);
  if (lead < 0x80) return 1;
  for (const LeadingBytes& row : kLeadingBytes) {
    if (!isWithin(lead, row.first, row.last)) continue;
    if (bytes.size() < row.size || !isWithin(byteAt(bytes, 1), row.secondFirst, row.secondLast)) return 0;
    for (std::size_t index = 2; index < row.size; ++index) {
      if (!isWithin(byteAt(bytes, index), 0x80, 0xBF)) return 0;
    }
    return row.size;
  }
  return 0;
}

char32_t codePointOf(std::string_view character) {
  const std::uint8_t lead = byteAt(character, 0);
  if (lead < 0x80) return lead;
  auto codePoint = static_cast<char32_t>(lead & (0x7FU >> character.size()));
  for (std::size_t index = 1; index < character.size(); ++index)
    codePoint = codePoint << 6 | (byteAt(character, index) & 0x3FU);
  return codePoint;
}

void appendCodePoint(std::string& out, char32_t codePoint) {
  const auto trailing = [codePoint](unsigned shift) { return static_cast<char>(0x80 | (codePoint >> shift & 0x3F)); };
  if (codePoint < 0x80) {
    out += static_cast<char>(codePoint);
  } else if (codePoint < 0x800) {
    out += {static_cast<char>(0xC0 | codePoint >> 6), trailing(0)};
  } else if (codePoint < 0x10000) {
    out += {static_cast<char>(0xE0 | codePoint >> 12), trailing(6), trailing(0)};
  } else {
    out += {static_cast<char>(0xF0 | codePoint >> 18), trailing(12), trailing(6), trailing(0)};
  }
}

void appendUtf8(std::string& out, std::string_view bytes) {
  while (!bytes.empty()) {
    const std::size_t size = utf8CharacterSize(bytes);
    if (size == 0) {
      out += "\uFFFD";
      bytes.remove_prefix(1);
    } else {
      out += bytes.substr(0, size);
      bytes.remove_prefix(size);
    }
  }
}

}  // namespace vesk
