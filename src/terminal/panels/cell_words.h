#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "insight/reading.h"
#include "insight/technology.h"

/// Cells in words.
namespace vesk {

/// "PCI", "PSC", "BSIC".
[[nodiscard]] std::string_view codeNameOf(insight::Technology technology);
/// "EARFCN", "UARFCN", "ARFCN".
[[nodiscard]] std::string_view channelNameOf(insight::Technology technology);

/// Band and frequencies of a channel: "B17 742.5 MHz, UL 712.5 MHz"; absent where no band has it.
[[nodiscard]] std::optional<insight::Reading> channelReading(insight::Technology technology, std::int64_t channel);

/// "eNB 191040 / 17", "RNC 2 / cell 10222", "cell 6758".
[[nodiscard]] std::string siteText(insight::Technology technology, std::int64_t cellId);

/// "2018-01-20 21:53:05 UTC", of milliseconds since 1970-01-01 00:00:00 UTC.
[[nodiscard]] std::string dateText(std::int64_t time);

/// "0.3 s", "4.7 s", "12 min 03 s".
[[nodiscard]] std::string lastingText(std::int64_t milliseconds);

}  // namespace vesk
