#include "diag/framing/packet_reader.h"

#include <array>

#include "diag/little_endian.h"

namespace vesk::diag {

namespace {

using Bytes = std::span<const std::uint8_t>;

constexpr std::uint8_t kLogPacket = 0x10;
/// What stands before the length of a log packet: its kind, a byte that says whether more is to come, and the length
/// once more.
constexpr std::size_t kBeforeLength = 4;

/// Stands before a packet of one SIM: kind, a version, 2 bytes, the SIM.
constexpr std::uint8_t kOfOneSim = 0x98;
constexpr std::size_t kSimOffset = 4;
constexpr std::size_t kSimWrapperSize = 8;

constexpr std::uint64_t kMsFrom1970To1980 = 315964800000;

using Kinds = std::array<PacketKind, 256>;

constexpr Kinds makeKinds() {
  Kinds kinds{};
  kinds.fill(PacketKind::unknown);
  for (const int byte : {0x79, 0x7E, 0x92, 0x99, 0x9C, 0x9D})
    kinds[static_cast<std::size_t>(byte)] = PacketKind::debugMessage;
  for (const int byte : {0x00, 0x0C, 0x1C, 0x1D, 0x4B, 0x63, 0x73, 0x7C, 0x7D, 0x80, 0x81, 0x82})
    kinds[static_cast<std::size_t>(byte)] = PacketKind::answer;
  for (const int byte : {0x13, 0x14, 0x15, 0x18, 0x42, 0x47})
    kinds[static_cast<std::size_t>(byte)] = PacketKind::refusal;
  kinds[kLogPacket] = PacketKind::log;
  kinds[0x60] = PacketKind::events;
  kinds[0x9E] = PacketKind::encryptedLog;
  return kinds;
}

constexpr Kinds kKinds = makeKinds();

/// What is of no SIM in particular is of the first.
std::uint32_t simOf(std::uint32_t number) {
  return number == 0 || number == 0xFFFFFFFF ? 1 : number;
}

}  // namespace

std::uint64_t millisecondsOf(std::uint64_t modemTime) {
  return kMsFrom1970To1980 + (modemTime >> 16) * 5 / 4;
}

std::optional<LogPacket> readLogPacket(Bytes bytes, std::uint32_t sim) {
  if (bytes.size() < kLogHeaderSize) return std::nullopt;
  const std::size_t length = readLittleEndian<std::uint16_t>(bytes, 0);
  if (length < kLogHeaderSize || length > bytes.size()) return std::nullopt;
  return LogPacket{.code = readLittleEndian<std::uint16_t>(bytes, 2),
                   .milliseconds = millisecondsOf(readLittleEndian<std::uint64_t>(bytes, 4)),
                   .sim = sim,
                   .body = bytes.subspan(kLogHeaderSize, length - kLogHeaderSize)};
}

PacketKind kindOf(std::uint8_t firstByte) {
  return kKinds[firstByte];
}

Packet readPacket(Bytes content) {
  std::uint32_t sim = 1;
  if (content[0] == kOfOneSim) {
    if (content.size() <= kSimWrapperSize) return {PacketKind::damaged, std::nullopt, content};
    sim = simOf(readLittleEndian<std::uint32_t>(content, kSimOffset));
    content = content.subspan(kSimWrapperSize);
  }
  const PacketKind kind = kindOf(content[0]);
  if (kind != PacketKind::log) return {kind, sim, content};
  if (content.size() < kBeforeLength) return {PacketKind::damaged, sim, content};
  const std::optional<LogPacket> log = readLogPacket(content.subspan(kBeforeLength), sim);
  return {log ? PacketKind::log : PacketKind::damaged, sim, content, log};
}

}  // namespace vesk::diag
