#include <algorithm>

#include "diag/layout/byte_reader.h"
#include "diag/layout/values.h"
#include "diag/translation/event_batch.h"
#include "diag/umts/umts_logs.h"

namespace vesk::diag {

namespace {

using namespace metrics;
using namespace notation;
using enum Proof;
using enum WcdmaRrcConnState;

constexpr WcdmaRrcConnState kStates[] = {
    KWCDMA_RRC_CONN_STATE_IDLE,     KWCDMA_RRC_CONN_STATE_ESTABLISH, KWCDMA_RRC_CONN_STATE_CELL_FACH,
    KWCDMA_RRC_CONN_STATE_CELL_DCH, KWCDMA_RRC_CONN_STATE_CELL_PCH,  KWCDMA_RRC_CONN_STATE_URA_PCH,
};

/// From six digits, a byte each, of which the last is missing in a network code of two.
void setNetwork(KCellularWcdmaCellInfo& info, ByteSpan digits) {
  constexpr std::uint8_t kNoDigit = 15;
  const auto isDigit = [](std::uint8_t byte) { return byte <= 9; };
  const std::uint8_t last = digits[5];
  if (!std::ranges::all_of(digits.first(5), isDigit) || last > kNoDigit) return;
  info.setMcc(100U * digits[0] + 10U * digits[1] + digits[2]);
  const std::uint32_t twoDigits = 10U * digits[3] + digits[4];
  if (last == kNoDigit) {
    info.setMnc(twoDigits);
    info.setNumMncDigits(2);
  } else if (isDigit(last)) {
    info.setMnc(10 * twoDigits + last);
    info.setNumMncDigits(3);
  }
}

/// Where the cells begin, and how long those of UMTS and of GSM are. What is read stands first in each.
struct RankedLayout {
  std::uint8_t version;
  Proof proof;
  std::uint8_t firstCell;
  std::uint8_t umtsCellSize;
  std::uint8_t gsmCellSize;
};

constexpr RankedLayout kRanked[] = {
    {0, byTheBook, 2, 10, 7},
    {1, byTheBook, 2, 11, 8},
    {2, sample, 7, 16, 13},
};
constexpr auto kRankedVersions = versionsOf(kRanked);
constexpr Field kRankedVersion = b(0, 6, 2);
constexpr Field kUmtsCells = b(0, 0, 6);
constexpr Field kGsmCells = b(1, 0, 6);

void addUmtsCell(KCellularWcdmaNbrCellMeas& report, ByteReader cell) {
  // What is logged is dBm + 21, and twice the dB; what is told is dBm + 116, and half dB above -24.5.
  constexpr std::int32_t kToRscpCode = 95;
  constexpr std::int32_t kToEcnoCode = 49;
  auto result = makeMessage<UtraCellMeasResult>();
  result->setUarfcn(cell.get(h(0)));
  result->setPsc(cell.get(h(2)));
  result->setRscp(cell.getSigned(b(4)) + kToRscpCode);
  const std::int32_t ecno = cell.getSigned(b(7)) + kToEcnoCode;
  if (ecno >= 0) result->setEcno(static_cast<std::uint32_t>(ecno));
  report.addMeasUtraResult(std::move(result));
}

void addGsmCell(KCellularWcdmaNbrCellMeas& report, ByteReader cell) {
  auto result = makeMessage<GsmCellMeasResult>();
  result->setArfcn(cell.get(h(0, 0, 12)));
  result->setRxlev(rxlevOf(cell.getSigned(b(4))));
  report.addMeasGsmResult(std::move(result));
}

}  // namespace

Reading readUmtsServingCell(const LogPacket& packet, SimState& /*sim*/, EventBatch& events) {
  ByteReader body(packet.body);
  KCellularWcdmaCellInfo info;
  info.setDlUarfcn(body.get(w(4)));
  info.setCellId(body.get(w(8)));
  info.setPsc(body.get(h(16, 4, 12)));
  info.setLac(body.get(w(24)));
  if (body.isCutOff()) return Reading::damaged;
  setNetwork(info, packet.body.subspan(18, 6));
  events.add(info);
  return Reading::read;
}

Reading readUmtsRrcState(const LogPacket& packet, SimState& /*sim*/, EventBatch& events) {
  ByteReader body(packet.body);
  const std::uint8_t state = body.byte(0);
  if (body.isCutOff()) return Reading::damaged;
  if (state >= std::size(kStates)) return Reading::read;
  KCellularWcdmaRrcConnectionState report;
  report.setState(kStates[state]);
  events.add(report);
  return Reading::read;
}

Versions umtsRankedCellVersions() {
  return kRankedVersions;
}

Reading readUmtsRankedCells(const LogPacket& packet, SimState& /*sim*/, EventBatch& events) {
  ByteReader body(packet.body);
  const RankedLayout* layout = findLayout(kRanked, static_cast<std::uint8_t>(body.get(kRankedVersion)));
  if (layout == nullptr) return Reading::passedOver;
  const std::size_t umtsCells = body.get(kUmtsCells);
  const std::size_t gsmCells = body.get(kGsmCells);
  if (body.isCutOff()) return Reading::damaged;

  KCellularWcdmaNbrCellMeas report;
  const std::size_t firstGsmCell = layout->firstCell + umtsCells * layout->umtsCellSize;
  const bool isWhole = forEachRecord(packet.body, layout->firstCell, umtsCells, layout->umtsCellSize,
                                     [&report](ByteReader cell) { addUmtsCell(report, cell); }) &&
                       forEachRecord(packet.body, firstGsmCell, gsmCells, layout->gsmCellSize,
                                     [&report](ByteReader cell) { addGsmCell(report, cell); });
  if (!isWhole) return Reading::damaged;
  if (umtsCells + gsmCells != 0) events.add(report);
  return Reading::read;
}

}  // namespace vesk::diag
