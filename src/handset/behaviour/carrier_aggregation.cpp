#include "handset/behaviour/carrier_aggregation.h"

#include <algorithm>
#include <memory>

#include "handset/reports/reported_level.h"

namespace vesk::handset {

using namespace metrics;

namespace {

constexpr std::size_t kMostSecondaries = 2;
constexpr std::int64_t kActivationMs = 300;
/// In dBm: below this no secondary carrier is worth its power.
constexpr double kLeastLevel = -112;
/// And above this it is used in the uplink too.
constexpr double kUplinkLevel = -90;

std::shared_ptr<SecondaryComponentCarrier> makeCarrier(std::uint32_t index, const LteCell& cell, SccState state) {
  auto carrier = std::make_shared<SecondaryComponentCarrier>();
  carrier->setIndex(index);
  carrier->setState(state);
  carrier->setPci(cell.pci);
  carrier->setDlEarfcn(cell.carrier->earfcn);
  carrier->setDlRfBand(cell.carrier->band);
  carrier->setDlBandwidth(cell.carrier->bandwidthCode);
  carrier->setHasUplink(false);
  return carrier;
}

void addUplink(SecondaryComponentCarrier& carrier, const LteCarrier& used) {
  carrier.setHasUplink(true);
  carrier.setUlEarfcn(used.earfcn + kEarfcnUplinkOffset);
  carrier.setUlRfBand(used.band);
  carrier.setUlBandwidth(used.bandwidthCode);
}

/// In hundredths, but for the ratio of signal to noise.
void addMeasurement(SecondaryComponentCarrier& carrier, const LteSignal& signal) {
  carrier.setRsrp(rounded(100 * signal.rsrp, -14000, -4400));
  carrier.setRsrq(rounded(100 * signal.rsrq, -1950, -300));
  carrier.setSnr(sinrDb(signal.sinr));
  carrier.setRssi(rounded(100 * signal.rssi, -11500, -2500));
}

}  // namespace

void CarrierAggregation::start(const LteCell& primary, const StepContext& now) {
  primary_ = &primary;
  secondaries_.clear();
  changeMs_ = now.nowMs + 1500;
  tellCarriers(now);
}

void CarrierAggregation::end(const StepContext& now) {
  while (!secondaries_.empty())
    deconfigureLast(now);
  primary_ = nullptr;
}

void CarrierAggregation::step(const StepContext& now) {
  bool hasActivated = false;
  for (Secondary& secondary : secondaries_) {
    const bool isDue = secondary.state != SccState::SCC_STATE_ACTIVATED && now.nowMs >= secondary.activationMs;
    if (isDue) secondary.state = SccState::SCC_STATE_ACTIVATED;
    hasActivated |= isDue;
  }
  if (hasActivated) status_.reset();
  if (now.nowMs >= changeMs_) {
    changeMs_ = now.nowMs + 3000 + now.random.below(6000);
    const bool grows = secondaries_.empty() || (secondaries_.size() < kMostSecondaries && now.random.chance(0.6));
    grows ? configureAnother(now) : deconfigureLast(now);
  }
  if (!secondaries_.empty() && status_.isDue(now.nowMs)) tellStatus(now);
}

void CarrierAggregation::configureAnother(const StepContext& now) {
  const auto isUsed = [this](const LteCarrier* carrier) {
    return carrier == primary_->carrier ||
           std::any_of(secondaries_.begin(), secondaries_.end(),
                       [carrier](const Secondary& secondary) { return secondary.cell->carrier == carrier; });
  };
  for (const LteSignal& signal : now.radio.lte()) {
    const Antenna& antenna = signal.cell->antenna;
    const bool isCoSited = antenna.site == primary_->antenna.site && antenna.direction == primary_->antenna.direction;
    if (!isCoSited || isUsed(signal.cell->carrier) || signal.rsrp < kLeastLevel) continue;
    secondaries_.push_back({signal.cell, SccState::SCC_STATE_CONFIGURED_DEACTIVATED, now.nowMs + kActivationMs});
    tellCarriers(now);
    tellStatus(now);
    return;
  }
}

void CarrierAggregation::deconfigureLast(const StepContext& now) {
  secondaries_.back().state = SccState::SCC_STATE_DECONFIGURED;
  tellStatus(now);
  secondaries_.pop_back();
  tellCarriers(now);
}

void CarrierAggregation::tellCarriers(const StepContext& now) const {
  KCellularLteComponentCarrierInfo info;
  info.setPccEarfcn(primary_->carrier->earfcn);
  info.setPccBandwidth(primary_->carrier->bandwidthMhz);
  if (!secondaries_.empty()) {
    info.setScc0Earfcn(secondaries_[0].cell->carrier->earfcn);
    info.setScc0Bandwidth(secondaries_[0].cell->carrier->bandwidthMhz);
  }
  if (secondaries_.size() > 1) {
    info.setScc1Earfcn(secondaries_[1].cell->carrier->earfcn);
    info.setScc1Bandwidth(secondaries_[1].cell->carrier->bandwidthMhz);
  }
  now.outbox.tell(info);
}

void CarrierAggregation::tellStatus(const StepContext& now) {
  KCellularLteCarrierAggregationStatus status;
  std::uint32_t index = 0;
  for (const Secondary& secondary : secondaries_) {
    auto carrier = makeCarrier(++index, *secondary.cell, secondary.state);
    const LteSignal* signal = now.radio.of(secondary.cell);
    if (secondary.state == SccState::SCC_STATE_ACTIVATED && signal != nullptr) {
      addMeasurement(*carrier, *signal);
      if (index == 1 && signal->rsrp > kUplinkLevel) addUplink(*carrier, *secondary.cell->carrier);
    }
    status.addSccList(std::move(carrier));
  }
  now.outbox.tell(status);
}

}  // namespace vesk::handset
