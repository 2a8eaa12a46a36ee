#include "diag/translation/translator.h"

#include <algorithm>

#include "diag/translation/log_kind.h"

namespace vesk::diag {

Translation Translator::translate(const LogPacket& packet) {
  const LogKind* kind = findLogKind(packet.code);
  if (kind == nullptr) return {Reading::passedOver, {}};
  if (kind->versionPlace != VersionPlace::none && packet.body.empty()) return {Reading::damaged, {}};

  batch_.begin(packet.milliseconds);
  const Reading reading = kind->read(packet, stateOf(packet.sim), batch_);
  if (reading != Reading::read) return {reading, {}};
  return {reading, batch_.events()};
}

SimState& Translator::stateOf(std::uint32_t sim) {
  const auto known = std::find_if(sims_.begin(), sims_.end(), [sim](const Sim& held) { return held.number == sim; });
  if (known != sims_.end()) {
    std::rotate(sims_.begin(), known, known + 1);
  } else {
    if (sims_.size() == kMostSims) sims_.pop_back();
    sims_.insert(sims_.begin(), Sim{sim, std::make_unique<SimState>()});
  }
  return *sims_.front().state;
}

}  // namespace vesk::diag
