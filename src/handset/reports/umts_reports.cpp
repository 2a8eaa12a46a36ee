#include "handset/reports/umts_reports.h"

#include <memory>

#include "handset/reports/reported_level.h"

namespace vesk::handset {

using namespace metrics;

namespace {

constexpr std::size_t kUmtsMostNeighbours = 6;
constexpr std::size_t kUmtsMostOfOtherTechnology = 4;

/// Broadcast: the least RSCP in dBm and Ec/N0 in dB.
constexpr double kLeastRscp = -115;
constexpr double kLeastEcNo = -18;
/// Reselection priorities: LTE's carriers have theirs, above this.
constexpr std::uint32_t kUmtsPriority = 3;
constexpr std::uint32_t kGsmPriority = 1;

}  // namespace

KCellularWcdmaCellInfo makeUmtsCellInfo(const UmtsCell& serving) {
  KCellularWcdmaCellInfo info;
  info.setMcc(kMcc);
  info.setMnc(kMnc);
  info.setLac(serving.locationAreaCode);
  info.setCellId(serving.cellId);
  info.setWcdmaBand(SysBand::SYS_BAND_WCDMA_VIII_900);
  info.setDlUarfcn(kUarfcn);
  info.setPsc(serving.scramblingCode);
  info.setNumMncDigits(kMncDigits);
  info.setHspa(HsIndication::SYS_HS_IND_HSDPA_HSUPA_SUPP_CELL);
  return info;
}

KCellularWcdmaSelReselCellInfo makeUmtsSelection(const Radio& radio, const UmtsSignal& serving) {
  KCellularWcdmaSelReselCellInfo info;
  info.setHsdpaCapable(1);
  info.setEdchCapable(1);
  info.setDuplexMode(KCellularWcdmaSelReselCellInfo::DuplexMode::FDD);
  info.setImsEmergencySupport(0);
  info.setCellBarred(0);
  info.setFachMeasOccInfoPresent(1);
  info.setSRxlev(rounded(serving.rscp - kLeastRscp, -10, 90));
  info.setSQual(rounded(serving.ecNo - kLeastEcNo, -7, 18));
  info.setSIntrasearch(10);
  info.setSIntersearch(6);
  info.setSSearchRat(4);
  info.setSCellPrio(kUmtsPriority);
  for (const LteCarrier& carrier : kLteCarriers) {
    auto frequency = std::make_shared<EutraFreqInfo>();
    frequency->setEarfcn(carrier.earfcn);
    frequency->setPrio(carrier.priority);
    info.addEutraPrioInfo(std::move(frequency));
  }
  auto own = std::make_shared<UtraFreqInfo>();
  own->setUarfcn(kUarfcn);
  own->setPrio(kUmtsPriority);
  info.addUtraPrioInfo(std::move(own));
  for (const GsmSignal& signal : radio.gsm()) {
    if (info.gsmPrioInfosCount() == kUmtsMostOfOtherTechnology) break;
    auto frequency = std::make_shared<GsmFreqInfo>();
    frequency->setArfcn(signal.cell->arfcn);
    frequency->setPrio(kGsmPriority);
    info.addGsmPrioInfo(std::move(frequency));
  }
  return info;
}

KCellularWcdmaRrcConfiguration makeUmtsConfiguration(bool isConnected) {
  KCellularWcdmaRrcConfiguration configuration;
  configuration.setDrxCycleLengthMs(isConnected ? 320 : 1280);
  configuration.setIsMimoConfigured(false);
  configuration.setIsDcConfigured(false);
  return configuration;
}

KCellularWcdmaScellMeasurement makeUmtsServing(const UmtsSignal& serving, bool isConnected) {
  auto chain = std::make_shared<RxInfo>();
  chain->setRssi(rssiDbm(serving.rssi));
  chain->setRsrpRange(rscpCode(serving.rscp));
  chain->setRsrqRange(ecNoCode(serving.ecNo));
  // Despreading over the 256 chips of a CPICH symbol gains 24 dB.
  chain->setSnr(rounded(serving.ecNo + 24, -20, 30));
  KCellularWcdmaScellMeasurement report;
  report.setConnectedMode(isConnected);
  report.addRxInfo(std::move(chain));
  return report;
}

KCellularWcdmaTxPower makeUmtsTxPower(const UmtsSignal& serving, Random& random) {
  const double pathLoss = serving.cell->antenna.powerDbm - serving.rscp;
  KCellularWcdmaTxPower report;
  for (std::uint32_t index = 0; index < 2; ++index) {
    const double control = pathLoss - 118 + random.normal();
    auto power = std::make_shared<TxPowerInfo>();
    power->setPucchTxPower(rounded(control, -50, 24));
    power->setPuschTxPower(rounded(control + random.between(3, 8), -50, 24));
    power->setSubframeIndex(index);
    report.addTxPowerInfo(std::move(power));
  }
  return report;
}

KCellularWcdmaNbrCellMeas makeUmtsNeighbours(const Radio& radio, const UmtsCell& serving) {
  KCellularWcdmaNbrCellMeas report;
  for (const UmtsSignal& signal : radio.umts()) {
    if (report.measUtraResultsCount() == kUmtsMostNeighbours) break;
    if (signal.cell == &serving) continue;
    auto result = std::make_shared<UtraCellMeasResult>();
    result->setUarfcn(kUarfcn);
    result->setBand(kUmtsBand);
    result->setPsc(signal.cell->scramblingCode);
    result->setEcno(ecNoCode(signal.ecNo));
    result->setRscp(static_cast<std::int32_t>(rscpCode(signal.rscp)));
    report.addMeasUtraResult(std::move(result));
  }
  for (const GsmSignal& signal : radio.gsm()) {
    if (report.measGsmResultsCount() == kUmtsMostOfOtherTechnology) break;
    auto result = std::make_shared<GsmCellMeasResult>();
    result->setArfcn(signal.cell->arfcn);
    result->setBsic(signal.cell->bsic);
    result->setRxlev(rxLevCode(signal.rxLev));
    report.addMeasGsmResult(std::move(result));
  }
  for (const LteSignal& signal : radio.lte()) {
    if (report.measLteResultsCount() == kUmtsMostOfOtherTechnology) break;
    auto result = std::make_shared<LteCellMeasResult>();
    result->setEarfcn(signal.cell->carrier->earfcn);
    result->setPhyCellId(signal.cell->pci);
    result->setEutraBand(signal.cell->carrier->band);
    result->setRsrp(static_cast<std::int32_t>(rsrpCode(signal.rsrp)));
    result->setRsrq(static_cast<std::int32_t>(rsrqCode(signal.rsrq)));
    report.addMeasLteResult(std::move(result));
  }
  return report;
}

}  // namespace vesk::handset
