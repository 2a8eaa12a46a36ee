#pragma once

#include <cstdint>
#include <memory>
#include <span>
#include <vector>

#include "diag/packet.h"
#include "diag/translation/event_batch.h"
#include "diag/translation/sim_state.h"

namespace vesk::diag {

/// What a packet has become.
struct Translation {
  Reading reading;
  /// In the order in which they are to be told; valid until the next packet is translated.
  std::span<const Event> events;
};

/// Makes metric events of log packets. Remembers of each SIM what later events are made of, and depends on nothing but
/// the packets: no clock, no thread, no input or output.
class Translator {
 public:
  [[nodiscard]] Translation translate(const LogPacket& packet);

 private:
  [[nodiscard]] SimState& stateOf(std::uint32_t sim);

  struct Sim {
    std::uint32_t number;
    std::unique_ptr<SimState> state;
  };
  /// No more than kMostSims; the one that was heard of last comes first.
  std::vector<Sim> sims_;
  EventBatch batch_;
};

}  // namespace vesk::diag
