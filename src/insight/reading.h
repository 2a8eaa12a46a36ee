#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "insight/quantities.h"
#include "messages/shared/lte_bands.h"
#include "values/json_form.h"

namespace vesk::insight {

/// What is remarkable about a value.
enum class Mark {
  /// Outside of what the quantity can be: unknown to whatever else looks at it.
  impossible,
  /// The lowest code: at or below.
  floor,
  /// A code that the standard reserves.
  reserved,
  /// Contradicts the channel number beside it.
  mismatch,
  ambiguous,
  /// Of power.
  high,
};

/// "impossible" to "high".
[[nodiscard]] std::string_view nameOf(Mark mark);

/// What a value of a record means: as a text, and whatever applies of the rest.
struct Reading {
  std::string text;
  /// In `unit`.
  std::optional<double> value{};
  std::string_view unit{};
  std::optional<Grade> grade{};
  std::optional<Mark> mark{};
  std::optional<std::string> band{};
  /// Frequencies in units of 100 kHz. A channel that has a downlink and no uplink says so.
  std::optional<int> downlink{};
  std::optional<int> uplink{};
  std::optional<Duplex> duplex{};
  std::optional<std::int64_t> enb{};
  std::optional<std::int64_t> sector{};
  std::optional<std::int64_t> rnc{};
  std::optional<std::int64_t> cell{};
  std::optional<std::string> plmn{};
  std::optional<std::int64_t> code{};
};

/// The reading of a value that cannot be.
[[nodiscard]] Reading impossibleReading();

/// The reading of a level, in the quantity's unit: "-96 dBm, fair".
[[nodiscard]] Reading levelReading(const Quantity& quantity, double number);

/// Writes {"text":"-96 dBm, fair","value":-96,"unit":"dBm","grade":"fair"}, with "mark", "band", "dl_mhz", "ul_mhz",
/// "duplex", "enb", "sector", "rnc", "cell", "plmn" and "code" where they apply.
void writeReading(JsonWriter& json, const Reading& reading);

}  // namespace vesk::insight
