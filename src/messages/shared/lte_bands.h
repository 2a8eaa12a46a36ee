#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

/// The bands of LTE and their channel numbers. Frequencies are in units of 100 kHz, as are the steps of the numbers.
namespace vesk {

enum class Duplex {
  /// Downlink and uplink apart in frequency.
  FDD,
  /// Both on the same frequency.
  TDD,
  /// Downlink only.
  SDL,
};

[[nodiscard]] std::string_view nameOf(Duplex duplex);

/// A run of channel numbers and the frequency of the first.
struct LteChannelRange {
  int low;
  int first;
  int last;

  [[nodiscard]] constexpr bool contains(std::int64_t channel) const { return channel >= first && channel <= last; }
  [[nodiscard]] constexpr int frequencyOf(std::int64_t channel) const {
    return low + static_cast<int>(channel - first);
  }
};

struct LteBand {
  int number;
  Duplex duplex;
  LteChannelRange downlink;
  /// That of the downlink for TDD; without any channel for SDL.
  LteChannelRange uplink;

  /// The frequency of the uplink that belongs to a downlink channel of this band; absent where there is none.
  [[nodiscard]] std::optional<int> uplinkFrequencyOf(std::int64_t downlinkChannel) const;
};

/// The band with that number; null for none.
[[nodiscard]] const LteBand* findLteBand(std::int64_t number);
/// The band in which a downlink EARFCN lies; null for none.
[[nodiscard]] const LteBand* lteBandOfDownlink(std::int64_t earfcn);
/// The band in which an uplink EARFCN lies; null for none.
[[nodiscard]] const LteBand* lteBandOfUplink(std::int64_t earfcn);

}  // namespace vesk
