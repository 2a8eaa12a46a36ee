#include "diag/receiver.h"

#include "diag/translation/log_kind.h"

namespace vesk::diag {

std::span<const Event> Receiver::take(const Packet& packet) {
  if (packet.log) return take(*packet.log);
  if (isOfOther(packet.sim)) {
    counts_.noteOtherSim();
  } else {
    counts_.note(packet.kind);
  }
  return {};
}

std::span<const Event> Receiver::take(const LogPacket& packet) {
  if (isOfOther(packet.sim)) {
    counts_.noteOtherSim();
    return {};
  }
  const Translation translation = translator_->translate(packet);
  const std::optional<std::uint8_t> version = versionOf(packet);
  counts_.noteLog(packet, version, translation.reading);
  if (translation.reading != Reading::damaged) {
    for (const Version::Subpacket& unread : unreadSubpacketsOf(packet))
      counts_.noteUnreadSubpacket({packet.code, version, unread});
  }
  return translation.events;
}

}  // namespace vesk::diag
