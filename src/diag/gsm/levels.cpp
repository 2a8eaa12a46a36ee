#include <algorithm>

#include "diag/gsm/gsm_logs.h"
#include "diag/layout/byte_reader.h"
#include "diag/layout/values.h"
#include "diag/translation/event_batch.h"

namespace vesk::diag {

namespace {

using namespace metrics;
using namespace notation;
using Report = KCellularGsmGrrEventMeasCr;

/// Of a cell and of an entry of a list of cells.
constexpr Field kArfcn = h(0, 0, 12);
/// In 1/16 dBm.
constexpr Field kLevel = h(2);
/// In dBm + 110.
constexpr Field kLevelCode = b(5);
constexpr std::uint32_t kHighestLevelCode = 63;

GsmNcellMeas& addNeighbour(Report& report, std::uint32_t arfcn) {
  auto cell = makeMessage<GsmNcellMeas>();
  cell->setArfcn(arfcn);
  report.addGsmNcellMeas(cell);
  return *cell;
}

void addReport(Report& report, EventBatch& events) {
  if (report.gsmNcellMeasCount() != 0) events.add(report);
}

void addServingLevel(std::int32_t dbm, std::optional<std::uint32_t> arfcn, EventBatch& events) {
  KCellularGsmIdleScellMeasurement level;
  setWhenKnown(level, &KCellularGsmIdleScellMeasurement::setScellArfcn, arfcn);
  level.setIdleRxlevDBm(dbm);
  events.add(level);
}

}  // namespace

Reading readGsmServingLevel(const LogPacket& packet, SimState& /*sim*/, EventBatch& events) {
  ByteReader body(packet.body);
  const std::int32_t level = body.getSigned(h(0));
  if (body.isCutOff()) return Reading::damaged;
  if (level != 0) addServingLevel(dbmOf(level), std::nullopt, events);
  return Reading::read;
}

Reading readGsmNeighbourLevels(const LogPacket& packet, SimState& /*sim*/, EventBatch& events) {
  ByteReader body(packet.body);
  const std::size_t count = body.byte(0);
  Report report;
  const auto readOne = [&report](ByteReader cell) {
    const std::int32_t level = cell.getSigned(kLevel);
    if (level != 0) addNeighbour(report, cell.get(kArfcn)).setRxlev(rxlevOf(dbmOf(level)));
  };
  if (body.isCutOff() || !forEachRecord(packet.body, 1, count, 4, readOne)) return Reading::damaged;
  addReport(report, events);
  return Reading::read;
}

Reading readGsmNeighbourList(const LogPacket& packet, SimState& /*sim*/, EventBatch& events) {
  constexpr std::int32_t kNotYetMeasured = -1760;
  ByteReader body(packet.body);
  const std::size_t count = body.byte(0);
  Report report;
  const auto readOne = [&report](ByteReader cell) {
    GsmNcellMeas& neighbour = addNeighbour(report, cell.get(kArfcn));
    const bool isBsicKnown = cell.byte(4) == 1;
    if (isBsicKnown) neighbour.setBsic(cell.byte(5) & 63U);
    const std::int32_t level = cell.getSigned(kLevel);
    if (level != 0 && level != kNotYetMeasured) neighbour.setRxlev(rxlevOf(dbmOf(level)));
  };
  if (body.isCutOff() || !forEachRecord(packet.body, 1, count, 12, readOne)) return Reading::damaged;
  addReport(report, events);
  return Reading::read;
}

Reading readGsmReselection(const LogPacket& packet, SimState& /*sim*/, EventBatch& events) {
  ByteReader body(packet.body);
  const std::uint32_t arfcn = body.get(kArfcn);
  const auto level = static_cast<std::int32_t>(body.get(kLevelCode));
  const std::size_t count = body.byte(25);
  Report report;
  const auto readOne = [&report](ByteReader cell) {
    addNeighbour(report, cell.get(kArfcn)).setRxlev(std::min(cell.get(kLevelCode), kHighestLevelCode));
  };
  if (body.isCutOff() || !forEachRecord(packet.body, 26, count, 25, readOne)) return Reading::damaged;
  addServingLevel(level - 110, arfcn, events);
  addReport(report, events);
  return Reading::read;
}

}  // namespace vesk::diag
