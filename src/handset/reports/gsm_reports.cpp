#include "handset/reports/gsm_reports.h"

#include <memory>

#include "handset/reports/reported_level.h"

namespace vesk::handset {

using namespace metrics;

namespace {

/// A call's measurement report has room for six.
constexpr std::size_t kGsmMostNeighbours = 6;
constexpr std::size_t kGsmMostOfOtherTechnology = 4;

constexpr SysBand kBand = SysBand::SYS_BAND_GSM_PGSM_900;
constexpr std::uint32_t kBandNumber = static_cast<std::uint32_t>(kBand);

/// Layer 1: camping, and on a dedicated channel.
constexpr std::uint32_t kIdleLayer = 2;
constexpr std::uint32_t kDedicatedLayer = 5;

/// dBm: power control aims the uplink at this, 2 dB a step, between the least and the greatest power of its class.
constexpr double kUplinkTarget = -80;
constexpr std::int32_t kLeastPower = 5;
constexpr std::int32_t kMostPower = 33;

}  // namespace

KCellularGsmScellInfo makeGsmCellInfo(const GsmCell& serving, bool isDedicated) {
  KCellularGsmScellInfo info;
  info.setMcc(kMcc);
  info.setMnc(kMnc);
  info.setLac(serving.locationAreaCode);
  info.setCellId(serving.cellId);
  info.setGsmBand(kBand);
  info.setArfcn(serving.arfcn);
  info.setBsic(serving.bsic);
  info.setState(isDedicated ? GsmDedicatedState::DEDICATED_STATE : GsmDedicatedState::NON_DEDICATED_STATE);
  info.setNumMncDigits(kMncDigits);
  return info;
}

KCellularGsmIdleConfig makeGsmIdleConfig(const GsmCell& serving, bool isDedicated) {
  KCellularGsmIdleConfig config;
  config.setArfcnBcch(serving.arfcn);
  config.setMcc(kMcc);
  config.setMnc(kMnc);
  config.setLac(serving.locationAreaCode);
  config.setCi(serving.cellId);
  config.setBsic(serving.bsic);
  config.setDtxFromBs(1);
  // In SACCH blocks.
  config.setRadioLinkTimeout(24);
  config.setMultibRep(0);
  config.setGsmBand(kBandNumber);
  config.setAccessTech(0);
  config.setTypeOfCurChan(isDedicated ? 1 : 0);
  // Power level 5 is 33 dBm; access from -102 dBm.
  config.setMsTxpwr(5);
  config.setRxAccMin(8);
  config.setCbq(0);
  config.setCba(0);
  config.setC2Valid(1);
  config.setCrOffset(0);
  config.setTmpOffset(0);
  config.setPenaltyT(0);
  // In tenths of an hour.
  config.setT3212(10);
  config.setAcc(0);
  config.setBsPaMfrms(4);
  config.setCsPagemode(0);
  config.setMaxRetransCs(2);
  config.setEmergCallAllowed(1);
  config.setAttachAllowed(1);
  config.setHalfRateSupported(1);
  config.setSi78Broadcast(0);
  config.setCbchSupported(0);
  config.setReestAllowed(0);
  config.setEcsc(1);
  config.setSi2TerNeeded(0);
  return config;
}

KCellularGsmGprsConfig makeGprsConfig() {
  KCellularGsmGprsConfig config;
  config.setGprsSup(true);
  config.setRac(kRoutingAreaCode);
  config.setSpPgCy(false);
  config.setNco(0);
  config.setNom(2);
  config.setCrHyst(3);
  config.setAccThr(6);
  config.setExtUplTbfSupported(true);
  config.setPriorityClass(0);
  config.setCellBarAccess2(0);
  return config;
}

KCellularGsmIdleScellMeasurement makeGsmIdle(const GsmSignal& serving, Random& random) {
  KCellularGsmIdleScellMeasurement report;
  report.setScellArfcn(serving.cell->arfcn);
  report.setSimplifiedL1State(kIdleLayer);
  report.setCurrentAntenna(random.below(2));
  report.setIdleRxlevDBm(rounded(serving.rxLev, -110, -47));
  return report;
}

KCellularGsmCsRfMeasurement makeGsmDedicated(const GsmSignal& serving, Random& random) {
  KCellularGsmCsRfMeasurement report;
  report.setScellArfcn(serving.cell->arfcn);
  report.setSimplifiedL1State(kDedicatedLayer);
  report.setCurrentAntenna(random.below(2));
  for (int burst = 0; burst < 4; ++burst) {
    const double step = (kUplinkTarget - serving.rxLev + 20 + random.normal()) / 2;
    report.addCsTxPwr(rounded(2 * step, kLeastPower, kMostPower));
  }
  report.setCsRxlevSub(rxLevCode(serving.rxLev));
  // Quality follows the level once that comes near the noise.
  report.setCsRxqualSub(roundedUnsigned((-95 - serving.rxLev) / 2 + random.uniform(), 7));
  report.setScellBand(kBandNumber);
  return report;
}

KCellularGsmGrrEventMeasCr makeGsmNeighbours(const Radio& radio, const GsmCell& serving) {
  KCellularGsmGrrEventMeasCr report;
  for (const GsmSignal& signal : radio.gsm()) {
    if (report.gsmNcellMeasCount() == kGsmMostNeighbours) break;
    if (signal.cell == &serving) continue;
    auto neighbour = std::make_shared<GsmNcellMeas>();
    neighbour->setMcc(kMcc);
    neighbour->setMnc(kMnc);
    neighbour->setLac(signal.cell->locationAreaCode);
    neighbour->setCi(signal.cell->cellId);
    neighbour->setBsic(signal.cell->bsic);
    neighbour->setArfcn(signal.cell->arfcn);
    neighbour->setRxlev(rxLevCode(signal.rxLev));
    report.addGsmNcellMeas(std::move(neighbour));
  }
  for (const UmtsSignal& signal : radio.umts()) {
    if (report.umtsNcellMeasCount() == kGsmMostOfOtherTechnology) break;
    auto neighbour = std::make_shared<UmtsNcellMeas>();
    neighbour->setCellType(0);
    neighbour->setCpichSc(signal.cell->scramblingCode);
    neighbour->setDlUarfcn(kUarfcn);
    neighbour->setCpichRscp(rscpCode(signal.rscp));
    neighbour->setCpichEcn0(ecNoCode(signal.ecNo));
    report.addUmtsNcellMeas(std::move(neighbour));
  }
  for (const LteSignal& signal : radio.lte()) {
    if (report.lteNcellMeasCount() == kGsmMostOfOtherTechnology) break;
    auto neighbour = std::make_shared<LteNcellMeas>();
    neighbour->setPhysicalCellId(signal.cell->pci);
    neighbour->setBandwidth(signal.cell->carrier->bandwidthCode);
    neighbour->setRsrp(rsrpCode(signal.rsrp));
    neighbour->setEarfcn(signal.cell->carrier->earfcn);
    neighbour->setRsrq(rsrqCode(signal.rsrq));
    report.addLteNcellMeas(std::move(neighbour));
  }
  return report;
}

}  // namespace vesk::handset
