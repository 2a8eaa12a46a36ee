#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string>

#include "values/value.h"

/// Networks: a mobile country code and a mobile network code.
namespace vesk::insight {

/// "310-410", from the values of a record; null is absent. The network code has 3 digits when `mncDigits` is 3, else at
/// least 2. Absent without a country and a network code, each 0 to 999.
[[nodiscard]] std::optional<std::string> plmnText(const Value* mcc, const Value* mnc, const Value* mncDigits);

/// The same from the 3 bytes of the NAS protocols. Absent for other lengths, and for what holds a half byte that is no
/// digit.
[[nodiscard]] std::optional<std::string> plmnText(std::span<const std::uint8_t> encoded);

/// The same of the "encoded_plmn" of a record.
[[nodiscard]] std::optional<std::string> encodedPlmnText(const Dictionary& record);

/// How many digits a network code has at least: 3 when a record says so, else 2; null is absent.
[[nodiscard]] int mncDigitsOf(const Value* mncDigits);

/// An MCC alone, or an MNC: `digits` at least, with leading zeros.
[[nodiscard]] std::string codeText(std::int64_t code, int digits);

}  // namespace vesk::insight
