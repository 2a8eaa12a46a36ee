#include "insight/report_fields.h"
#include "insight/report_steps.h"
#include "insight/umts_chain.h"

namespace vesk::insight {

namespace {

/// Under which keys a list has what is known of a cell.
struct NeighborKeys {
  Text channel;
  Text code;
  Text level;
  Text quality;
};

void readLteNeighbors(Report& report, const RecordList& list, const NeighborKeys& keys) {
  for (const Record& element : list) {
    OrderedLookup each(element);
    report.neighbors.push_back({Technology::lte, earfcnOf(each, keys.channel), pciOf(each, keys.code),
                                levelOf(kRsrp, each, keys.level), levelOf(kRsrq, each, keys.quality)});
  }
}

void readUmtsNeighbors(Report& report, const RecordList& list, const NeighborKeys& keys) {
  for (const Record& element : list) {
    OrderedLookup each(element);
    report.neighbors.push_back({Technology::umts, uarfcnOf(each, keys.channel), pscOf(each, keys.code),
                                levelOf(kRscp, each, keys.level), levelOf(kEcNo, each, keys.quality)});
  }
}

void readGsmNeighbors(Report& report, const RecordList& list) {
  for (const Record& element : list) {
    OrderedLookup each(element);
    const Integer arfcn = arfcnOf(each, std::nullopt);
    const Integer bsic = bsicOf(each);
    report.neighbors.push_back({Technology::gsm, arfcn, bsic, levelOf(kRxLev, each, "rxlev"_text), std::nullopt});
  }
}

const NeighborKeys& utraKeys() {
  static const NeighborKeys kKeys{"uarfcn"_text, "psc"_text, "rscp"_text, "ecno"_text};
  return kKeys;
}

}  // namespace

void readLteMeasurement(Report& report, OrderedLookup& record, const Stores& stores) {
  if (record.find("inst_values"_text) == nullptr || stores.myLTE.RsrpRsrqSinr.size() == 0) return;
  OrderedLookup sample(stores.myLTE.RsrpRsrqSinr[0]);
  report.samplePci = pciOf(sample, "phy_cell_id"_text);
  const auto better = [&](const Quantity& quantity, const Text& first, const Text& second) {
    const Number one = levelOf(quantity, sample, first);
    return greater(one, levelOf(quantity, sample, second));
  };
  const Number level = better(kRsrp, "rsrp0"_text, "rsrp1"_text);
  report.kpis.add(Kpi::lteRsrp, level);
  report.kpis.add(Kpi::lteRsrq, better(kRsrq, "rsrq0"_text, "rsrq1"_text));
  report.kpis.add(Kpi::lteSinr, better(kSinr, "sinr0"_text, "sinr1"_text));
  if (level) report.technology = Technology::lte;
}

void readLteTxPower(Report& report, OrderedLookup& record, const Stores& stores) {
  if (record.find("tx_power_info"_text) == nullptr) return;
  Number pucch;
  Number pusch;
  for (const Record& element : stores.myLTE.TxPower) {
    OrderedLookup each(element);
    pucch = greater(pucch, levelOf(kTxPower, each, "pucch_tx_power"_text));
    pusch = greater(pusch, levelOf(kTxPower, each, "pusch_tx_power"_text));
  }
  report.kpis.add(Kpi::ltePuschTxPower, pusch);
  report.kpis.add(Kpi::ltePucchTxPower, pucch);
}

void readUmtsTxPower(Report& report, OrderedLookup& record, const Stores& stores) {
  if (record.find("tx_power_info"_text) == nullptr) return;
  report.kpis.add(Kpi::umtsTxPower, greatest(stores.myUMTS.TxPower, [](const Record& element) {
                    OrderedLookup each(element);
                    return levelOf(kTxPower, each, "pusch_tx_power"_text);
                  }));
}

void readUmtsMeasurement(Report& report, OrderedLookup& record, const Stores& stores) {
  const Value* isConnected = record.find("connected_mode"_text);
  if (isConnected != nullptr && isConnected->boolean() != nullptr) report.isConnectedMode = *isConnected->boolean();
  if (record.find("rx_info"_text) == nullptr) return;
  UmtsChain best;
  for (const Record& each : stores.myUMTS.rXInfo) {
    const UmtsChain chain = umtsChainOf(each);
    best = {greater(best.rscp, chain.rscp), greater(best.ecNo, chain.ecNo), greater(best.rssi, chain.rssi)};
  }
  report.kpis.add(Kpi::umtsRscp, best.rscp);
  report.kpis.add(Kpi::umtsEcNo, best.ecNo);
  report.kpis.add(Kpi::umtsRssi, best.rssi);
  if (!report.kpis.empty()) report.technology = Technology::umts;
}

void readGsmIdleMeasurement(Report& report, OrderedLookup& record, const Stores& /*stores*/) {
  report.kpis.add(Kpi::gsmRxLev, levelOf(kRxLev, record, "idle_rxlev_dBm"_text));
  if (!report.kpis.empty()) report.technology = Technology::gsm;
}

void readGsmConnectedMeasurement(Report& report, OrderedLookup& record, const Stores& /*stores*/) {
  const Number level = decodedLevel(kRxLev, record.find("cs_rxlev_sub"_text), 1, -110);
  report.kpis.add(Kpi::gsmRxLev, level);
  report.kpis.add(Kpi::gsmRxQual, levelOf(kRxQual, record, "cs_rxqual_sub"_text));
  if (level) report.technology = Technology::gsm;
  const Value* powers = record.find("cs_tx_pwr"_text);
  if (powers == nullptr || powers->array() == nullptr) return;
  report.kpis.add(Kpi::gsmTxPower,
                  greatest(*powers->array(), [](const Value& each) { return possibleValue(kTxPower, &each); }));
}

void readNeighborsOfLte(Report& report, OrderedLookup& record, const Stores& stores) {
  if (record.find("meas_nbr_eutra"_text) == nullptr) return;
  static const NeighborKeys kKeys{"nbr_earfcn"_text, "nbr_phys_cell_id"_text, "nbr_rsrp"_text, "nbr_rsrq"_text};
  readLteNeighbors(report, stores.myLTE.EutraNbrsMeas, kKeys);
  report.kpis.add(Kpi::lteNbrRsrp, greatest(report.neighbors, [](const NeighborReport& each) { return each.level; }));
}

void readOtherNeighborsOfLte(Report& report, OrderedLookup& record, const Stores& stores) {
  if (record.find("meas_nbr_utra"_text) != nullptr) readUmtsNeighbors(report, stores.myLTE.UtraNbrsMeas, utraKeys());
  if (record.find("meas_nbr_geran"_text) != nullptr) readGsmNeighbors(report, stores.myLTE.GeraNbrsMeas);
}

void readNeighborsOfUmts(Report& report, OrderedLookup& record, const Stores& stores) {
  static const NeighborKeys kEutraKeys{"earfcn"_text, "phy_cell_id"_text, "rsrp"_text, "rsrq"_text};
  if (record.find("meas_utra_result"_text) != nullptr) readUmtsNeighbors(report, stores.myUMTS.utraNbrMeas, utraKeys());
  if (record.find("meas_gsm_result"_text) != nullptr) readGsmNeighbors(report, stores.myUMTS.geraNbrMeas);
  if (record.find("meas_lte_result"_text) != nullptr) readLteNeighbors(report, stores.myUMTS.eUtraNbrMeas, kEutraKeys);
}

void readNeighborsOfGsm(Report& report, OrderedLookup& record, const Stores& stores) {
  static const NeighborKeys kUtraKeys{"dl_uarfcn"_text, "cpich_sc"_text, "cpich_rscp"_text, "cpich_ecn0"_text};
  static const NeighborKeys kEutraKeys{"earfcn"_text, "physical_cell_id"_text, "rsrp"_text, "rsrq"_text};
  if (record.find("gsm_ncell_meas"_text) != nullptr) readGsmNeighbors(report, stores.myGSM.geraNbrMeas);
  if (record.find("umts_ncell_meas"_text) != nullptr) readUmtsNeighbors(report, stores.myGSM.utraNbrMeas, kUtraKeys);
  if (record.find("lte_ncell_meas"_text) != nullptr) readLteNeighbors(report, stores.myGSM.eUtraNbrMeas, kEutraKeys);
}

}  // namespace vesk::insight
