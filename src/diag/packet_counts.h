#pragma once

#include <array>
#include <compare>
#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <vector>

#include "diag/framing/packet_reader.h"
#include "diag/layout/version.h"
#include "diag/packet.h"

namespace vesk::diag {

/// What became of some packets.
struct Tally {
  std::uint64_t read = 0;
  std::uint64_t passedOver = 0;
  std::uint64_t damaged = 0;

  void note(Reading reading);
  Tally& operator+=(const Tally& other);
};

/// What is counted together: the packets of one code and version, or the subpackets of one kind in them.
struct PacketVariety {
  std::uint16_t code;
  /// Absent where packets of this code have none.
  std::optional<std::uint8_t> version;
  std::optional<Version::Subpacket> subpacket{};
  auto operator<=>(const PacketVariety&) const = default;
};

/// What came and what became of it. Memory is bounded whatever comes.
class PacketCounts {
 public:
  void noteLog(const LogPacket& packet, std::optional<std::uint8_t> version, Reading reading);
  /// A part of a packet, noted besides, that nobody can read.
  void noteUnreadSubpacket(const PacketVariety& variety) { add(variety, Reading::passedOver); }
  /// Anything but a log packet that is whole.
  void note(PacketKind kind);
  void noteOtherSim() { ++ofOtherSims_; }
  void noteDamagedFrame() { ++damagedFrames_; }

  /// Of all log packets that are whole.
  [[nodiscard]] const Tally& logs() const { return logs_; }
  /// By code and version, with the subpackets that were not read behind their packets.
  [[nodiscard]] const std::map<PacketVariety, Tally>& byVariety() const { return byVariety_; }
  /// Of more codes and versions than are told apart.
  [[nodiscard]] const Tally& ofOtherVarieties() const { return ofOtherVarieties_; }
  [[nodiscard]] std::uint64_t of(PacketKind kind) const { return kinds_[static_cast<std::size_t>(kind)]; }
  [[nodiscard]] std::uint64_t damagedFrames() const { return damagedFrames_; }
  /// Of a port or a capture with frames: all that came, sound or not.
  [[nodiscard]] std::uint64_t frames() const;
  /// Of SIMs that were not chosen: not counted anywhere else.
  [[nodiscard]] std::uint64_t ofOtherSims() const { return ofOtherSims_; }

  /// Frames that are not sound, and packets that are not what they say.
  [[nodiscard]] std::uint64_t damaged() const;
  /// Packets that hold nothing of ours, or that nobody can read.
  [[nodiscard]] std::uint64_t passedOver() const;

  /// Which SIMs the log packets were of, in the order they came; no more than kMostSims.
  [[nodiscard]] const std::vector<std::uint32_t>& sims() const { return sims_; }
  /// Whether there were more than that.
  [[nodiscard]] bool hasMoreSims() const { return hasMoreSims_; }
  /// Whether a packet's time lies before 2000: no network had set the modem's clock.
  [[nodiscard]] bool hasUnsetClock() const { return hasUnsetClock_; }

 private:
  void noteSim(std::uint32_t sim);
  void add(const PacketVariety& variety, Reading reading);

  Tally logs_;
  std::map<PacketVariety, Tally> byVariety_;
  Tally ofOtherVarieties_;
  std::array<std::uint64_t, kPacketKinds> kinds_{};
  std::uint64_t damagedFrames_ = 0;
  std::uint64_t ofOtherSims_ = 0;
  std::vector<std::uint32_t> sims_;
  bool hasMoreSims_ = false;
  bool hasUnsetClock_ = false;
};

}  // namespace vesk::diag
