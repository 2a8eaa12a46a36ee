#include "diag/packet_counts.h"

#include <algorithm>

#include "diag/modem_clock.h"

namespace vesk::diag {

namespace {

constexpr std::size_t kMostCodes = 4096;
constexpr std::size_t kMostSims = 4;

constexpr std::uint32_t kNoVersion = 0x100;

std::uint32_t keyOf(std::uint16_t code, std::optional<std::uint8_t> version) {
  return std::uint32_t{code} << 16 | (version ? *version : kNoVersion);
}

}  // namespace

void Tally::note(Reading reading) {
  switch (reading) {
    case Reading::read:
      ++read;
      break;
    case Reading::passedOver:
      ++passedOver;
      break;
    case Reading::damaged:
      ++damaged;
      break;
  }
}

void PacketCounts::noteLog(const LogPacket& packet, std::optional<std::uint8_t> version, Reading reading) {
  logs_.note(reading);
  if (isBeforeClockIsSet(packet.milliseconds)) hasUnsetClock_ = true;
  if (sims_.size() < kMostSims && std::find(sims_.begin(), sims_.end(), packet.sim) == sims_.end())
    sims_.push_back(packet.sim);
  const std::uint32_t key = keyOf(packet.code, version);
  const auto known = byCode_.find(key);
  if (known != byCode_.end()) {
    known->second.note(reading);
  } else if (byCode_.size() < kMostCodes) {
    byCode_[key].note(reading);
  } else {
    ofOtherCodes_.note(reading);
  }
}

void PacketCounts::note(PacketKind kind) {
  ++kinds_[static_cast<std::size_t>(kind)];
}

std::vector<CodeTally> PacketCounts::byCode() const {
  std::vector<CodeTally> rows;
  for (const auto& [key, tally] : byCode_) {
    const bool hasVersion = (key & kNoVersion) == 0;
    rows.push_back({.code = static_cast<std::uint16_t>(key >> 16),
                    .version = hasVersion ? std::optional(static_cast<std::uint8_t>(key)) : std::nullopt,
                    .tally = tally});
  }
  std::sort(rows.begin(), rows.end(), [](const CodeTally& left, const CodeTally& right) {
    return std::pair(left.code, left.version) < std::pair(right.code, right.version);
  });
  return rows;
}

std::uint64_t PacketCounts::damaged() const {
  return damagedFrames_ + logs_.damaged + of(PacketKind::damaged);
}

std::uint64_t PacketCounts::passedOver() const {
  std::uint64_t count = logs_.passedOver;
  for (const PacketKind kind : {PacketKind::events, PacketKind::debugMessage, PacketKind::answer, PacketKind::refusal,
                                PacketKind::encryptedLog, PacketKind::unknown})
    count += of(kind);
  return count;
}

}  // namespace vesk::diag
