#include <limits>
#include <optional>

#include "diag/layout/bit_reader.h"
#include "diag/layout/byte_reader.h"
#include "diag/layout/values.h"
#include "diag/lte/lte_logs.h"
#include "diag/lte/measurement_report.h"
#include "diag/modem_clock.h"
#include "diag/translation/event_batch.h"
#include "diag/translation/sim_state.h"

namespace vesk::diag {

namespace {

using namespace metrics;
using namespace notation;
using enum Proof;
using enum LteRrcState;
using enum LteRrcCause;

struct RrcLayout {
  std::uint8_t version;
  Proof proof;
  Field pci;
  /// Which channel the message went over.
  Field channel;
  Field length;
  /// The number of DL-CCCH.
  std::uint8_t firstChannel;
  std::uint8_t message;
  /// Which part of a message this is.
  std::optional<Field> segment = {};
};

// clang-format off
constexpr RrcLayout kRrcLayouts[] = {
    //              PCI   channel length  DL-CCCH message
    {2,  byTheBook, h(4), b(10),  h(11),   5,     13},
    {3,  byTheBook, h(4), b(10),  h(11),   5,     13},
    {4,  byTheBook, h(4), b(10),  h(11),   5,     13},
    {6,  byTheBook, h(4), b(10),  h(15),   5,     17},
    {7,  byTheBook, h(4), b(10),  h(15),   5,     17},
    {8,  checked,   h(4), b(12),  h(17),   5,     19},
    {9,  checked,   h(4), b(12),  h(17),  12,     19},
    {12, byTheBook, h(4), b(12),  h(17),  12,     19},
    {13, byTheBook, h(4), b(12),  h(17),   5,     19},
    {14, byTheBook, h(4), b(12),  h(17),   6,     19},
    {15, checked,   h(4), b(12),  h(17),   6,     19},
    {16, byTheBook, h(4), b(12),  h(17),   6,     19},
    {19, byTheBook, h(4), b(12),  h(17),   8,     19},
    {20, checked,   h(4), b(12),  h(17),   6,     19},
    {22, byTheBook, h(4), b(12),  h(17),   5,     19},
    {24, byTheBook, h(4), b(12),  h(17),   6,     19},
    {25, byTheBook, h(6), b(14),  h(19),   6,     21},
    {26, checked,   h(6), b(14),  h(19),   8,     21},
    {27, byTheBook, h(6), b(14),  h(19),   8,     21},
    {29, byTheBook, h(6), b(14),  h(19),   8,     21},
    {30, byTheBook, h(6), b(14),  h(19),   8,     24, b(23)},
    {31, byTheBook, h(6), b(14),  h(19),   8,     24, b(23)},
};
// clang-format on
constexpr auto kRrcVersions = versionsOf(kRrcLayouts);

/// A message of one of the channels, and what it may change.
struct RrcMessage {
  BitReader bits;
  std::uint32_t pci;
  std::uint64_t milliseconds;
  RrcConnection& connection;
  EventBatch& events;
};

/// How long the state before lasted; none when the clock was set meanwhile or the time cannot be told.
std::optional<std::uint32_t> durationMs(std::uint64_t from, std::uint64_t to) {
  const bool wasClockSet = isBeforeClockIsSet(from) != isBeforeClockIsSet(to);
  if (wasClockSet || to < from || to - from > std::numeric_limits<std::uint32_t>::max()) return std::nullopt;
  return static_cast<std::uint32_t>(to - from);
}

/// A state that lasts is told once, except a connection, which may have been made anew.
void enter(LteRrcState state, std::optional<LteRrcCause> cause, RrcMessage& message) {
  auto& last = message.connection.last;
  if (last && last->state == state && state != KLTE_RRC_STATE_CONNECTED) return;
  KCellularLteRrcState event;
  event.setState(state);
  if (last) {
    event.setPrevState(last->state);
    setWhenKnown(event, &KCellularLteRrcState::setPrevStateDurMs, durationMs(last->sinceMs, message.milliseconds));
  }
  setWhenKnown(event, &KCellularLteRrcState::setCause, cause);
  message.events.add(event);
  last = {state, message.milliseconds};
}

/// The cause `code` places after `first`; none for one of the spare codes behind the last cause.
std::optional<LteRrcCause> causeFrom(LteRrcCause first, std::uint32_t code, LteRrcCause last) {
  const auto cause = static_cast<LteRrcCause>(static_cast<std::int32_t>(first) + static_cast<std::int32_t>(code));
  if (cause > last) return std::nullopt;
  return cause;
}

Reading readDownlinkCommon(RrcMessage& message) {
  constexpr std::uint32_t kReestablishmentReject = 1;
  constexpr std::uint32_t kReject = 2;
  const std::uint32_t type = message.bits.at(1, 2);
  if (message.bits.isCutOff()) return Reading::damaged;
  if (type == kReestablishmentReject) {
    enter(KLTE_RRC_STATE_IDLE, KLTE_RRC_CAUSE_REL_CONN_FAIL_REEST_REJ, message);
  } else if (type == kReject) {
    enter(KLTE_RRC_STATE_IDLE, KLTE_RRC_CAUSE_EST_FAIL_REJ, message);
  }
  return Reading::read;
}

Reading readDownlinkDedicated(RrcMessage& message) {
  constexpr std::uint32_t kMobilityCommand = 3;
  constexpr std::uint32_t kRelease = 5;
  BitReader& bits = message.bits;
  const std::uint32_t type = bits.at(1, 4);
  std::optional<LteRrcCause> cause;
  if (type == kRelease && bits.at(7, 3) == 0)
    cause = causeFrom(KLTE_RRC_CAUSE_REL_LOAD_BAL_TAU_REQD, bits.at(13, 2), KLTE_RRC_CAUSE_REL_CSFB_HIGH_PRIO);
  if (bits.isCutOff()) return Reading::damaged;
  if (type == kMobilityCommand) enter(KLTE_RRC_STATE_ATMPT_OUTBND_MOBILITY, std::nullopt, message);
  if (type == kRelease) enter(KLTE_RRC_STATE_IDLE, cause, message);
  return Reading::read;
}

/// A connection is asked for, or asked for again after a failure.
Reading readUplinkCommon(RrcMessage& message) {
  BitReader& bits = message.bits;
  const bool isFirstRequest = bits.at(1, 1) != 0;
  std::optional<LteRrcCause> cause;
  if (bits.at(2, 1) == 0) {
    cause = isFirstRequest
                ? causeFrom(KLTE_RRC_CAUSE_EST_EMERGENCY, bits.at(44, 3), KLTE_RRC_CAUSE_EST_DELAY_TOL_ACC)
                : causeFrom(KLTE_RRC_CAUSE_REEST_RECFG_FAIL, bits.at(44, 2), KLTE_RRC_CAUSE_REEST_OTHER_FAIL);
  }
  if (bits.isCutOff()) return Reading::damaged;
  message.connection.requestCause = cause;
  enter(KLTE_RRC_STATE_ATMPT_CONNECTION, cause, message);
  return Reading::read;
}

Reading readUplinkDedicated(RrcMessage& message) {
  constexpr std::uint32_t kMeasurementReport = 1;
  constexpr std::uint32_t kReestablishmentComplete = 3;
  constexpr std::uint32_t kSetupComplete = 4;
  const std::uint32_t type = message.bits.at(1, 4);
  const bool isKnownReport = type == kMeasurementReport && message.bits.at(5, 4) == 0;
  if (message.bits.isCutOff()) return Reading::damaged;
  if (isKnownReport) return readMeasurementReport(message.bits, message.pci, message.events);
  if (type == kReestablishmentComplete || type == kSetupComplete)
    enter(KLTE_RRC_STATE_CONNECTED, message.connection.requestCause, message);
  return Reading::read;
}

/// DL-CCCH, DL-DCCH, UL-CCCH and UL-DCCH, as they are numbered one after the other.
constexpr Reading (*kReadChannel[])(RrcMessage&) = {
    readDownlinkCommon,
    readDownlinkDedicated,
    readUplinkCommon,
    readUplinkDedicated,
};

}  // namespace

Versions lteRrcMessageVersions() {
  return kRrcVersions;
}

Reading readLteRrcMessage(const LogPacket& packet, SimState& sim, EventBatch& events) {
  const RrcLayout* layout = findLayout(kRrcLayouts, packet.body[0]);
  if (layout == nullptr) return Reading::passedOver;

  ByteReader body(packet.body);
  const std::uint32_t channel = body.get(layout->channel);
  const std::uint32_t segment = layout->segment ? body.get(*layout->segment) : 0;
  const std::uint32_t pci = body.get(layout->pci);
  const ByteSpan bytes = body.part(layout->message, body.get(layout->length));
  if (body.isCutOff()) return Reading::damaged;
  if (segment != 0) return Reading::passedOver;
  // Broadcast and paging tell nothing here.
  const std::uint32_t index = channel - layout->firstChannel;
  if (channel < layout->firstChannel || index >= std::size(kReadChannel)) return Reading::read;

  RrcMessage message{BitReader(bytes), pci, packet.milliseconds, sim.rrc, events};
  const bool isExtension = message.bits.at(0, 1) != 0;
  if (message.bits.isCutOff()) return Reading::damaged;
  return isExtension ? Reading::read : kReadChannel[index](message);
}

}  // namespace vesk::diag
