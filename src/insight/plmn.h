#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string>

#include "values/optional_number.h"
#include "values/value.h"

/// Networks, and the areas that they are divided into.
namespace vesk::insight {

/// A network: a mobile country code and a mobile network code, each 0 to 999.
struct Plmn {
  std::int16_t mcc;
  std::int16_t mnc;
  /// With how many digits the network code is written, 2 or 3.
  std::int8_t mncDigits;

  friend bool operator==(const Plmn&, const Plmn&) = default;
};

/// From the values of a record; null is absent. The network code has 3 digits when `mncDigits` is 3, and so
/// has every code above 99, else 2. Absent without a country and a network code.
[[nodiscard]] std::optional<Plmn> plmnOf(const Value* mcc, const Value* mnc, const Value* mncDigits);

/// From the 3 bytes of the NAS protocols. Absent for other lengths, and for what holds a half byte that is no digit.
[[nodiscard]] std::optional<Plmn> plmnOf(std::span<const std::uint8_t> encoded);

/// The same from the "encoded_plmn" of a record.
[[nodiscard]] std::optional<Plmn> encodedPlmnOf(const Dictionary& record);

/// "310-410".
[[nodiscard]] std::string textOf(const Plmn& plmn);

/// A tracking, location or routing area.
struct AreaIdentity {
  Plmn plmn;
  /// TAC or LAC.
  std::int64_t code;
  /// RAC; of a routing area only.
  OptionalNumber<std::int64_t> routingCode{};

  friend bool operator==(const AreaIdentity&, const AreaIdentity&) = default;
};

/// "310-410 19980", "460-00 4566 100".
[[nodiscard]] std::string textOf(const AreaIdentity& area);

/// How many digits a network code has at least: 3 when a record says so, else 2; null is absent.
[[nodiscard]] int mncDigitsOf(const Value* mncDigits);

/// An MCC alone, or an MNC: `digits` at least, with leading zeros.
[[nodiscard]] std::string codeText(std::int64_t code, int digits);

}  // namespace vesk::insight
