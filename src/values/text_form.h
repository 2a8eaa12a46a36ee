#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>

#include "values/value.h"

namespace vesk {

/// Appends the form in which a person reads `value`, on one line: 7, -19.5, true, text as it is, 0x0a1b,
/// [1, 3, 7], {key: value, key: value}. Always valid UTF-8.
void appendText(std::string& out, const Value& value);
void appendText(std::string& out, const Array& array);
void appendText(std::string& out, const Dictionary& dictionary);

template <class Shown>
[[nodiscard]] std::string textOf(const Shown& shown) {
  std::string out;
  appendText(out, shown);
  return out;
}

/// "1 stretch", "2 stretches".
[[nodiscard]] std::string counted(std::uint64_t count, std::string_view one, std::string_view more);

/// Appends `number` in decimal.
void appendDecimal(std::string& out, std::int64_t number);
void appendDecimal(std::string& out, std::uint64_t number);
/// Appends the fewest digits that read back as `number`, always with a point and never with an exponent: 20.0, 1.4,
/// 100000.0.
void appendDecimal(std::string& out, float number);
void appendDecimal(std::string& out, double number);
/// Appends `number` in upper-case hexadecimal.
void appendUpperHex(std::string& out, std::uint64_t number);
/// Appends two lower-case digits a byte.
void appendHex(std::string& out, std::span<const std::uint8_t> bytes);

}  // namespace vesk
