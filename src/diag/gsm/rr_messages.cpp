#include "diag/gsm/rr_messages.h"

#include <algorithm>
#include <optional>

#include "diag/gsm/serving_cell.h"
#include "diag/layout/bit_reader.h"
#include "diag/layout/values.h"
#include "diag/translation/event_batch.h"
#include "diag/translation/sim_state.h"

namespace vesk::diag {

namespace {

using namespace metrics;
using namespace notation;

/// The octets at a message's end in which later releases have put what they added. A bit there is high when it differs
/// from the padding, which phones of before take it for.
class RestOctets {
 public:
  explicit RestOctets(ByteSpan bytes) : bits_(bytes) {}

  [[nodiscard]] bool isNextHigh() {
    constexpr std::uint32_t kPadding = 0x2B;
    const std::uint32_t low = kPadding >> (7 - bits_.position() % 8) & 1U;
    return bits_.next(1) != low;
  }
  [[nodiscard]] std::uint32_t next(unsigned count) { return bits_.next(count); }
  [[nodiscard]] bool nextFlag() { return bits_.nextFlag(); }
  void skip(std::size_t count) { bits_.skip(count); }
  [[nodiscard]] std::size_t position() const { return bits_.position(); }
  [[nodiscard]] bool isCutOff() const { return bits_.isCutOff(); }

 private:
  BitReader bits_;
};

void setFromRestOctets(KCellularGsmIdleConfig& config, RestOctets rest) {
  const bool hasReselection = rest.isNextHigh();
  config.setC2Valid(hasReselection ? 1 : 0);
  if (hasReselection) {
    config.setCbq(rest.next(1));
    config.setCrOffset(rest.next(6));
    config.setTmpOffset(rest.next(3));
    config.setPenaltyT(rest.next(5));
  }
  const bool hasPowerOffset = rest.isNextHigh();
  if (hasPowerOffset) rest.skip(2);
  config.setSi2TerNeeded(rest.isNextHigh() ? 1 : 0);
  config.setEcsc(rest.isNextHigh() ? 1 : 0);
}

/// Passes over the frequencies that a cell hops on.
void skipMobileAllocation(RestOctets& rest) {
  rest.skip(2 + 6);
  while (rest.nextFlag())
    rest.skip(4);
  const bool isListOfNumbers = rest.nextFlag();
  if (isListOfNumbers) {
    while (rest.nextFlag())
      rest.skip(6);
  } else {
    rest.skip(rest.next(6) + 1);
  }
}

/// Whether phones may ask for more blocks while they send, where the cell says so.
std::optional<bool> readExtension(RestOctets& rest) {
  const std::size_t size = rest.next(6) + 1;
  const std::size_t end = rest.position() + size;
  if (rest.nextFlag()) rest.skip(5);
  rest.skip(4);
  if (rest.position() >= end) return std::nullopt;
  return rest.nextFlag();
}

}  // namespace

Reading readSystemInformation3(ByteSpan message, SimState& sim, EventBatch& events) {
  constexpr std::size_t kSize = 23;
  if (message.size() < kSize) return Reading::damaged;
  ByteReader m(message);
  const GsmCellIdentity identity{plmnDigits(message.subspan<5, 3>()), m.bigEndian(8, 2), m.bigEndian(3, 2)};
  addGsmServingCell(identity, sim.gsmCell, events);

  const std::uint32_t accessClasses = m.bigEndian(17, 2);
  KCellularGsmIdleConfig config;
  config.setMcc(identity.network.mcc);
  config.setMnc(identity.network.mnc);
  config.setLac(identity.lac);
  config.setCi(identity.cellId);
  config.setAttachAllowed(m.get(b(10, 6, 1)));
  config.setBsPaMfrms(m.get(b(11, 0, 3)) + 2);
  config.setT3212(m.byte(12));
  config.setDtxFromBs(m.get(b(13, 4, 2)));
  config.setRadioLinkTimeout(4 * (m.get(b(13, 0, 4)) + 1));
  config.setMsTxpwr(m.get(b(14, 0, 5)));
  config.setRxAccMin(m.get(b(15, 0, 6)));
  config.setCba(m.get(b(16, 1, 1)));
  config.setReestAllowed(1 - m.get(b(16, 0, 1)));
  config.setMaxRetransCs(m.get(b(16, 6, 2)));
  config.setAcc(accessClasses);
  config.setEmergCallAllowed(1 - (accessClasses >> 10 & 1U));
  setFromRestOctets(config, RestOctets(message.subspan<19, 4>()));
  events.add(config);
  return Reading::read;
}

Reading readSystemInformation13(ByteSpan message, SimState& /*sim*/, EventBatch& events) {
  if (message.size() < 3) return Reading::damaged;
  RestOctets rest(message.subspan(3));
  const bool hasPacketService = rest.isNextHigh();
  if (rest.isCutOff()) return Reading::damaged;
  if (!hasPacketService) return Reading::read;

  rest.skip(3 + 4);
  if (rest.nextFlag()) skipMobileAllocation(rest);
  const bool hasPacketBroadcast = rest.nextFlag();
  if (rest.isCutOff()) return Reading::damaged;
  if (hasPacketBroadcast) return Reading::read;

  KCellularGsmGprsConfig config;
  config.setGprsSup(true);
  config.setRac(rest.next(8));
  config.setSpPgCy(rest.nextFlag());
  config.setAccThr(rest.next(3));
  config.setNco(rest.next(2));
  config.setNom(rest.next(2) + 1);
  rest.skip(15);
  if (rest.nextFlag()) rest.skip(9);
  if (rest.nextFlag()) setWhenKnown(config, &KCellularGsmGprsConfig::setExtUplTbfSupported, readExtension(rest));
  if (rest.isCutOff()) return Reading::damaged;
  events.add(config);
  return Reading::read;
}

Reading readGsmMeasurementReport(ByteSpan message, SimState& /*sim*/, EventBatch& events) {
  constexpr std::size_t kSize = 16;
  constexpr std::size_t kNeighbours = 26;
  constexpr std::uint32_t kNoNeighbours = 7;
  const ByteSpan report = message.subspan(2);
  BitReader bits(report.first(std::min(report.size(), kSize)));
  const bool isNotValid = bits.at(9, 1) != 0;
  if (bits.isCutOff()) return Reading::damaged;
  if (isNotValid) return Reading::read;

  KCellularGsmCsRfMeasurement serving;
  serving.setCsRxlevSub(bits.at(10, 6));
  serving.setCsRxqualSub(bits.at(20, 3));
  const std::uint32_t count = bits.at(23, 3);
  KCellularGsmGrrEventMeasCr neighbours;
  bits.seek(kNeighbours);
  for (std::uint32_t index = 0; count != kNoNeighbours && index < count; ++index) {
    auto cell = makeMessage<GsmNcellMeas>();
    cell->setRxlev(bits.next(6));
    bits.skip(5);  // its place in a list that the report does not hold
    cell->setBsic(bits.next(6));
    neighbours.addGsmNcellMeas(std::move(cell));
  }
  if (bits.isCutOff()) return Reading::damaged;
  events.add(serving);
  if (neighbours.gsmNcellMeasCount() != 0) events.add(neighbours);
  return Reading::read;
}

}  // namespace vesk::diag
