#include "diag/layout/byte_reader.h"
#include "diag/layout/values.h"
#include "diag/lte/lte_logs.h"
#include "diag/translation/event_batch.h"

namespace vesk::diag {

namespace {

using namespace metrics;
using namespace notation;
using enum Proof;

struct CellLayout {
  std::uint8_t version;
  Proof proof;
  Field pci;
  Field downlinkEarfcn, uplinkEarfcn;
  Field downlinkBlocks, uplinkBlocks;
  Field cellId, tac, band;
  Field mcc, mncDigits, mnc;
};

// clang-format off
constexpr CellLayout kCellLayouts[] = {
    //             PCI   EARFCN      resource blocks cell   TAC    band   MCC    MNC: digits, number
    {3, checked,   h(1), w(3), w(7), b(11), b(12),   w(13), h(17), w(19), h(23), b(25), h(26)},
    {2, byTheBook, h(1), h(3), h(5), b(7),  b(8),    w(9),  h(13), w(15), h(19), b(21), h(22)},
};
// clang-format on
constexpr auto kCellVersions = versionsOf(kCellLayouts);

}  // namespace

Versions lteServingCellVersions() {
  return kCellVersions;
}

Reading readLteServingCell(const LogPacket& packet, SimState& /*sim*/, EventBatch& events) {
  const CellLayout* layout = findLayout(kCellLayouts, packet.body[0]);
  if (layout == nullptr) return Reading::passedOver;

  ByteReader body(packet.body);
  const std::uint32_t earfcn = body.get(layout->downlinkEarfcn);
  const std::uint32_t downlinkBlocks = body.get(layout->downlinkBlocks);
  KCellularLteScellInfo info;
  info.setPhyCellId(body.get(layout->pci));
  info.setDlFreq(earfcn);
  info.setUlFreq(body.get(layout->uplinkEarfcn));
  setWhenKnown(info, &KCellularLteScellInfo::setDlBw, bandwidthHalfMhz(downlinkBlocks));
  setWhenKnown(info, &KCellularLteScellInfo::setUlBw, bandwidthHalfMhz(body.get(layout->uplinkBlocks)));
  info.setCellId(body.get(layout->cellId));
  info.setTrackingAreaCode(body.get(layout->tac));
  info.setFreqBandInd(body.get(layout->band));
  info.setSelPlmnMcc(body.get(layout->mcc));
  info.setNumMncDigits(body.get(layout->mncDigits));
  info.setSelPlmnMnc(body.get(layout->mnc));
  if (body.isCutOff()) return Reading::damaged;
  events.add(info);

  KCellularLteComponentCarrierInfo carriers;
  carriers.setPccEarfcn(earfcn);
  setWhenKnown(carriers, &KCellularLteComponentCarrierInfo::setPccBandwidth, bandwidthMhz(downlinkBlocks));
  events.add(carriers);
  return Reading::read;
}

}  // namespace vesk::diag
