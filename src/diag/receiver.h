#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <utility>

#include "diag/framing/packet_reader.h"
#include "diag/packet.h"
#include "diag/packet_counts.h"
#include "diag/translation/translator.h"

namespace vesk::diag {

/// Takes packets in the order a modem sent them, makes events of those of the SIMs that are wanted, and counts what
/// became of each.
class Receiver {
 public:
  /// `sim` is the one that is wanted; absent for all.
  explicit Receiver(std::optional<std::uint32_t> sim) : sim_(sim) {}

  /// The packet's events, valid until the next call.
  std::span<const Event> take(const Packet& packet);
  std::span<const Event> take(const LogPacket& packet);
  void noteDamagedFrame() { counts_.noteDamagedFrame(); }
  void noteDamagedPacket() { counts_.note(PacketKind::damaged); }
  /// Forgets all that came.
  void startOver() {
    translator_.emplace();
    counts_ = {};
  }

  [[nodiscard]] const PacketCounts& counts() const { return counts_; }

 private:
  /// Whether a packet is of a SIM that is not wanted; one of no known SIM is not.
  [[nodiscard]] bool isOfOther(std::optional<std::uint32_t> sim) const { return sim_ && sim && *sim != *sim_; }

  std::optional<std::uint32_t> sim_;
  std::optional<Translator> translator_{std::in_place};
  PacketCounts counts_;
};

}  // namespace vesk::diag
