#include "handset/behaviour/lte_mode.h"

#include "handset/behaviour/triggers.h"

namespace vesk::handset {

using namespace metrics;

namespace {

constexpr std::uint32_t kSamplePeriodMs = 100;
constexpr std::size_t kSamplesOfReport = 10;
constexpr double kSampleDeviation = 1.0;

/// dBm: below the first a connection seeks another technology, below the second an idle handset does.
constexpr double kB2Level = -114;
constexpr double kLeastIdleLevel = -118;
/// dB.
constexpr double kA3Margin = 3;
constexpr double kReselectionMargin = 4;
constexpr double kOtherFrequencyMargin = 2;
constexpr double kOutOfSyncSinr = -7;

constexpr double kHandoverFailure = 0.05;
constexpr double kAccessFailure = 0.02;

std::int64_t milliseconds(double low, double high, Random& random) {
  return static_cast<std::int64_t>(1000 * random.between(low, high));
}

LteRrcCause chooseCause(Random& random) {
  const double choice = random.uniform();
  if (choice < 0.6) return LteRrcCause::KLTE_RRC_CAUSE_EST_MO_DATA;
  return choice < 0.9 ? LteRrcCause::KLTE_RRC_CAUSE_EST_MT_ACC : LteRrcCause::KLTE_RRC_CAUSE_EST_MO_SIGNAL;
}

std::string makeCallId(Random& random) {
  std::string id;
  for (int count = 0; count < 8; ++count)
    id += "0123456789abcdef"[random.below(16)];
  return id;
}

}  // namespace

void LteMode::enter(const StepContext& now, bool isHandover) {
  callId_.clear();
  camp(*now.radio.lte().front().cell, now);
  if (isHandover) {
    changeState(State::KLTE_RRC_STATE_ATMPT_INBND_MOBILITY, Cause::KLTE_RRC_CAUSE_NA, now);
    establishmentCause_ = Cause::KLTE_RRC_CAUSE_EST_SUCC_MOB_TO_EUTRAN;
    dueMs_ = now.nowMs + 200;
  } else {
    changeState(State::KLTE_RRC_STATE_IDLE, Cause::KLTE_RRC_CAUSE_NA, now);
    dueMs_ = now.nowMs + milliseconds(3, 8, now.random);
  }
}

std::optional<Departure> LteMode::step(const StepContext& now) {
  const LteSignal* signal = now.radio.of(serving_);
  if (signal != nullptr) report(now, *signal);
  switch (state_) {
    case State::KLTE_RRC_STATE_NULL:
    case State::KLTE_RRC_STATE_IDLE:
      return stepIdle(now, signal);
    case State::KLTE_RRC_STATE_ATMPT_CONNECTION:
    case State::KLTE_RRC_STATE_ATMPT_INBND_MOBILITY:
      if (now.nowMs >= dueMs_) stepAttempt(now);
      return std::nullopt;
    case State::KLTE_RRC_STATE_CONNECTED:
      stepConnected(now, signal);
      return std::nullopt;
    case State::KLTE_RRC_STATE_ENDING:
      endConnection(Cause::KLTE_RRC_CAUSE_REL_OTHER, now);
      return std::nullopt;
    case State::KLTE_RRC_STATE_ATMPT_OUTBND_MOBILITY:
      return leave(Cause::KLTE_RRC_CAUSE_REL_SUCC_MOB_FROM_EUTRAN, true, now);
  }
  return std::nullopt;
}

std::optional<Departure> LteMode::stepIdle(const StepContext& now, const LteSignal* signal) {
  const bool isTooWeak = signal == nullptr || signal->rsrp < kLeastIdleLevel;
  if (outOfReach_.hasHeld(isTooWeak && !isLteUsable(now.radio), now.nowMs)) {
    const auto departure = leave(Cause::KLTE_RRC_CAUSE_NO_SERVICE, false, now);
    if (departure) return departure;
  }
  const LteCell* better = betterCell(now.radio, signal, kReselectionMargin);
  if (reselection_.hasHeld(better != nullptr, now.nowMs) && better != nullptr) {
    camp(*better, now);
  } else if (!isTooWeak && !now.registration.isRegisteredIn(area())) {
    startConnection(Cause::KLTE_RRC_CAUSE_EST_MO_SIGNAL, now);
  } else if (!isTooWeak && now.nowMs >= dueMs_) {
    startConnection(chooseCause(now.random), now);
  }
  return std::nullopt;
}

void LteMode::stepAttempt(const StepContext& now) {
  if (isReestablishing_) {
    isReestablishing_ = false;
    if (!isLteUsable(now.radio)) {
      endConnection(Cause::KLTE_RRC_CAUSE_REL_CONN_FAIL_T311_EXP, now);
      return;
    }
    camp(*now.radio.lte().front().cell, now);
  } else if (now.random.chance(kAccessFailure)) {
    endConnection(Cause::KLTE_RRC_CAUSE_EST_FAIL_NO_RESP_FROM_CELL, now);
    return;
  }
  changeState(State::KLTE_RRC_STATE_CONNECTED, establishmentCause_, now);
  callId_ = makeCallId(now.random);
  dueMs_ = now.nowMs + milliseconds(20, 45, now.random);
  auto drx = makeLteDrx(true, 3 + now.random.below(2));
  now.outbox.tell(drx);
  aggregation_.start(*serving_, now);
}

void LteMode::stepConnected(const StepContext& now, const LteSignal* signal) {
  now.registration.keepUp(area(), now.nowMs, now.outbox, now.random);
  aggregation_.step(now);

  const bool isWeak = signal == nullptr || signal->rsrp < kB2Level;
  if (eventB2_.hasHeld(isWeak && !isLteUsable(now.radio) && isUmtsUsable(now.radio), now.nowMs)) {
    aggregation_.end(now);
    changeState(State::KLTE_RRC_STATE_ATMPT_OUTBND_MOBILITY, Cause::KLTE_RRC_CAUSE_NA, now);
    return;
  }
  if (outOfSync_.hasHeld(signal == nullptr || signal->sinr < kOutOfSyncSinr, now.nowMs)) {
    failLink(Cause::KLTE_RRC_CAUSE_REEST_OTHER_FAIL_T310_EXP, now);
    return;
  }
  const LteCell* better = betterCell(now.radio, signal, kA3Margin);
  if (eventA3_.hasHeld(better != nullptr, now.nowMs) && better != nullptr) {
    handOver(*better, now);
  } else if (now.nowMs >= dueMs_) {
    changeState(State::KLTE_RRC_STATE_ENDING, Cause::KLTE_RRC_CAUSE_NA, now);
  }
}

std::optional<Departure> LteMode::leave(Cause cause, bool isHandover, const StepContext& now) {
  const bool toUmts = isUmtsUsable(now.radio);
  if (!toUmts && !isGsmUsable(now.radio)) {
    if (isHandover) endConnection(Cause::KLTE_RRC_CAUSE_REL_CONN_FAIL_CELL_NOT_SUIT, now);
    return std::nullopt;
  }
  changeState(State::KLTE_RRC_STATE_NULL, cause, now);
  return Departure{toUmts ? Technology::umts : Technology::gsm, isHandover && toUmts};
}

void LteMode::startConnection(Cause cause, const StepContext& now) {
  establishmentCause_ = cause;
  changeState(State::KLTE_RRC_STATE_ATMPT_CONNECTION, cause, now);
  dueMs_ = now.nowMs + 100 + now.random.below(100);
}

void LteMode::endConnection(Cause cause, const StepContext& now) {
  if (!callId_.empty()) aggregation_.end(now);
  callId_.clear();
  changeState(State::KLTE_RRC_STATE_IDLE, cause, now);
  dueMs_ = now.nowMs + milliseconds(6, 15, now.random);
  auto drx = makeLteDrx(false, 0);
  now.outbox.tell(drx);
}

void LteMode::handOver(const LteCell& target, const StepContext& now) {
  now.outbox.raiseTrigger(kHandoverTrigger);
  if (now.random.chance(kHandoverFailure)) {
    failLink(Cause::KLTE_RRC_CAUSE_REEST_HO_FAIL, now);
    return;
  }
  aggregation_.end(now);
  camp(target, now);
  aggregation_.start(target, now);
}

void LteMode::failLink(Cause cause, const StepContext& now) {
  aggregation_.end(now);
  now.outbox.tellRadioLinkFailure();
  isReestablishing_ = true;
  startConnection(cause, now);
}

void LteMode::changeState(State state, Cause cause, const StepContext& now) {
  KCellularLteRrcState report;
  report.setState(state);
  report.setPrevState(state_);
  report.setPrevStateDurMs(static_cast<std::uint32_t>(now.nowMs - stateSinceMs_));
  report.setCause(cause);
  now.outbox.tell(report);
  state_ = state;
  stateSinceMs_ = now.nowMs;
  outOfReach_.reset();
  eventB2_.reset();
  outOfSync_.reset();
}

void LteMode::camp(const LteCell& cell, const StepContext& now) {
  serving_ = &cell;
  samples_.clear();
  reselection_.reset();
  eventA3_.reset();
  auto info = makeLteCellInfo(cell);
  now.outbox.tell(info);
  auto selection = makeLteSelection(cell);
  now.outbox.tell(selection);
}

const LteCell* LteMode::betterCell(const Radio& radio, const LteSignal* signal, double margin) {
  for (const LteSignal& candidate : radio.lte()) {
    if (signal == nullptr) return candidate.rsrp > kLeastIdleLevel ? candidate.cell : nullptr;
    const double extra = candidate.cell->carrier == signal->cell->carrier ? 0 : kOtherFrequencyMargin;
    if (candidate.rsrp > signal->rsrp + margin + extra) return candidate.cell;
  }
  return nullptr;
}

void LteMode::report(const StepContext& now, const LteSignal& signal) {
  takeSample(now, signal);
  if (servingReport_.isDue(now.nowMs)) {
    auto serving = makeLteServing(signal, isConnected(), now.radio.secondChainGain());
    now.outbox.tell(serving);
  }
  if (isConnected() && powerReport_.isDue(now.nowMs)) {
    auto power = makeLteTxPower(signal, now.random);
    now.outbox.tell(power);
  }
  if (neighbourReport_.isDue(now.nowMs)) {
    auto neighbours = makeLteNeighbours(now.radio, *serving_);
    if (neighbours.measNbrEutrasCount() > 0) now.outbox.tell(neighbours);
  }
  if (otherTechnologyReport_.isDue(now.nowMs)) {
    auto others = makeLteOtherTechnologies(now.radio);
    now.outbox.tell(others);
  }
}

void LteMode::takeSample(const StepContext& now, const LteSignal& signal) {
  LteSample sample{signal.cell->pci, {}, {}, {}};
  for (std::size_t chain = 0; chain < 2; ++chain) {
    const double gain = (chain == 0 ? 0 : now.radio.secondChainGain()) + kSampleDeviation * now.random.normal();
    sample.rsrp[chain] = signal.rsrp + gain;
    sample.rsrq[chain] = signal.rsrq + 0.5 * now.random.normal();
    sample.sinr[chain] = signal.sinr + gain;
  }
  samples_.push_back(sample);
  if (samples_.size() < kSamplesOfReport) return;
  auto report = makeLteSamples(samples_, kSamplePeriodMs, callId_);
  now.outbox.tell(report);
  samples_.clear();
}

}  // namespace vesk::handset
