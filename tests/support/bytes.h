#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace vesk {

using Bytes = std::vector<std::uint8_t>;

/// The bytes that two digits each stand for, blanks passed over: bytesOf("08 96 01").
inline Bytes bytesOf(std::string_view hex) {
  std::string digits;
  for (const char c : hex) {
    if (c != ' ') digits += c;
  }
  Bytes bytes;
  for (std::size_t index = 0; index + 1 < digits.size(); index += 2) {
    bytes.push_back(static_cast<std::uint8_t>(std::stoul(digits.substr(index, 2), nullptr, 16)));
  }
  return bytes;
}

/// "08 96 01", which tells more in a failure than a list of numbers.
inline std::string hexOf(std::span<const std::uint8_t> bytes) {
  constexpr std::string_view kDigits = "0123456789ABCDEF";
  std::string hex;
  for (const std::uint8_t byte : bytes) {
    if (!hex.empty()) hex += ' ';
    hex += kDigits[byte >> 4];
    hex += kDigits[byte & 0x0F];
  }
  return hex;
}

/// `hex` over and over.
inline std::string repeated(std::size_t times, std::string_view hex) {
  std::string result;
  for (; times > 0; --times)
    result += hex;
  return result;
}

}  // namespace vesk
