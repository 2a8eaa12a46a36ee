#include "diag/nas/emm.h"

#include <memory>
#include <optional>

#include "diag/layout/values.h"
#include "diag/nas/elements.h"
#include "diag/nas/esm.h"
#include "diag/translation/event_batch.h"
#include "diag/translation/sim_state.h"

namespace vesk::diag {

namespace {

using namespace metrics;
using enum EmmProc;
using Emm = KCellularEmmContext;

constexpr std::uint8_t kAreaElement = 0x13;
constexpr std::uint8_t kMobileIdentityElement = 0x23;
constexpr std::uint8_t kGutiElement = 0x50;
constexpr std::uint8_t kCauseElement = 0x53;
constexpr std::uint8_t kAreasElement = 0x54;
constexpr std::uint8_t kTimerElement = 0x5A;
constexpr std::uint8_t kFeaturesElement = 0x64;

void setProcedure(Emm& emm, const std::optional<EmmProc>& procedure) {
  setOrRemove(emm, &Emm::setRegProc, &Emm::setHasRegProc, procedure);
}

void setTimer(Emm& emm, std::uint8_t timer) {
  setOrRemove(emm, &Emm::setT3412DurS, &Emm::setHasT3412DurS, gprsTimerSeconds(timer));
}

/// Reads on when the identity is a whole one: the network (3 bytes behind the first) is left out.
void setGuti(Emm& emm, ByteSpan identity) {
  constexpr std::size_t kLeastSize = 11;
  if (identity.size() < kLeastSize) return;
  auto guti = makeMessage<Guti>();
  guti->setMmegi(bigEndian(identity.subspan(4, 2)));
  guti->setMmec(identity[6]);
  guti->setMTmsi(bigEndian(identity.subspan(7, 4)));
  emm.setGuti(std::move(guti));
}

void addBearers(NasMessage& message) {
  auto report = message.sim.bearers.report();
  message.events.add(report);
}

/// Requests differ in what the last three bits of their third byte mean.
Reading readRequest(NasMessage& message, std::optional<EmmProc> (*procedureOf)(unsigned type)) {
  ByteReader reader(message.bytes);
  const unsigned type = reader.byte(2) & 7U;
  if (reader.isCutOff()) return Reading::damaged;
  setProcedure(message.sim.emm, procedureOf(type));
  message.events.add(message.sim.emm);
  return Reading::read;
}

std::optional<EmmProc> attachOf(unsigned type) {
  switch (type) {
    case 1:
      return EMM_PROC_ATTACH;
    case 2:
      return EMM_PROC_ATTACH_COMB;
    case 6:
      return EMM_PROC_EMERGENCY_ATTACH;
    default:
      return std::nullopt;
  }
}

std::optional<EmmProc> updateOf(unsigned type) {
  switch (type) {
    case 0:
      return EMM_PROC_TAU;
    case 1:
    case 2:
      return EMM_PROC_TAU_COMB;
    case 3:
      return EMM_PROC_PERIODIC_TAU;
    default:
      return std::nullopt;
  }
}

Reading readAttachRequest(NasMessage& message) {
  return readRequest(message, attachOf);
}

Reading readUpdateRequest(NasMessage& message) {
  return readRequest(message, updateOf);
}

Reading readServiceRequest(NasMessage& message) {
  message.sim.emm.setRegProc(EMM_PROC_SERV_REQ);
  message.events.add(message.sim.emm);
  return Reading::read;
}

/// The accept of a combined procedure registers with UMTS and GSM too.
void addCombined(const Elements& elements, NasMessage& message) {
  const auto area = elements.find(kAreaElement);
  if (!area) return;
  KCellularMmContext& mm = message.sim.mm;
  mm.setUpdateStatus(MmUpdateStatus::STATUS_UPDATED);
  mm.setLai(locationArea(area->first<5>()));
  mm.setIsCombinedProc(true);
  const auto identity = elements.find(kMobileIdentityElement);
  if (identity && identity->size() == 5) mm.setTmsi(bigEndian(identity->last(4)));
  message.events.add(mm);
}

/// What attach and update accepts have in common, once all of them is known to be sound.
void applyAccept(const Elements& elements, bool isCombined, NasMessage& message) {
  Emm& emm = message.sim.emm;
  if (const auto identity = elements.find(kGutiElement)) setGuti(emm, *identity);
  const auto features = elements.find(kFeaturesElement);
  if (features && !features->empty()) {
    emm.setIsImsVoiceSupported((features->front() & 1U) != 0);
    emm.setIsEmergBearerSupported((features->front() & 2U) != 0);
  }
  emm.setUpdateStatus(EpsUpdateStatus::EPS_STATUS_UPDATED);
  emm.setRegProc(EMM_PROC_NO_PROC);
  std::optional<EmmCause> cause;
  if (const auto element = elements.find(kCauseElement)) cause = static_cast<EmmCause>(element->front());
  setOrRemove(emm, &Emm::setRejectCause, &Emm::setHasRejectCause, cause);
  message.events.add(emm);

  if (isCombined) addCombined(elements, message);
  addEquivalentNetworks(elements, message.events);
}

Reading readAttachAccept(NasMessage& message) {
  constexpr unsigned kCombined = 2;
  ByteReader reader(message.bytes);
  const unsigned result = reader.byte(2) & 7U;
  const std::uint8_t timer = reader.byte(3);
  const std::size_t areasSize = reader.byte(4);
  const auto areas = readTrackingAreas(reader.part(5, areasSize));
  const std::size_t container = 5 + areasSize;
  const std::size_t containerSize = reader.bigEndian(container, 2);
  const auto bearerMessage = readEsmMessage(reader.part(container + 2, containerSize));
  const Elements elements(reader.rest(container + 2 + containerSize), kEpsElements);
  if (reader.isCutOff() || !areas || !bearerMessage) return Reading::damaged;

  SimState& sim = message.sim;
  sim.bearers.reset();
  // With no bearer left, it can only ask for one.
  static_cast<void>(apply(*bearerMessage, sim.bearers));
  setTimer(sim.emm, timer);
  sim.emm.setTaiLists(areas->list);
  applyAccept(elements, result == kCombined, message);
  return Reading::read;
}

Reading readUpdateAccept(NasMessage& message) {
  constexpr unsigned kCombined = 1;
  constexpr unsigned kCombinedWithInternetVoice = 5;
  ByteReader reader(message.bytes);
  const unsigned result = reader.byte(2) & 7U;
  const Elements elements(reader.rest(3), kEpsElements);
  if (reader.isCutOff()) return Reading::damaged;
  std::optional<TrackingAreas> areas;
  if (const auto element = elements.find(kAreasElement)) {
    areas = readTrackingAreas(*element);
    if (!areas) return Reading::damaged;
  }

  if (const auto timer = elements.find(kTimerElement)) setTimer(message.sim.emm, timer->front());
  if (areas) message.sim.emm.setTaiLists(areas->list);
  applyAccept(elements, result == kCombined || result == kCombinedWithInternetVoice, message);
  return Reading::read;
}

Reading readReject(NasMessage& message) {
  using enum EpsUpdateStatus;
  Emm& emm = message.sim.emm;
  if (!setReject<EmmCause>(message.bytes, forbidsRegistration, EPS_STATUS_ROAMING_NOT_ALLOWED, EPS_STATUS_NOT_UPDATED,
                           emm))
    return Reading::damaged;
  emm.setRegProc(EMM_PROC_NO_PROC);
  message.events.add(emm);
  return Reading::read;
}

Reading readDetachRequest(NasMessage& message) {
  message.sim.emm.setRegStatus(RegStatus::KREG_STATUS_SERVICE_DETACHED);
  message.events.add(message.sim.emm);
  message.sim.bearers.reset();
  addBearers(message);
  return Reading::read;
}

Reading readAttachComplete(NasMessage& message) {
  ByteReader reader(message.bytes);
  const auto bearerMessage = readEsmMessage(reader.part(4, reader.bigEndian(2, 2)));
  if (reader.isCutOff() || !bearerMessage) return Reading::damaged;
  if (apply(*bearerMessage, message.sim.bearers)) addBearers(message);
  return Reading::read;
}

Reading readReallocation(NasMessage& message) {
  ByteReader reader(message.bytes);
  const std::size_t size = reader.byte(2);
  const ByteSpan identity = reader.part(3, size);
  const auto element = Elements(reader.rest(3 + size), kEpsElements).find(kAreasElement);
  const auto areas = element ? readTrackingAreas(*element) : std::nullopt;
  if (reader.isCutOff() || (element && !areas)) return Reading::damaged;
  setGuti(message.sim.emm, identity);
  if (areas) message.sim.emm.setTaiLists(areas->list);
  message.events.add(message.sim.emm);
  return Reading::read;
}

struct EmmType {
  std::uint8_t type;
  Reading (*read)(NasMessage& message);
};

constexpr EmmType kEmmTypes[] = {
    {0x41, readAttachRequest},  {0x42, readAttachAccept},  {0x43, readAttachComplete}, {0x44, readReject},
    {0x45, readDetachRequest},  {0x48, readUpdateRequest}, {0x49, readUpdateAccept},   {0x4B, readReject},
    {0x4C, readServiceRequest}, {0x4E, readReject},        {0x50, readReallocation},
};

}  // namespace

Reading readEmmMessage(ByteSpan bytes, SimState& sim, EventBatch& events) {
  constexpr unsigned kPlain = 0;
  constexpr unsigned kServiceRequest = 12;
  NasMessage message{bytes, sim, events};
  const unsigned protection = bytes[0] >> 4;
  if (protection == kServiceRequest) return readServiceRequest(message);
  if (protection != kPlain) return Reading::read;
  if (bytes.size() < 2) return Reading::damaged;
  for (const EmmType& row : kEmmTypes) {
    if (row.type == bytes[1]) return row.read(message);
  }
  return Reading::read;
}

}  // namespace vesk::diag
