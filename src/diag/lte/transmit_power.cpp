#include <optional>

#include "diag/layout/byte_reader.h"
#include "diag/lte/lte_logs.h"
#include "diag/translation/event_batch.h"

namespace vesk::diag {

namespace {

using namespace metrics;
using namespace notation;
using enum Proof;

/// The power in dBm is signed. A record without a carrier is of the primary one.
struct PowerLayout {
  std::uint8_t version;
  Proof proof;
  std::uint8_t recordSize;
  Field power;
  std::optional<Field> carrier;
};

// clang-format off
constexpr PowerLayout kPusch[] = {
    {43,  checked,    64, b(24, 0, 7), std::nullopt},
    {102, checked,    68, b(24, 0, 7), b(2, 0, 2)},
    {122, byTheBook,  68, b(24, 0, 7), b(2, 0, 2)},
    {124, checked,    84, b(24, 0, 7), b(2, 0, 2)},
    {144, byTheBook, 100, b(40, 0, 7), b(2, 0, 2)},
    {145, byTheBook, 100, b(40, 0, 7), b(2, 0, 2)},
};
constexpr PowerLayout kPucch[] = {
    {43,  checked,    36, b(23, 0, 7), std::nullopt},
    {101, byTheBook,  36, b(23, 0, 7), b(4, 0, 2)},
    {121, checked,    36, b(23, 0, 7), b(4, 0, 2)},
    {142, byTheBook,  52, b(23, 0, 7), b(4, 0, 2)},
};
// clang-format on
constexpr auto kPuschVersions = versionsOf(kPusch);
constexpr auto kPucchVersions = versionsOf(kPucch);
constexpr std::size_t kFirstPowerRecord = 8;
constexpr Field kPowerRecords = h(1, 9, 5);
constexpr Field kSubframeIndex = h(0);

struct ControlLayout {
  std::uint8_t version;
  Proof proof;
  Field frame, subframe;
  Field power;
  std::optional<Field> carrier;
};

// clang-format off
constexpr ControlLayout kPuschControl[] = {
    {25, checked,   w(0, 3, 10), w(0, 13, 4), w(8, 15, 8), w(0, 0, 3)},
    {5,  byTheBook, w(0, 0, 10), w(0, 10, 4), w(8, 15, 8), std::nullopt},
    {4,  byTheBook, w(0, 0, 10), w(0, 10, 4), w(8, 5, 8),  std::nullopt},
};
constexpr ControlLayout kPucchControl[] = {
    {4,  byTheBook, w(0, 0, 10), w(0, 10, 4), b(10),       std::nullopt},
    {24, byTheBook, w(0, 0, 10), w(0, 10, 4), b(10),       std::nullopt},
};
// clang-format on
constexpr auto kPuschControlVersions = versionsOf(kPuschControl);
constexpr auto kPucchControlVersions = versionsOf(kPucchControl);
constexpr std::size_t kFirstControlRecord = 4;
constexpr std::size_t kControlRecordSize = 12;

/// Which of the two powers of an entry is set.
using SetPower = void (TxPowerInfo::*)(std::int32_t);

bool isOfPrimaryCarrier(const std::optional<Field>& carrier, ByteReader& record) {
  return !carrier || record.get(*carrier) == 0;
}

void addEntry(KCellularLteTxPower& report, SetPower set, std::int32_t dbm, std::uint32_t subframeIndex) {
  auto entry = makeMessage<TxPowerInfo>();
  ((*entry).*set)(dbm);
  entry->setSubframeIndex(subframeIndex);
  report.addTxPowerInfo(std::move(entry));
}

void addReport(KCellularLteTxPower& report, EventBatch& events) {
  if (report.txPowerInfosCount() != 0) events.add(report);
}

template <std::size_t Count>
Reading readPower(const PowerLayout (&layouts)[Count], SetPower set, const LogPacket& packet, EventBatch& events) {
  const PowerLayout* layout = findLayout(layouts, packet.body[0]);
  if (layout == nullptr) return Reading::passedOver;

  ByteReader body(packet.body);
  const std::size_t count = body.get(kPowerRecords);
  if (body.isCutOff() || packet.body.size() != kFirstPowerRecord + count * layout->recordSize) return Reading::damaged;
  KCellularLteTxPower report;
  const auto readOne = [&](ByteReader record) {
    if (!isOfPrimaryCarrier(layout->carrier, record)) return;
    addEntry(report, set, record.getSigned(layout->power), record.get(kSubframeIndex));
  };
  if (!forEachRecord(packet.body, kFirstPowerRecord, count, layout->recordSize, readOne)) return Reading::damaged;
  addReport(report, events);
  return Reading::read;
}

template <std::size_t Count>
Reading readControl(const ControlLayout (&layouts)[Count], SetPower set, const LogPacket& packet, EventBatch& events) {
  const ControlLayout* layout = findLayout(layouts, packet.body[0]);
  if (layout == nullptr) return Reading::passedOver;

  ByteReader body(packet.body);
  const std::size_t count = body.byte(3);
  if (body.isCutOff()) return Reading::damaged;
  KCellularLteTxPower report;
  const auto readOne = [&](ByteReader record) {
    if (!isOfPrimaryCarrier(layout->carrier, record)) return;
    const std::uint32_t subframeIndex = record.get(layout->frame) * 10 + record.get(layout->subframe);
    addEntry(report, set, record.getSigned(layout->power), subframeIndex);
  };
  if (!forEachRecord(packet.body, kFirstControlRecord, count, kControlRecordSize, readOne)) return Reading::damaged;
  addReport(report, events);
  return Reading::read;
}

}  // namespace

Versions ltePuschPowerVersions() {
  return kPuschVersions;
}

Reading readLtePuschPower(const LogPacket& packet, SimState& /*sim*/, EventBatch& events) {
  return readPower(kPusch, &TxPowerInfo::setPuschTxPower, packet, events);
}

Versions ltePucchPowerVersions() {
  return kPucchVersions;
}

Reading readLtePucchPower(const LogPacket& packet, SimState& /*sim*/, EventBatch& events) {
  return readPower(kPucch, &TxPowerInfo::setPucchTxPower, packet, events);
}

Versions ltePuschPowerControlVersions() {
  return kPuschControlVersions;
}

Reading readLtePuschPowerControl(const LogPacket& packet, SimState& /*sim*/, EventBatch& events) {
  return readControl(kPuschControl, &TxPowerInfo::setPuschTxPower, packet, events);
}

Versions ltePucchPowerControlVersions() {
  return kPucchControlVersions;
}

Reading readLtePucchPowerControl(const LogPacket& packet, SimState& /*sim*/, EventBatch& events) {
  return readControl(kPucchControl, &TxPowerInfo::setPucchTxPower, packet, events);
}

}  // namespace vesk::diag
