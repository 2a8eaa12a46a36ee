#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <unordered_map>
#include <vector>

#include "diag/framing/packet_reader.h"
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

/// The packets of one code and version.
struct CodeTally {
  std::uint16_t code;
  /// Absent where packets of this code have none.
  std::optional<std::uint8_t> version;
  Tally tally;
};

/// What came and what became of it. Memory is bounded whatever comes.
class PacketCounts {
 public:
  void noteLog(const LogPacket& packet, std::optional<std::uint8_t> version, Reading reading);
  /// Anything but a log packet that is whole.
  void note(PacketKind kind);
  void noteOtherSim() { ++ofOtherSims_; }
  void noteDamagedFrame() { ++damagedFrames_; }

  /// Of all log packets that are whole.
  [[nodiscard]] const Tally& logs() const { return logs_; }
  /// By code and version, in their order.
  [[nodiscard]] std::vector<CodeTally> byCode() const;
  /// Of log packets of more codes and versions than are told apart.
  [[nodiscard]] const Tally& ofOtherCodes() const { return ofOtherCodes_; }
  [[nodiscard]] std::uint64_t of(PacketKind kind) const { return kinds_[static_cast<std::size_t>(kind)]; }
  [[nodiscard]] std::uint64_t damagedFrames() const { return damagedFrames_; }
  /// Of SIMs that were not chosen: not counted anywhere else.
  [[nodiscard]] std::uint64_t ofOtherSims() const { return ofOtherSims_; }

  /// Frames that are not sound, and packets that are not what they say.
  [[nodiscard]] std::uint64_t damaged() const;
  /// Packets that hold nothing of ours, or that nobody can read.
  [[nodiscard]] std::uint64_t passedOver() const;

  /// Which SIMs the log packets were of, in the order they came; no more than a handset has.
  [[nodiscard]] const std::vector<std::uint32_t>& sims() const { return sims_; }
  /// Whether a packet's time lies before 2000: no network had set the modem's clock.
  [[nodiscard]] bool hasUnsetClock() const { return hasUnsetClock_; }

 private:
  Tally logs_;
  Tally ofOtherCodes_;
  std::unordered_map<std::uint32_t, Tally> byCode_;
  std::array<std::uint64_t, kPacketKinds> kinds_{};
  std::uint64_t damagedFrames_ = 0;
  std::uint64_t ofOtherSims_ = 0;
  std::vector<std::uint32_t> sims_;
  bool hasUnsetClock_ = false;
};

}  // namespace vesk::diag
