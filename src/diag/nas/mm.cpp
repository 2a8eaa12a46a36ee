#include <algorithm>
#include <iterator>
#include <optional>

#include "diag/layout/byte_reader.h"
#include "diag/layout/values.h"
#include "diag/nas/elements.h"
#include "diag/nas/nas_logs.h"
#include "diag/nas/registration_status.h"
#include "diag/translation/event_batch.h"
#include "diag/translation/sim_state.h"

namespace vesk::diag {

namespace {

using namespace metrics;
using namespace notation;
using enum RegStatus;
using enum NasMmRegProc;
using Gmm = KCellularGmmContext;

constexpr StatusOfState kMmStatuses[] = {
    {19, 8, KREG_STATUS_NORMAL_SERVICE},
    {19, 7, KREG_STATUS_NORMAL_SERVICE},
    {19, 3, KREG_STATUS_LIMITED_SERVICE},
    {19, 2, KREG_STATUS_NO_SERVICE},
    {19, 6, KREG_STATUS_NO_SERVICE},
    {19, 4, KREG_STATUS_AT_NOT_REGISTERED},
    {19, 5, KREG_STATUS_AT_NOT_REGISTERED},
    {3, std::nullopt, KREG_STATUS_REGISTRATION_IN_PROGRESS},
    {14, std::nullopt, KREG_STATUS_REGISTRATION_IN_PROGRESS},
};

constexpr StatusOfState kGmmStatuses[] = {
    {3, 0, KREG_STATUS_NORMAL_SERVICE},
    {3, 1, KREG_STATUS_LIMITED_SERVICE},
    {3, 5, KREG_STATUS_NO_SERVICE},
    {3, 6, KREG_STATUS_NO_SERVICE},
    {3, 7, KREG_STATUS_NORMAL_SERVICE},
    {1, 0, KREG_STATUS_AT_NOT_REGISTERED},
    {1, 1, KREG_STATUS_LIMITED_SERVICE},
    {1, 2, KREG_STATUS_AT_NOT_REGISTERED},
    {1, 3, KREG_STATUS_AT_NOT_REGISTERED},
    {1, 5, KREG_STATUS_NO_SERVICE},
    {1, 6, KREG_STATUS_NO_SERVICE},
    {2, std::nullopt, KREG_STATUS_REGISTRATION_IN_PROGRESS},
    {5, std::nullopt, KREG_STATUS_REGISTRATION_IN_PROGRESS},
    {6, std::nullopt, KREG_STATUS_NORMAL_SERVICE},
    {4, std::nullopt, KREG_STATUS_SERVICE_DETACHED},
};

/// By the number that the modem has for each.
constexpr MmUpdateStatus kMmUpdates[] = {MmUpdateStatus::STATUS_UPDATED, MmUpdateStatus::STATUS_NOT_UPDATED,
                                         MmUpdateStatus::STATUS_ROAMING_NOT_ALLOWED};
constexpr GprsUpdateStatus kGmmUpdates[] = {
    GprsUpdateStatus::GPRS_STATUS_UPDATED, GprsUpdateStatus::GPRS_STATUS_NOT_UPDATED,
    GprsUpdateStatus::GPRS_STATUS_ROAMING_NOT_ALLOWED, GprsUpdateStatus::GPRS_STATUS_ROAMING_NOT_ALLOWED};

/// What the modem has made of a registration: state, substate, update status.
template <class Context, class Update, std::size_t Count>
Reading readState(const LogPacket& packet, std::span<const StatusOfState> statuses, const Update (&updates)[Count],
                  Context& context, EventBatch& events) {
  ByteReader body(packet.body);
  const auto status = statusOf(statuses, body.byte(0), body.byte(1));
  const std::uint8_t update = body.byte(2);
  if (body.isCutOff()) return Reading::damaged;
  setWhenKnown(context, &Context::setRegStatus, status);
  if (update < Count) context.setUpdateStatus(updates[update]);
  events.add(context);
  return Reading::read;
}

Reading readLocationAccept(NasMessage& message) {
  constexpr std::uint8_t kIdentityElement = 0x17;
  ByteReader reader(message.bytes);
  const ByteSpan area = reader.part(2, 5);
  if (reader.isCutOff()) return Reading::damaged;

  // An identity comes first, with a length here, unlike another element of its number.
  std::optional<std::uint32_t> tmsi;
  ByteSpan rest = reader.rest(7);
  if (!rest.empty() && rest.front() == kIdentityElement) {
    const ByteSpan identity = reader.part(9, reader.byte(8));
    tmsi = temporaryIdentity(identity);
    rest = reader.isCutOff() ? ByteSpan{} : reader.rest(9 + identity.size());
  }

  KCellularMmContext& mm = message.sim.mm;
  mm.setUpdateStatus(MmUpdateStatus::STATUS_UPDATED);
  mm.setLai(locationArea(area.first<5>()));
  mm.setIsCombinedProc(false);
  mm.setHasRejectCause(false);
  setWhenKnown(mm, &KCellularMmContext::setTmsi, tmsi);
  message.events.add(mm);
  addEquivalentNetworks(Elements(rest, kEpsElements), message.events);
  return Reading::read;
}

bool forbidsLocation(std::uint8_t cause) {
  static constexpr std::uint8_t kForbidding[] = {2, 3, 6, 11, 12, 13, 15};
  return std::find(std::begin(kForbidding), std::end(kForbidding), cause) != std::end(kForbidding);
}

Reading readLocationReject(NasMessage& message) {
  using enum MmUpdateStatus;
  KCellularMmContext& mm = message.sim.mm;
  if (!setReject<NasMmRejectCause>(message.bytes, forbidsLocation, STATUS_ROAMING_NOT_ALLOWED, STATUS_NOT_UPDATED, mm))
    return Reading::damaged;
  message.events.add(mm);
  return Reading::read;
}

void addGprsRequest(std::optional<NasMmRegProc> procedure, NasMessage& message) {
  setOrRemove(message.sim.gmm, &Gmm::setRegProc, &Gmm::setHasRegProc, procedure);
  message.events.add(message.sim.gmm);
}

Reading readGprsAttachRequest(NasMessage& message) {
  ByteReader reader(message.bytes);
  const std::size_t capabilitySize = reader.byte(2);
  const unsigned type = reader.byte(3 + capabilitySize) & 7U;
  if (reader.isCutOff()) return Reading::damaged;
  std::optional<NasMmRegProc> procedure;
  if (type == 1) procedure = KNAS_MM_REG_PROC_ATTACH;
  if (type == 2 || type == 3) procedure = KNAS_MM_REG_PROC_COMBINED_ATTACH;
  addGprsRequest(procedure, message);
  return Reading::read;
}

Reading readRoutingRequest(NasMessage& message) {
  ByteReader reader(message.bytes);
  const unsigned type = reader.byte(2) & 7U;
  if (reader.isCutOff()) return Reading::damaged;
  std::optional<NasMmRegProc> procedure;
  if (type == 0 || type == 3) procedure = KNAS_MM_REG_PROC_ROUTING_AREA_UPDATE;
  if (type == 1 || type == 2) procedure = KNAS_MM_REG_PROC_COMBINED_RAU;
  addGprsRequest(procedure, message);
  return Reading::read;
}

Reading readGprsAccept(std::size_t areaAt, NasMessage& message) {
  constexpr std::uint8_t kIdentityElement = 0x18;
  constexpr std::size_t kAreaSize = 6;
  ByteReader reader(message.bytes);
  const std::uint8_t timer = reader.byte(3);
  const ByteSpan bytes = reader.part(areaAt, kAreaSize);
  const Elements elements(reader.rest(areaAt + kAreaSize), kGprsElements);
  if (reader.isCutOff()) return Reading::damaged;

  auto area = makeMessage<RoutingAreaId>();
  area->setEncodedPlmn(Data::copy(bytes.first(3)));
  area->setLac(bigEndian(bytes.subspan(3, 2)));
  area->setRac(bytes[5]);
  Gmm& gmm = message.sim.gmm;
  gmm.setUpdateStatus(GprsUpdateStatus::GPRS_STATUS_UPDATED);
  gmm.setRai(std::move(area));
  gmm.setRegProc(KNAS_MM_REG_PROC_PROC_NONE);
  gmm.setHasRejectCause(false);
  setOrRemove(gmm, &Gmm::setT3312DurS, &Gmm::setHasT3312DurS, gprsTimerSeconds(timer));
  if (const auto identity = elements.find(kIdentityElement))
    setWhenKnown(gmm, &Gmm::setPTmsi, temporaryIdentity(*identity));
  message.events.add(gmm);
  addEquivalentNetworks(elements, message.events);
  return Reading::read;
}

Reading readGprsAttachAccept(NasMessage& message) {
  return readGprsAccept(5, message);
}

Reading readRoutingAccept(NasMessage& message) {
  return readGprsAccept(4, message);
}

Reading readGprsReject(NasMessage& message) {
  using enum GprsUpdateStatus;
  Gmm& gmm = message.sim.gmm;
  if (!setReject<NasMmRejectCause>(message.bytes, forbidsRegistration, GPRS_STATUS_ROAMING_NOT_ALLOWED,
                                   GPRS_STATUS_NOT_UPDATED, gmm))
    return Reading::damaged;
  gmm.setRegProc(KNAS_MM_REG_PROC_PROC_NONE);
  message.events.add(gmm);
  return Reading::read;
}

constexpr unsigned kMm = 5;
constexpr unsigned kGmm = 8;

struct MmType {
  std::uint8_t protocol;
  std::uint8_t type;
  Reading (*read)(NasMessage& message);
};

constexpr MmType kMmTypes[] = {
    {kMm, 0x02, readLocationAccept},    {kMm, 0x04, readLocationReject}, {kGmm, 0x01, readGprsAttachRequest},
    {kGmm, 0x02, readGprsAttachAccept}, {kGmm, 0x04, readGprsReject},    {kGmm, 0x08, readRoutingRequest},
    {kGmm, 0x09, readRoutingAccept},    {kGmm, 0x0B, readGprsReject},
};

}  // namespace

Reading readMmState(const LogPacket& packet, SimState& sim, EventBatch& events) {
  return readState(packet, kMmStatuses, kMmUpdates, sim.mm, events);
}

Reading readGmmState(const LogPacket& packet, SimState& sim, EventBatch& events) {
  return readState(packet, kGmmStatuses, kGmmUpdates, sim.gmm, events);
}

Reading readNasMessage(const LogPacket& packet, SimState& sim, EventBatch& events) {
  // The upper two bits of an MM type count messages.
  constexpr unsigned kMmTypeBits = 0x3F;
  ByteReader body(packet.body);
  NasMessage message{body.part(5, body.get(w(1))), sim, events};
  if (body.isCutOff()) return Reading::damaged;
  if (message.bytes.size() < 2) return Reading::read;
  const unsigned protocol = message.bytes[0] & 15U;
  const unsigned type = message.bytes[1] & (protocol == kMm ? kMmTypeBits : 0xFFU);
  for (const MmType& row : kMmTypes) {
    if (row.protocol == protocol && row.type == type) return row.read(message);
  }
  return Reading::read;
}

}  // namespace vesk::diag
