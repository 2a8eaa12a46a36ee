#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

#include "messages/shared/lte_bands.h"
#include "values/value.h"

/// Channel numbers to bands and frequencies. Frequencies are in units of 100 kHz.
namespace vesk::insight {

/// What a UARFCN or an ARFCN stands for.
struct Channel {
  /// "I", "P-GSM 900".
  std::string_view band;
  int downlink;
  int uplink;
};

/// The channel of a UMTS downlink UARFCN, of the first band that has it; absent when none has.
[[nodiscard]] std::optional<Channel> umtsChannel(std::int64_t uarfcn);

/// The two GSM bands that share channel numbers.
enum class SharedGsmBand { dcs1800, pcs1900 };

/// The one that a record's band indicator names, by its name or number; absent for null and for other bands.
[[nodiscard]] std::optional<SharedGsmBand> sharedGsmBand(const Value* bandIndicator);

struct GsmChannel : Channel {
  /// The other channel that the number may stand for, where nothing says which is meant.
  std::optional<Channel> otherwise;
};

/// The channel of an ARFCN; absent when no band has it. 512 to 810 are of the band `indicated`, or ambiguous without
/// one: then of DCS 1800, or else of PCS 1900.
[[nodiscard]] std::optional<GsmChannel> gsmChannel(std::int64_t arfcn, std::optional<SharedGsmBand> indicated);

}  // namespace vesk::insight
