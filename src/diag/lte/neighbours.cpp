#include "diag/layout/byte_reader.h"
#include "diag/layout/lte_bands.h"
#include "diag/layout/values.h"
#include "diag/lte/lte_logs.h"
#include "diag/lte/neighbour_entry.h"
#include "diag/lte/subpackets.h"
#include "diag/translation/event_batch.h"

namespace vesk::diag {

namespace {

using namespace metrics;
using namespace notation;
using enum Proof;

struct NeighbourLayout {
  std::uint8_t version;
  Proof proof;
  Field earfcn;
  Field count;
  std::uint8_t firstCell;
  std::uint8_t cellSize;
  /// Of a cell.
  Field pci, rsrp, rsrq;
};

// clang-format off
//                                    EARFCN number       cells    PCI            RSRP            RSRQ
constexpr NeighbourLayout kFiltered[] = {
    {4, checked,                      w(8),  b(24),       28, 12,  h(0),          h(2),           h(6)},
    {3, byTheBook,                    h(8),  b(22),       24, 12,  h(0),          h(2),           h(6)},
};
constexpr NeighbourLayout kIdle[] = {
    {5, sample,                       w(4),  w(8, 6, 26), 12, 32,  w(0, 0, 9),    w(0, 20, 12),   w(8, 12, 10)},
    {4, sample,                       h(4),  h(6, 6, 10),  8, 32,  w(0, 0, 9),    w(0, 20, 12),   w(8, 12, 10)},
};
// Of subpackets; those that ask for the measurements have other numbers.
constexpr std::uint8_t kConnectedSubpacket = 31;
constexpr NeighbourLayout kConnectedMeasured[] = {
    {4, checked,                      w(0),  h(4, 0, 6),   8, 52,  w(0, 0, 10),   w(12, 0, 12),   w(20, 10, 10)},
    {3, byTheBook,                    h(0),  h(2, 0, 6),   4, 52,  w(0, 0, 10),   w(12, 0, 12),   w(20, 10, 10)},
};
constexpr std::uint8_t kIdleSubpacket = 27;
constexpr NeighbourLayout kIdleMeasured[] = {
    {4, byTheBook,                    w(0),  h(4, 0, 6),   8, 52,  w(0, 0, 10),   w(12, 0, 12),   w(20, 10, 10)},
    {2, byTheBook,                    h(0),  h(2, 0, 6),   4, 52,  w(0, 0, 10),   w(12, 0, 12),   w(20, 10, 10)},
};
// clang-format on

constexpr auto kFilteredVersions = versionsOf(kFiltered);
constexpr auto kIdleVersions = versionsOf(kIdle);
constexpr auto kConnectedMeasuredVersions = subpacketVersionsOf(kConnectedSubpacket, kConnectedMeasured);
constexpr auto kIdleMeasuredVersions = subpacketVersionsOf(kIdleSubpacket, kIdleMeasured);

/// False when the list is cut off.
bool addCells(const NeighbourLayout& layout, ByteSpan bytes, KCellularLteNbrEutraCellMeas& report) {
  ByteReader header(bytes);
  const std::uint32_t earfcn = header.get(layout.earfcn);
  const std::uint32_t count = header.get(layout.count);
  if (header.isCutOff()) return false;
  return forEachRecord(bytes, layout.firstCell, count, layout.cellSize, [&](ByteReader cell) {
    addLteNeighbour(report, earfcn, cell.get(layout.pci), cell.get(layout.rsrp), cell.get(layout.rsrq));
  });
}

void addReport(KCellularLteNbrEutraCellMeas& report, EventBatch& events) {
  if (report.measNbrEutrasCount() != 0) events.add(report);
}

template <std::size_t Count>
Reading readList(const NeighbourLayout (&layouts)[Count], const LogPacket& packet, EventBatch& events) {
  const NeighbourLayout* layout = findLayout(layouts, packet.body[0]);
  if (layout == nullptr) return Reading::passedOver;
  KCellularLteNbrEutraCellMeas report;
  if (!addCells(*layout, packet.body, report)) return Reading::damaged;
  addReport(report, events);
  return Reading::read;
}

/// The cells of all subpackets make one report.
template <std::size_t Count>
Reading readMeasured(std::uint8_t id, const NeighbourLayout (&layouts)[Count], const LogPacket& packet,
                     EventBatch& events) {
  KCellularLteNbrEutraCellMeas report;
  const Reading reading = readSubpackets(packet, [&](const Subpacket& subpacket) {
    const NeighbourLayout* layout = subpacket.id == id ? findLayout(layouts, subpacket.version) : nullptr;
    if (layout == nullptr) return Reading::passedOver;
    return addCells(*layout, subpacket.content, report) ? Reading::read : Reading::damaged;
  });
  addReport(report, events);
  return reading;
}

}  // namespace

void addLteNeighbour(KCellularLteNbrEutraCellMeas& report, std::uint32_t earfcn, std::uint32_t pci,
                     std::uint32_t rawRsrp, std::uint32_t rawRsrq) {
  const auto rsrp = neighbourRsrp(rawRsrp);
  if (!rsrp) return;
  auto neighbour = makeMessage<EgwErrcNbrEutraMeas>();
  neighbour->setNbrEarfcn(earfcn);
  neighbour->setNbrPhysCellId(pci);
  setWhenKnown(*neighbour, &EgwErrcNbrEutraMeas::setFreqBandInd, lteBandOf(earfcn));
  neighbour->setNbrRsrp(*rsrp);
  setWhenKnown(*neighbour, &EgwErrcNbrEutraMeas::setNbrRsrq, neighbourRsrq(rawRsrq));
  report.addMeasNbrEutra(std::move(neighbour));
}

Versions lteFilteredNeighbourVersions() {
  return kFilteredVersions;
}

Reading readLteFilteredNeighbours(const LogPacket& packet, SimState& /*sim*/, EventBatch& events) {
  return readList(kFiltered, packet, events);
}

Versions lteIdleNeighbourVersions() {
  return kIdleVersions;
}

Reading readLteIdleNeighbours(const LogPacket& packet, SimState& /*sim*/, EventBatch& events) {
  return readList(kIdle, packet, events);
}

Versions lteMeasuredNeighbourVersions() {
  return kConnectedMeasuredVersions;
}

Reading readLteMeasuredNeighbours(const LogPacket& packet, SimState& /*sim*/, EventBatch& events) {
  return readMeasured(kConnectedSubpacket, kConnectedMeasured, packet, events);
}

Versions lteIdleMeasuredNeighbourVersions() {
  return kIdleMeasuredVersions;
}

Reading readLteIdleMeasuredNeighbours(const LogPacket& packet, SimState& /*sim*/, EventBatch& events) {
  return readMeasured(kIdleSubpacket, kIdleMeasured, packet, events);
}

}  // namespace vesk::diag
