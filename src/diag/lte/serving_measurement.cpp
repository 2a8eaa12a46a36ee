#include <algorithm>
#include <array>
#include <optional>

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

/// Of the first two receive chains.
using ChainFields = std::array<Field, 2>;

/// Where the levels of a cell stand: of each chain, and of all together.
struct LevelFields {
  ChainFields rsrp;
  Field rsrpOfAll;
  /// What the RSRP of all is logged too low by.
  std::uint32_t rsrpOfAllOffset;
  ChainFields rsrq;
  Field rsrqOfAll;
  Field rssiOfAll;
};

struct MeasurementLayout {
  std::uint8_t version;
  Proof proof;
  std::uint8_t firstCell;
  std::uint8_t cellSize;
  /// Bytes of a cell before those that its fields count from.
  std::uint8_t lead;
  /// Absent: only the first cell's layout is known.
  std::optional<Field> count;
  Field isServing;
  const LevelFields* levels;
  std::optional<ChainFields> snr;
};

// clang-format off
//                           RSRP of 0, 1                      all                +    RSRQ of 0, 1                   all            RSSI of all
constexpr LevelFields kLevels18{
                             {w(16, 10, 12), w(20, 12, 12)},   w(24, 12, 12),     0,   {w(28, 12, 10), w(32, 0, 10)}, w(32, 20, 10), w(40, 0, 11)};
constexpr LevelFields kLevels35{
                             {w(16, 10, 12), w(20, 12, 12)},   w(28, 12, 12),   640,   {w(36, 0, 10), w(36, 20, 10)}, w(44, 0, 10),  w(56, 0, 11)};
constexpr LevelFields kLevels40{
                             {w(16, 10, 12), w(20, 12, 12)},   w(32, 12, 12),   640,   {w(40, 0, 10), w(40, 20, 10)}, w(48, 0, 10),  w(60, 0, 11)};

constexpr std::uint8_t kSubpacket = 25;
constexpr MeasurementLayout kMeasurementLayouts[] = {
    //              cells: from, size, lead, number  serving                      SNR of 0, 1
    {18, checked,    4,  68, 0, std::nullopt,        h(0, 12, 1), &kLevels18,    {{w(64, 0, 9), w(64, 9, 9)}}},
    {19, checked,    8,  68, 0, std::nullopt,        h(0, 12, 1), &kLevels18,    {{w(64, 0, 9), w(64, 9, 9)}}},
    {35, byTheBook,  8,  84, 0, std::nullopt,        h(0, 12, 1), &kLevels35,  {{w(80, 0, 9), w(80, 9, 9)}}},
    {36, checked,    8, 128, 0, h(4),                h(0, 12, 1), &kLevels35,  {{w(80, 0, 9), w(80, 9, 9)}}},
    {40, byTheBook,  8,  88, 0, std::nullopt,        h(0, 12, 1), &kLevels40,   {{w(84, 0, 9), w(84, 9, 9)}}},
    {48, sample,    12, 140, 0, h(4),                h(0, 12, 1), &kLevels40,   {{w(92, 0, 9), w(92, 9, 9)}}},
    {60, sample,     8, 148, 8, h(4),                h(0, 15, 1), &kLevels40,   std::nullopt},
};
// clang-format on
constexpr auto kMeasurementVersions = subpacketVersionsOf(kSubpacket, kMeasurementLayouts);
constexpr Field kPci = h(0, 0, 9);
constexpr Field kServingIndex = h(0, 9, 3);

/// A cell with its raw levels, 0 for none.
struct Cell {
  std::uint32_t earfcn;
  std::uint32_t pci;
  std::uint32_t servingIndex;
  bool isServing;
  std::array<std::uint32_t, 2> rsrp, rsrq, snr;
  std::uint32_t rsrpOfAll, rsrqOfAll, rssiOfAll;
};

Cell readCell(const MeasurementLayout& layout, std::uint32_t earfcn, ByteReader cell) {
  ByteReader bytes(cell.rest(layout.lead));
  const LevelFields& levels = *layout.levels;
  const auto both = [&bytes](const ChainFields& fields) {
    return std::array<std::uint32_t, 2>{bytes.get(fields[0]), bytes.get(fields[1])};
  };
  return {.earfcn = earfcn,
          .pci = bytes.get(kPci),
          .servingIndex = bytes.get(kServingIndex),
          .isServing = bytes.get(layout.isServing) != 0,
          .rsrp = both(levels.rsrp),
          .rsrq = both(levels.rsrq),
          .snr = layout.snr ? both(*layout.snr) : std::array<std::uint32_t, 2>{},
          .rsrpOfAll = bytes.get(levels.rsrpOfAll) + levels.rsrpOfAllOffset,
          .rsrqOfAll = bytes.get(levels.rsrqOfAll),
          .rssiOfAll = bytes.get(levels.rssiOfAll)};
}

/// All chains together hear what the better one of the first two does, even where a third hears more. A cell of which
/// that is not true is not laid out as its version claims.
bool isPlausible(const Cell& cell) {
  return cell.rsrpOfAll == std::max(cell.rsrp[0], cell.rsrp[1]);
}

void addSample(std::shared_ptr<RsrpRsrqSinr> values, EventBatch& events) {
  KCellularLteRsrpRsrqSinr report;
  report.setNumSamples(1);
  report.addInstValues(std::move(values));
  events.add(report);
}

void addPrimaryCell(const Cell& cell, EventBatch& events) {
  auto values = makeMessage<RsrpRsrqSinr>();
  values->setPhyCellId(cell.pci);
  if (const auto rsrp = rsrpDbm(cell.rsrp[0])) {
    values->setRsrp0(*rsrp);
    setWhenKnown(*values, &RsrpRsrqSinr::setRsrq0, rsrqDb(cell.rsrq[0]));
    setWhenKnown(*values, &RsrpRsrqSinr::setSinr0, sinrHalfDb(cell.snr[0]));
  }
  if (const auto rsrp = rsrpDbm(cell.rsrp[1])) {
    values->setRsrp1(*rsrp);
    setWhenKnown(*values, &RsrpRsrqSinr::setRsrq1, rsrqDb(cell.rsrq[1]));
    setWhenKnown(*values, &RsrpRsrqSinr::setSinr1, sinrHalfDb(cell.snr[1]));
  }
  addSample(std::move(values), events);
}

void addSecondaryCell(const Cell& cell, EventBatch& events) {
  using Carrier = SecondaryComponentCarrier;
  auto carrier = makeMessage<Carrier>();
  carrier->setIndex(cell.servingIndex);
  carrier->setPci(cell.pci);
  carrier->setDlEarfcn(cell.earfcn);
  setWhenKnown(*carrier, &Carrier::setDlRfBand, lteBandOf(cell.earfcn));
  setWhenKnown(*carrier, &Carrier::setRsrp, hundredthsOfDb(cell.rsrpOfAll, kRsrpBaseDbm));
  setWhenKnown(*carrier, &Carrier::setRsrq, hundredthsOfDb(cell.rsrqOfAll, kRsrqBaseDb));
  setWhenKnown(*carrier, &Carrier::setRssi, hundredthsOfDb(cell.rssiOfAll, kRssiBaseDbm));
  const std::uint32_t snr = std::max(cell.rsrp[0] != 0 ? cell.snr[0] : 0, cell.rsrp[1] != 0 ? cell.snr[1] : 0);
  setWhenKnown(*carrier, &Carrier::setSnr, snrDb(snr));

  KCellularLteCarrierAggregationStatus status;
  status.addSccList(std::move(carrier));
  events.add(status);
}

Reading readCells(const Subpacket& subpacket, EventBatch& events) {
  const MeasurementLayout* layout =
      subpacket.id == kSubpacket ? findLayout(kMeasurementLayouts, subpacket.version) : nullptr;
  if (layout == nullptr) return Reading::passedOver;

  ByteReader header(subpacket.content);
  const std::uint32_t earfcn = header.get(w(0));
  const std::uint32_t count = layout->count ? header.get(*layout->count) : 1;
  if (header.isCutOff()) return Reading::damaged;

  KCellularLteNbrEutraCellMeas neighbours;
  const auto readOne = [&](ByteReader bytes) {
    const Cell cell = readCell(*layout, earfcn, bytes);
    if (!isPlausible(cell)) return;
    if (!cell.isServing) {
      addLteNeighbour(neighbours, earfcn, cell.pci, cell.rsrpOfAll, cell.rsrqOfAll);
    } else if (cell.servingIndex == 0) {
      addPrimaryCell(cell, events);
    } else {
      addSecondaryCell(cell, events);
    }
  };
  if (!forEachRecord(subpacket.content, layout->firstCell, count, layout->cellSize, readOne)) return Reading::damaged;
  if (neighbours.measNbrEutrasCount() != 0) events.add(neighbours);
  return Reading::read;
}

struct IdleMeasurementLayout {
  std::uint8_t version;
  Proof proof;
  Field pci, rsrp, rsrq;
};

// clang-format off
constexpr IdleMeasurementLayout kIdleMeasurementLayouts[] = {
    //           PCI         RSRP          RSRQ
    {4, sample,  h(6, 0, 9), w(8, 0, 12),  w(16, 0, 10)},
    {5, checked, h(8, 0, 9), w(12, 0, 12), w(20, 0, 10)},
};
// clang-format on
constexpr auto kIdleMeasurementVersions = versionsOf(kIdleMeasurementLayouts);

}  // namespace

Versions lteServingMeasurementVersions() {
  return kMeasurementVersions;
}

Reading readLteServingMeasurement(const LogPacket& packet, SimState& /*sim*/, EventBatch& events) {
  return readSubpackets(packet, [&events](const Subpacket& subpacket) { return readCells(subpacket, events); });
}

Versions lteIdleServingMeasurementVersions() {
  return kIdleMeasurementVersions;
}

Reading readLteIdleServingMeasurement(const LogPacket& packet, SimState& /*sim*/, EventBatch& events) {
  const IdleMeasurementLayout* layout = findLayout(kIdleMeasurementLayouts, packet.body[0]);
  if (layout == nullptr) return Reading::passedOver;

  ByteReader body(packet.body);
  const std::uint32_t pci = body.get(layout->pci);
  const auto rsrp = rsrpDbm(body.get(layout->rsrp));
  const auto rsrq = rsrqDb(body.get(layout->rsrq));
  if (body.isCutOff()) return Reading::damaged;
  if (!rsrp) return Reading::read;
  auto values = makeMessage<RsrpRsrqSinr>();
  values->setPhyCellId(pci);
  values->setRsrp0(*rsrp);
  setWhenKnown(*values, &RsrpRsrqSinr::setRsrq0, rsrq);
  addSample(std::move(values), events);
  return Reading::read;
}

}  // namespace vesk::diag
