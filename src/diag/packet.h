#pragma once

#include <cstddef>
#include <cstdint>
#include <span>

namespace vesk::diag {

/// A handset has a few SIMs. Of more, those that were heard of last are remembered.
inline constexpr std::size_t kMostSims = 16;

/// What a modem logs at one moment: the smallest thing that can be read by itself.
struct LogPacket {
  /// The equipment's identifier in the upper 4 bits, the item in the others: 0xB0C2.
  std::uint16_t code;
  /// Since 1970-01-01 UTC, by the modem's clock, which counts from 1980 until a network has set it.
  std::uint64_t milliseconds;
  /// Which SIM it is about, from 1.
  std::uint32_t sim;
  /// What follows the packet's header, down to no bytes at all; valid as long as what it was read from.
  std::span<const std::uint8_t> body;
};

/// A metric event that a packet has become.
struct Event {
  std::int64_t metricId;
  /// The packet's.
  std::uint64_t milliseconds;
  /// The metric's message; valid during the call that hands the event on.
  std::span<const std::uint8_t> payload;
};

/// What became of a packet.
enum class Reading {
  /// It was read, whether or not it gave an event.
  read,
  /// Nobody knows its code, or this version of it.
  passedOver,
  /// It is not laid out as its code and version say. It gave no event and left no trace.
  damaged,
};

}  // namespace vesk::diag
