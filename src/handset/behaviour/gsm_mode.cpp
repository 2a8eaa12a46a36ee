#include "handset/behaviour/gsm_mode.h"

#include "handset/reports/gsm_reports.h"

namespace vesk::handset {

namespace {

/// dB: the cell reselection hysteresis, and the margin of a handover.
constexpr double kGsmCellMargin = 6;

}  // namespace

void GsmMode::enter(const Surroundings& now, bool /*isHandover*/) {
  isDedicated_ = false;
  dueMs_ = now.nowMs + 2500 + now.random.below(1000);
  camp(*now.radio.gsm().front().cell, now);
}

std::optional<Departure> GsmMode::step(const Surroundings& now) {
  const GsmSignal* signal = now.radio.of(serving_);
  if (signal != nullptr) report(now, *signal);
  const bool isLteBack = lteIsBack_.hasHeld(isLteUsable(now.radio), now.nowMs);
  const bool isUmtsBack = umtsIsBack_.hasHeld(isUmtsUsable(now.radio), now.nowMs);
  if (!isDedicated_ && (isLteBack || isUmtsBack)) return Departure{isLteBack ? Technology::lte : Technology::umts};
  considerOtherCells(now, signal);
  now.registration.keepUp(area(), now.nowMs, now.outbox, now.random);
  if (now.nowMs >= dueMs_) setDedicated(!isDedicated_, now);
  return std::nullopt;
}

void GsmMode::considerOtherCells(const Surroundings& now, const GsmSignal* signal) {
  const auto& heard = now.radio.gsm();
  const bool isBetter = !heard.empty() && (signal == nullptr || heard.front().rxLev > signal->rxLev + kGsmCellMargin);
  if (betterCell_.hasHeld(isBetter, now.nowMs)) camp(*heard.front().cell, now);
}

void GsmMode::setDedicated(bool isDedicated, const Surroundings& now) {
  isDedicated_ = isDedicated;
  dueMs_ = now.nowMs + (isDedicated ? 4000 + now.random.below(3000) : 10000 + now.random.below(10000));
  servingReport_.reset();
  auto info = makeGsmCellInfo(*serving_, isDedicated_);
  now.outbox.tell(info);
}

void GsmMode::camp(const GsmCell& cell, const Surroundings& now) {
  serving_ = &cell;
  betterCell_.reset();
  auto info = makeGsmCellInfo(cell, isDedicated_);
  now.outbox.tell(info);
  auto config = makeGsmIdleConfig(cell, isDedicated_);
  now.outbox.tell(config);
  auto gprs = makeGprsConfig();
  now.outbox.tell(gprs);
}

void GsmMode::report(const Surroundings& now, const GsmSignal& signal) {
  if (servingReport_.isDue(now.nowMs)) {
    if (isDedicated_) {
      auto dedicated = makeGsmDedicated(signal, now.random);
      now.outbox.tell(dedicated);
    } else {
      auto idle = makeGsmIdle(signal, now.random);
      now.outbox.tell(idle);
    }
  }
  if (neighbourReport_.isDue(now.nowMs)) {
    auto neighbours = makeGsmNeighbours(now.radio, *serving_);
    now.outbox.tell(neighbours);
  }
}

}  // namespace vesk::handset
