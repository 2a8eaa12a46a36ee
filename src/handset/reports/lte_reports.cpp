#include "handset/reports/lte_reports.h"

#include <algorithm>
#include <memory>

#include "handset/reports/reported_level.h"

namespace vesk::handset {

using namespace metrics;

namespace {

constexpr std::size_t kLteMostNeighbours = 8;
constexpr std::size_t kLteMostOfOtherTechnology = 4;

/// Levels are broadcast in steps of 2 dB.
constexpr std::int32_t kLteLeastLevel = -62;
constexpr std::int32_t kLeastQuality = -18;
constexpr std::int32_t kMaxPowerDbm = 23;

std::shared_ptr<NbrEutra> makeNeighbourCarrier(const LteCarrier& carrier) {
  auto neighbour = std::make_shared<NbrEutra>();
  neighbour->setEarfcn(carrier.earfcn);
  neighbour->setQRxlevMin(kLteLeastLevel);
  neighbour->setQQualMin(kLeastQuality);
  neighbour->setQOffset(0);
  neighbour->setPmax(kMaxPowerDbm);
  neighbour->setDlBw(carrier.bandwidthCode);
  neighbour->setThresXHighP(8);
  neighbour->setThresXLowP(7);
  neighbour->setThresXHighQ(10);
  neighbour->setThresXLowQ(8);
  neighbour->setPriority(carrier.priority);
  neighbour->setFrameType(NbrEutra::FrameType::FDD);
  neighbour->setBand(carrier.band);
  return neighbour;
}

std::shared_ptr<RsrpRsrqSinr> makeValues(const LteSample& sample) {
  auto values = std::make_shared<RsrpRsrqSinr>();
  values->setPhyCellId(sample.pci);
  values->setRsrp0(rsrpDbm(sample.rsrp[0]));
  values->setRsrp1(rsrpDbm(sample.rsrp[1]));
  values->setRsrq0(rsrqDb(sample.rsrq[0]));
  values->setRsrq1(rsrqDb(sample.rsrq[1]));
  values->setSinr0(sinrCode(sample.sinr[0]));
  values->setSinr1(sinrCode(sample.sinr[1]));
  return values;
}

LteSample mean(const std::vector<LteSample>& samples) {
  LteSample sum{samples.back().pci, {}, {}, {}};
  const double weight = 1.0 / static_cast<double>(samples.size());
  for (const LteSample& sample : samples) {
    for (std::size_t chain = 0; chain < 2; ++chain) {
      sum.rsrp[chain] += weight * sample.rsrp[chain];
      sum.rsrq[chain] += weight * sample.rsrq[chain];
      sum.sinr[chain] += weight * sample.sinr[chain];
    }
  }
  return sum;
}

std::shared_ptr<RxInfo> makeChain(const LteSignal& signal, double gain) {
  auto chain = std::make_shared<RxInfo>();
  chain->setRssi(rssiDbm(signal.rssi + gain));
  chain->setRsrpRange(rsrpCode(signal.rsrp + gain));
  chain->setRsrqRange(rsrqCode(signal.rsrq));
  chain->setSnr(sinrDb(signal.sinr + gain));
  return chain;
}

}  // namespace

KCellularLteScellInfo makeLteCellInfo(const LteCell& serving) {
  const LteCarrier& carrier = *serving.carrier;
  KCellularLteScellInfo info;
  info.setPhyCellId(serving.pci);
  info.setDlFreq(carrier.earfcn);
  info.setUlFreq(carrier.earfcn + kEarfcnUplinkOffset);
  // In half MHz.
  info.setDlBw(2 * carrier.bandwidthMhz);
  info.setUlBw(2 * carrier.bandwidthMhz);
  info.setCellId(serving.cellId);
  info.setFreqBandInd(carrier.band);
  info.setTrackingAreaCode(serving.trackingAreaCode);
  info.setNumMncDigits(kMncDigits);
  info.setSelPlmnMcc(kMcc);
  info.setSelPlmnMnc(kMnc);
  return info;
}

KCellularLteSelReselCellInfo makeLteSelection(const LteCell& serving) {
  KCellularLteSelReselCellInfo info;
  // What band 1 uses is a part of band 65 too.
  if (serving.carrier->band == 1) info.addMultiBandInfo(65);
  info.setImsEmergencySupport(1);
  info.setAcBarringForEmergency(0);
  info.setMoSignallingAcBarringFactor(95);
  info.setMoSignallingAcBarringTime(4);
  info.setMoSignallingAcBarringForSpecialAc(0);
  info.setMoDataAcBarringFactor(95);
  info.setMoDataAcBarringTime(16);
  info.setMoDataAcBarringForSpecialAc(0);
  info.setQRxLevMin(kLteLeastLevel);
  info.setQQualMin(kLeastQuality);
  info.setQHyst(4);
  info.setSNonIntraSearchP(8);
  info.setSNonIntraSearchQ(6);
  info.setSIntraSearchP(29);
  info.setSIntraSearchQ(10);
  info.setThreshServingLowP(3);
  info.setThreshServingLowQ(2);
  info.setPriorityOperatingFreq(serving.carrier->priority);
  for (const LteCarrier& carrier : kLteCarriers) {
    if (&carrier != serving.carrier) info.addNbrEutra(makeNeighbourCarrier(carrier));
  }
  return info;
}

KCellularLteCdrxConfig makeLteDrx(bool isConnected, std::uint32_t transmissionMode) {
  KCellularLteCdrxConfig config;
  config.setCdrxConfigStatus(isConnected ? 1 : 0);
  if (!isConnected) {
    config.setRrcState(LteRrcState::KLTE_RRC_STATE_IDLE);
    return config;
  }
  config.setCellStatus(1);
  config.setOnDurationMs(10);
  config.setDrxInactivityMs(100);
  config.setDrxRetxTimerMs(8);
  config.setLongDrxCycleMs(320);
  config.setShortDrxCycleMs(40);
  config.setDrxShortCycleNum(2);
  config.setRrcState(LteRrcState::KLTE_RRC_STATE_CONNECTED);
  config.setTransmissionMode(transmissionMode);
  return config;
}

KCellularLteRsrpRsrqSinr makeLteSamples(const std::vector<LteSample>& samples, std::uint32_t periodMs,
                                        const std::string& callId) {
  const auto count = static_cast<std::uint32_t>(samples.size());
  KCellularLteRsrpRsrqSinr report;
  if (!callId.empty()) report.setCallId(Text::copy(callId));
  report.setLastXSeconds(std::max(1U, count * periodMs / 1000));
  report.setLastYSamples(count);
  report.setSamplePeriodMs(periodMs);
  report.setDurationMs(count * periodMs);
  report.setNumSamples(count);
  report.setAvgValues(makeValues(mean(samples)));
  for (const LteSample& sample : samples)
    report.addInstValues(makeValues(sample));
  return report;
}

KCellularLteServingCellMeasurement makeLteServing(const LteSignal& serving, bool isConnected, double secondChainGain) {
  KCellularLteServingCellMeasurement report;
  report.setIsConnectedMode(isConnected);
  report.addRxInfo(makeChain(serving, 0));
  report.addRxInfo(makeChain(serving, secondChainGain));
  return report;
}

KCellularLteTxPower makeLteTxPower(const LteSignal& serving, Random& random) {
  const double pathLoss = serving.cell->antenna.powerDbm - serving.rsrp;
  const auto firstSubframe = random.below(5);
  KCellularLteTxPower report;
  for (std::uint32_t index = 0; index < 4; ++index) {
    const double resourceBlocks = random.between(2, serving.cell->carrier->resourceBlocks);
    auto power = std::make_shared<TxPowerInfo>();
    power->setPucchTxPower(rounded(pathLoss - 112 + random.normal(), -40, kMaxPowerDbm));
    power->setPuschTxPower(rounded(0.8 * pathLoss - 86 + decibels(resourceBlocks), -40, kMaxPowerDbm));
    power->setSubframeIndex(firstSubframe + index);
    report.addTxPowerInfo(std::move(power));
  }
  return report;
}

KCellularLteNbrEutraCellMeas makeLteNeighbours(const Radio& radio, const LteCell& serving) {
  KCellularLteNbrEutraCellMeas report;
  for (const LteSignal& signal : radio.lte()) {
    if (report.measNbrEutrasCount() == kLteMostNeighbours) break;
    if (signal.cell == &serving) continue;
    auto neighbour = std::make_shared<EgwErrcNbrEutraMeas>();
    neighbour->setNbrEarfcn(signal.cell->carrier->earfcn);
    neighbour->setNbrPhysCellId(signal.cell->pci);
    neighbour->setFreqBandInd(signal.cell->carrier->band);
    neighbour->setNbrRsrp(static_cast<std::int32_t>(rsrpCode(signal.rsrp)));
    neighbour->setNbrRsrq(static_cast<std::int32_t>(rsrqCode(signal.rsrq)));
    report.addMeasNbrEutra(std::move(neighbour));
  }
  return report;
}

KCellularLteNbrInterRatCellMeas makeLteOtherTechnologies(const Radio& radio) {
  KCellularLteNbrInterRatCellMeas report;
  for (const UmtsSignal& signal : radio.umts()) {
    if (report.measNbrUtrasCount() == kLteMostOfOtherTechnology) break;
    auto neighbour = std::make_shared<EgwErrcNbrUtraMeas>();
    neighbour->setUarfcn(kUarfcn);
    neighbour->setPsc(signal.cell->scramblingCode);
    neighbour->setRscp(static_cast<std::int32_t>(rscpCode(signal.rscp)));
    neighbour->setEcno(ecNoCode(signal.ecNo));
    report.addMeasNbrUtra(std::move(neighbour));
  }
  for (const GsmSignal& signal : radio.gsm()) {
    if (report.measNbrGeransCount() == kLteMostOfOtherTechnology) break;
    auto neighbour = std::make_shared<EgwErrcNbrGeranMeas>();
    neighbour->setArfcn(signal.cell->arfcn);
    neighbour->setBsic(signal.cell->bsic);
    neighbour->setRxlev(rxLevCode(signal.rxLev));
    report.addMeasNbrGeran(std::move(neighbour));
  }
  return report;
}

}  // namespace vesk::handset
