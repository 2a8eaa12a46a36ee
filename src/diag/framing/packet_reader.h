#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>

#include "diag/packet.h"

namespace vesk::diag {

/// What a frame may hold.
enum class PacketKind {
  log,
  /// Counts of things that happened: nothing of ours.
  events,
  debugMessage,
  /// To a command that somebody gave the modem.
  answer,
  refusal,
  encryptedLog,
  unknown,
  damaged,
};
inline constexpr std::size_t kPacketKinds = 8;

/// A frame's content, told apart; valid as long as that.
struct Packet {
  PacketKind kind;
  /// From 1; absent where what wraps the packets of one SIM is cut off.
  std::optional<std::uint32_t> sim;
  /// Without what wraps the packets of one SIM; its first byte tells the kind.
  std::span<const std::uint8_t> content;
  /// There for a log packet.
  std::optional<LogPacket> log{};
};

/// What a packet is that begins with that byte, as far as the byte tells.
[[nodiscard]] PacketKind kindOf(std::uint8_t firstByte);

/// Looks into the content of a sound frame, which is not empty.
[[nodiscard]] Packet readPacket(std::span<const std::uint8_t> content);

/// What a log packet holds at least, from its length on: length, code and time.
inline constexpr std::size_t kLogHeaderSize = 12;

/// A log packet from its length on; absent when it is cut off or too short to be one. Bytes behind it are ignored.
[[nodiscard]] std::optional<LogPacket> readLogPacket(std::span<const std::uint8_t> bytes, std::uint32_t sim);

/// Milliseconds since 1970-01-01 UTC of a modem's time: its upper 48 bits count 1.25 ms from 1980-01-06 on.
[[nodiscard]] std::uint64_t millisecondsOf(std::uint64_t modemTime);

}  // namespace vesk::diag
