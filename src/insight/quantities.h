#pragma once

#include <optional>
#include <string_view>

#include "values/optional_number.h"
#include "values/value.h"

/// The measured quantities: what values are possible, and which are good.
namespace vesk::insight {

enum class Grade { poor, fair, good, excellent };

/// "poor" to "excellent".
[[nodiscard]] std::string_view nameOf(Grade grade);

/// From which value on a level is of a grade; below fair it is poor.
struct GradeSteps {
  double excellent;
  double good;
  double fair;
};

/// The values of the lowest codes with which a level is reported: they mean "at or below".
struct Floor {
  double low;
  double high;
};

/// From this transmit power on, in dBm, a phone shouts.
inline constexpr double kHighTxPower = 20;

struct Quantity {
  std::string_view unit;
  /// The possible values, ends included.
  double lowest;
  double highest;
  /// Absent for a quantity that has no grades.
  std::optional<GradeSteps> steps{};
  std::optional<Floor> floor{};
  /// From this value on it is high; absent where that says nothing.
  OptionalNumber<double> high{};
};

// clang-format off
inline constexpr Quantity kRsrp{"dBm", -156, -31, GradeSteps{-80, -90, -100}, Floor{-140, -140}};
/// A fully loaded cell alone has -10.8 dB; below -12 dB others are loud.
inline constexpr Quantity kRsrq{"dB", -34, 2.5, GradeSteps{-7, -10, -12}, Floor{-20, -19.5}};
/// About 64QAM, 16QAM, the cell's edge.
inline constexpr Quantity kSinr{"dB", -23, 40, GradeSteps{20, 13, 0}};
inline constexpr Quantity kRscp{"dBm", -120, -25, GradeSteps{-75, -85, -95}};
inline constexpr Quantity kEcNo{"dB", -24.5, 0, GradeSteps{-6, -10, -14}};
/// A phone's sensitivity is about -102 dBm.
inline constexpr Quantity kRxLev{"dBm", -110, -47, GradeSteps{-70, -85, -95}};
/// All power in the carrier, which tells nothing of the cell.
inline constexpr Quantity kRssi{"dBm", -120, -25};
inline constexpr Quantity kTxPower{.unit = "dBm", .lowest = -50, .highest = 39, .high = kHighTxPower};
// clang-format on

[[nodiscard]] constexpr bool isPossible(const Quantity& quantity, double value) {
  return value >= quantity.lowest && value <= quantity.highest;
}

/// The number that a record holds, when it is one (a boolean is none) and possible; null is absent.
[[nodiscard]] inline OptionalNumber<double> possibleValue(const Quantity& quantity, const Value* value) {
  const OptionalNumber<double> number = value == nullptr ? std::nullopt : value->number();
  return number && isPossible(quantity, *number) ? number : std::nullopt;
}

/// Absent for a quantity without grades.
[[nodiscard]] std::optional<Grade> gradeOf(const Quantity& quantity, double value);

}  // namespace vesk::insight
