#include "diag/layout/byte_reader.h"
#include "diag/nas/emm.h"
#include "diag/nas/esm.h"
#include "diag/nas/nas_logs.h"
#include "diag/translation/event_batch.h"
#include "diag/translation/sim_state.h"

namespace vesk::diag {

Reading readEpsNasMessage(const LogPacket& packet, SimState& sim, EventBatch& events) {
  constexpr std::uint8_t kVersion = 1;
  // Version, and the release of the standard that it follows.
  constexpr std::size_t kHeaderSize = 4;
  constexpr unsigned kEmm = 7;
  constexpr unsigned kEsm = 2;

  ByteReader body(packet.body);
  if (body.byte(0) != kVersion) return Reading::passedOver;
  const unsigned protocol = body.byte(kHeaderSize) & 15U;
  if (body.isCutOff()) return Reading::damaged;
  const ByteSpan bytes = packet.body.subspan(kHeaderSize);
  if (protocol == kEmm) return readEmmMessage(bytes, sim, events);
  if (protocol != kEsm) return Reading::read;

  const auto message = readEsmMessage(bytes);
  if (!message) return Reading::damaged;
  if (apply(*message, sim.bearers)) {
    auto report = sim.bearers.report();
    events.add(report);
  }
  return Reading::read;
}

}  // namespace vesk::diag
