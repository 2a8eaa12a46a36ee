#include "values/ascii.h"

#include <algorithm>
#include <cstdint>
#include <cstring>

namespace vesk {

namespace {

bool isPrintable(char character) {
  const auto byte = static_cast<std::uint8_t>(character);
  return 0x20 <= byte && byte < 0x7F;
}

constexpr std::uint64_t kEach = 0x0101010101010101;

/// Has the highest bit of some byte set unless all eight characters are printable. A borrow or a carry into the next
/// byte comes only from one that is not.
std::uint64_t markEight(const char* characters) {
  std::uint64_t eight = 0;
  std::memcpy(&eight, characters, sizeof eight);
  return (eight - 0x20 * kEach) | (eight + kEach) | eight;
}

/// Whether all 32 characters are printable: four times eight without a branch between.
bool areAllPrintable(const char* characters) {
  const std::uint64_t marks =
      markEight(characters) | markEight(characters + 8) | markEight(characters + 16) | markEight(characters + 24);
  return (marks & (0x80 * kEach)) == 0;
}

}  // namespace

std::size_t printableAsciiSize(std::string_view text) {
  std::size_t size = 0;
  while (text.size() - size >= 32 && areAllPrintable(text.data() + size))
    size += 32;
  while (text.size() - size >= 8 && (markEight(text.data() + size) & (0x80 * kEach)) == 0)
    size += 8;
  while (size < text.size() && isPrintable(text[size]))
    ++size;
  return size;
}

bool containsIgnoringCase(std::string_view text, std::string_view part) {
  return std::search(text.begin(), text.end(), part.begin(), part.end(),
                     [](char a, char b) { return lowerAscii(a) == lowerAscii(b); }) != text.end();
}

}  // namespace vesk
