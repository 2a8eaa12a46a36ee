#include "handset/model/digits.h"

#include "handset/model/network.h"

namespace vesk::handset {

namespace {

constexpr unsigned kFiller = 0xF;

unsigned digitAt(std::string_view digits, std::size_t index) {
  return index < digits.size() ? static_cast<unsigned>(digits[index] - '0') : kFiller;
}

std::uint8_t twoDigits(unsigned low, unsigned high) {
  return static_cast<std::uint8_t>(high << 4 | low);
}

}  // namespace

Bytes swappedDigits(std::string_view digits) {
  Bytes bytes;
  for (std::size_t index = 0; index < digits.size(); index += 2)
    bytes.push_back(twoDigits(digitAt(digits, index), digitAt(digits, index + 1)));
  return bytes;
}

Bytes mobileIdentity(std::string_view imsi) {
  constexpr unsigned kImsiWithOddCount = 1 | 1 << 3;
  Bytes bytes{twoDigits(kImsiWithOddCount, digitAt(imsi, 0))};
  append(bytes, swappedDigits(imsi.substr(1)));
  return bytes;
}

Bytes encodedPlmn(std::uint32_t mnc) {
  static_assert(kMncDigits == 2);
  return {twoDigits(kMcc / 100, kMcc / 10 % 10), twoDigits(kMcc % 10, kFiller), twoDigits(mnc / 10, mnc % 10)};
}

std::string withCheckDigit(std::string digits) {
  unsigned sum = 0;
  bool isDoubled = true;
  for (std::size_t index = digits.size(); index-- > 0; isDoubled = !isDoubled) {
    const unsigned value = digitAt(digits, index) * (isDoubled ? 2 : 1);
    sum += value / 10 + value % 10;
  }
  digits += static_cast<char>('0' + (10 - sum % 10) % 10);
  return digits;
}

void appendNumber(Bytes& out, std::uint64_t value, unsigned count) {
  while (count-- > 0)
    out.push_back(static_cast<std::uint8_t>(value >> (8 * count)));
}

void append(Bytes& out, const Bytes& more) {
  out.insert(out.end(), more.begin(), more.end());
}

}  // namespace vesk::handset
