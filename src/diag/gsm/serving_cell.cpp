#include "diag/gsm/serving_cell.h"

#include "diag/gsm/gsm_logs.h"
#include "diag/layout/byte_reader.h"
#include "diag/translation/event_batch.h"

namespace vesk::diag {

using namespace metrics;
using namespace notation;

void addGsmServingCell(const GsmCellIdentity& identity, const std::optional<GsmCell>& lastCell, EventBatch& events) {
  const PlmnDigits& network = identity.network;
  KCellularGsmScellInfo info;
  info.setMcc(network.mcc);
  info.setMnc(network.mnc);
  info.setNumMncDigits(network.mncDigits);
  info.setLac(identity.lac);
  info.setCellId(identity.cellId);
  const bool isLastCell = lastCell && lastCell->mcc == network.mcc && lastCell->mnc == network.mnc &&
                          lastCell->lac == identity.lac && lastCell->cellId == identity.cellId;
  if (isLastCell) {
    info.setArfcn(lastCell->arfcn);
    info.setBsic(lastCell->bsic);
  }
  events.add(info);
}

Reading readGsmServingCell(const LogPacket& packet, SimState& sim, EventBatch& events) {
  ByteReader body(packet.body);
  const std::uint32_t arfcn = body.get(h(0, 0, 12));
  const std::uint32_t bcc = body.byte(2) & 7U;
  const std::uint32_t ncc = body.byte(3) & 7U;
  const std::uint32_t cellId = body.get(h(4));
  const ByteSpan plmn = body.part(6, 3);
  const std::uint32_t lac = body.bigEndian(9, 2);
  if (body.isCutOff()) return Reading::damaged;

  const PlmnDigits network = plmnDigits(plmn.first<3>());
  sim.gsmCell = {network.mcc, network.mnc, lac, cellId, arfcn, 8 * ncc + bcc};
  addGsmServingCell({network, lac, cellId}, sim.gsmCell, events);
  return Reading::read;
}

}  // namespace vesk::diag
