#pragma once

#include <cstdint>
#include <string>

/// How numbers stand in the texts of this room.
namespace vesk::insight {

/// Rounded to 2 decimals, without trailing zeros: -96, -12.5, -9.85.
void appendNumber(std::string& out, double number);
[[nodiscard]] std::string numberText(double number);

/// A frequency in units of 100 kHz as MHz, always with one decimal: 742.5.
[[nodiscard]] std::string megahertzText(int hundredKilohertz);

/// A duration in milliseconds, cut, not rounded: "91 ms", "4.7 s", "12 min 03 s", "1 h 02 min", "1 d 20 h".
[[nodiscard]] std::string durationText(std::uint64_t milliseconds);

}  // namespace vesk::insight
