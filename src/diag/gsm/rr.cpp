#include "diag/gsm/gsm_logs.h"
#include "diag/gsm/rr_messages.h"
#include "diag/layout/byte_reader.h"
#include "diag/translation/event_batch.h"

namespace vesk::diag {

namespace {

enum Channel : std::uint8_t { dcch = 0, bcch = 1, sacch = 4 };

struct RrType {
  Channel channel;
  std::uint8_t type;
  Reading (*read)(ByteSpan message, SimState& sim, EventBatch& events);
};

constexpr RrType kRrTypes[] = {
    {bcch, 0x00, readSystemInformation13},
    {bcch, 0x1B, readSystemInformation3},
    {dcch, 0x15, readGsmMeasurementReport},
    {sacch, 0x15, readGsmMeasurementReport},
};

}  // namespace

Reading readGsmRrMessage(const LogPacket& packet, SimState& sim, EventBatch& events) {
  constexpr std::size_t kHeaderSize = 3;
  constexpr std::uint8_t kRadioResources = 6;
  ByteReader body(packet.body);
  const unsigned channel = body.byte(0) & 127U;
  const ByteSpan bytes = body.part(kHeaderSize, body.byte(2));
  if (body.isCutOff()) return Reading::damaged;
  if (channel != dcch && channel != bcch && channel != sacch) return Reading::read;

  ByteReader message(bytes);
  const std::size_t start = channel == bcch ? 1 : 0;
  const bool isOfRadioResources = message.byte(start) == kRadioResources;
  const std::uint8_t type = isOfRadioResources ? message.byte(start + 1) : std::uint8_t{0};
  if (message.isCutOff()) return Reading::damaged;
  if (!isOfRadioResources) return Reading::read;
  for (const RrType& row : kRrTypes) {
    if (row.channel == channel && row.type == type) return row.read(bytes, sim, events);
  }
  return Reading::read;
}

}  // namespace vesk::diag
