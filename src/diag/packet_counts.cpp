#include "diag/packet_counts.h"

#include <algorithm>
#include <numeric>

#include "diag/modem_clock.h"

namespace vesk::diag {

namespace {

constexpr std::size_t kMostVarieties = 4096;

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
  noteSim(packet.sim);
  add({packet.code, version}, reading);
}

void PacketCounts::note(PacketKind kind) {
  ++kinds_[static_cast<std::size_t>(kind)];
}

std::uint64_t PacketCounts::frames() const {
  const std::uint64_t logs = logs_.read + logs_.passedOver + logs_.damaged;
  return std::accumulate(kinds_.begin(), kinds_.end(), damagedFrames_ + ofOtherSims_ + logs);
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

void PacketCounts::noteSim(std::uint32_t sim) {
  if (std::find(sims_.begin(), sims_.end(), sim) != sims_.end()) return;
  if (sims_.size() < kMostSims) {
    sims_.push_back(sim);
  } else {
    hasMoreSims_ = true;
  }
}

void PacketCounts::add(const PacketVariety& variety, Reading reading) {
  const auto known = byVariety_.find(variety);
  if (known != byVariety_.end()) {
    known->second.note(reading);
  } else if (byVariety_.size() < kMostVarieties) {
    byVariety_[variety].note(reading);
  } else {
    ofOtherVarieties_.note(reading);
  }
}

}  // namespace vesk::diag
