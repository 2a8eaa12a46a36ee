#include "diag/lte/measurement_report.h"

#include <optional>

#include "diag/layout/values.h"
#include "diag/translation/event_batch.h"

namespace vesk::diag {

namespace {

using namespace metrics;

constexpr std::size_t kNeighbours = 30;

/// What follows the identity of a cell: whether an extension follows, which ends the list, and the levels.
struct Levels {
  bool isLast;
  std::optional<std::uint32_t> level;
  std::optional<std::uint32_t> quality;
};

/// Of an LTE or UMTS cell, each level when it is there.
Levels readLevels(BitReader& bits) {
  Levels levels{.isLast = bits.nextFlag(), .level = {}, .quality = {}};
  const bool hasLevel = bits.nextFlag();
  const bool hasQuality = bits.nextFlag();
  if (hasLevel) levels.level = bits.next(7);
  if (hasQuality) levels.quality = bits.next(6);
  return levels;
}

std::optional<std::int32_t> asSigned(const std::optional<std::uint32_t>& code) {
  if (!code) return std::nullopt;
  return static_cast<std::int32_t>(*code);
}

/// Each reads one cell and adds it, and says whether another may follow. A cell that is cut off, or whose global
/// identity stands before its levels, is not added and ends the list.
bool readEutraCell(BitReader& bits, KCellularLteNbrEutraCellMeas& report) {
  const bool hasGlobalIdentity = bits.nextFlag();
  const std::uint32_t pci = bits.next(9);
  const Levels levels = readLevels(bits);
  if (hasGlobalIdentity || bits.isCutOff()) return false;

  auto cell = makeMessage<EgwErrcNbrEutraMeas>();
  cell->setNbrPhysCellId(pci);
  setWhenKnown(*cell, &EgwErrcNbrEutraMeas::setNbrRsrp, asSigned(levels.level));
  setWhenKnown(*cell, &EgwErrcNbrEutraMeas::setNbrRsrq, asSigned(levels.quality));
  report.addMeasNbrEutra(std::move(cell));
  return !levels.isLast;
}

bool readUtraCell(BitReader& bits, KCellularLteNbrInterRatCellMeas& report) {
  constexpr std::int32_t kLeastRscp = -5;
  const bool hasGlobalIdentity = bits.nextFlag();
  const bool isTdd = bits.nextFlag();
  const std::uint32_t code = bits.next(isTdd ? 7 : 9);
  const Levels levels = readLevels(bits);
  if (hasGlobalIdentity || bits.isCutOff()) return false;

  auto cell = makeMessage<EgwErrcNbrUtraMeas>();
  if (!isTdd) cell->setPsc(code);
  if (levels.level) cell->setRscp(static_cast<std::int32_t>(*levels.level) + kLeastRscp);
  setWhenKnown(*cell, &EgwErrcNbrUtraMeas::setEcno, levels.quality);
  report.addMeasNbrUtra(std::move(cell));
  return !levels.isLast;
}

bool readGeranCell(BitReader& bits, KCellularLteNbrInterRatCellMeas& report) {
  const bool hasGlobalIdentity = bits.nextFlag();
  const std::uint32_t arfcn = bits.next(10);
  bits.skip(1);  // which of two bands share the number
  const std::uint32_t bsic = bits.next(6);
  const bool isLast = bits.nextFlag();
  const std::uint32_t level = bits.next(6);
  if (hasGlobalIdentity || bits.isCutOff()) return false;

  auto cell = makeMessage<EgwErrcNbrGeranMeas>();
  cell->setArfcn(arfcn);
  cell->setBsic(bsic);
  cell->setRxlev(level);
  report.addMeasNbrGeran(std::move(cell));
  return !isLast;
}

/// The end of the message ends the list, too.
void addNeighbours(BitReader& bits, EventBatch& events) {
  enum Kind : std::uint32_t { eutra, utra, geran };
  const bool isOfLaterRelease = bits.nextFlag();
  const std::uint32_t kind = bits.next(2);
  const std::uint32_t mostCells = bits.next(3) + 1;
  if (isOfLaterRelease) return;

  KCellularLteNbrEutraCellMeas ownCells;
  KCellularLteNbrInterRatCellMeas otherCells;
  bool mayFollow = true;
  for (std::uint32_t index = 0; mayFollow && index < mostCells; ++index) {
    mayFollow = kind == eutra   ? readEutraCell(bits, ownCells)
                : kind == utra  ? readUtraCell(bits, otherCells)
                : kind == geran ? readGeranCell(bits, otherCells)
                                : false;
  }
  if (ownCells.measNbrEutrasCount() != 0) events.add(ownCells);
  if (otherCells.measNbrUtrasCount() + otherCells.measNbrGeransCount() != 0) events.add(otherCells);
}

}  // namespace

Reading readMeasurementReport(BitReader message, std::uint32_t servingPci, EventBatch& events) {
  const bool hasNeighbours = message.at(11, 1) != 0;
  const auto rsrpCode = static_cast<std::int32_t>(message.at(17, 7));
  const auto rsrqCode = static_cast<std::int32_t>(message.at(24, 6));
  if (message.isCutOff()) return Reading::damaged;

  auto values = makeMessage<RsrpRsrqSinr>();
  values->setPhyCellId(servingPci);
  values->setRsrp0(rsrpCode - 140);
  values->setRsrq0((rsrqCode - 39) >> 1);
  KCellularLteRsrpRsrqSinr report;
  report.setNumSamples(1);
  report.addInstValues(std::move(values));
  events.add(report);

  if (hasNeighbours) {
    message.seek(kNeighbours);
    addNeighbours(message, events);
  }
  return Reading::read;
}

}  // namespace vesk::diag
