#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace vesk::handset {

using Bytes = std::vector<std::uint8_t>;

/// Decimal digits two a byte, the first in the low half, as 3GPP codes them; a free last half is filled with 1s.
[[nodiscard]] Bytes swappedDigits(std::string_view digits);
/// An IMSI of 15 digits as a mobile identity (3GPP TS 24.008): 8 bytes.
[[nodiscard]] Bytes mobileIdentity(std::string_view imsi);
/// MCC and MNC of the test network, or of another network of its country: 3 bytes.
[[nodiscard]] Bytes encodedPlmn(std::uint32_t mnc);
/// `digits` with the check digit that makes them valid by Luhn's rule.
[[nodiscard]] std::string withCheckDigit(std::string digits);

/// Big-endian, in `count` bytes.
void appendNumber(Bytes& out, std::uint64_t value, unsigned count);
void append(Bytes& out, const Bytes& more);

}  // namespace vesk::handset
