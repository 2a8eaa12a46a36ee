#include "handset/behaviour/umts_mode.h"

#include "handset/reports/umts_reports.h"

namespace vesk::handset {

using namespace metrics;

namespace {

/// dBm: below this the handset seeks another technology.
constexpr double kUmtsLeastLevel = -110;
/// dB.
constexpr double kUmtsCellMargin = 3;

}  // namespace

bool UmtsMode::isConnected() const {
  return state_ == State::KWCDMA_RRC_CONN_STATE_CELL_DCH || state_ == State::KWCDMA_RRC_CONN_STATE_CELL_FACH;
}

void UmtsMode::enter(const Surroundings& now, bool isHandover) {
  camp(*now.radio.umts().front().cell, now);
  if (isHandover) {
    changeState(State::KWCDMA_RRC_CONN_STATE_CELL_DCH, now);
    dueMs_ = now.nowMs + 5000;
  } else {
    changeState(State::KWCDMA_RRC_CONN_STATE_IDLE, now);
    dueMs_ = now.nowMs + 500;
  }
}

std::optional<Departure> UmtsMode::step(const Surroundings& now) {
  const UmtsSignal* signal = now.radio.of(serving_);
  if (signal != nullptr) report(now, *signal);
  if (const auto departure = considerLeaving(now, signal)) return departure;
  considerOtherCells(now, signal);
  if (isConnected()) now.registration.keepUp(area(), now.nowMs, now.outbox, now.random);
  if (now.nowMs >= dueMs_) stepConnection(now);
  return std::nullopt;
}

std::optional<Departure> UmtsMode::considerLeaving(const Surroundings& now, const UmtsSignal* signal) {
  if (lteIsBack_.hasHeld(isLteUsable(now.radio), now.nowMs)) {
    const bool isHandover = state_ == State::KWCDMA_RRC_CONN_STATE_CELL_DCH;
    changeState(State::KWCDMA_RRC_CONN_STATE_INACTIVE, now, std::nullopt, Release::KRRC_REL_CELL_CHANGED);
    return Departure{Technology::lte, isHandover};
  }
  const bool isLost = (signal == nullptr || signal->rscp < kUmtsLeastLevel) && !isUmtsUsable(now.radio);
  if (outOfReach_.hasHeld(isLost && isGsmUsable(now.radio), now.nowMs)) {
    changeState(State::KWCDMA_RRC_CONN_STATE_INACTIVE, now, std::nullopt,
                isConnected() ? Release::KRRC_REL_RELEASE_OOSA : Release::KRRC_REL_NO_CELL);
    return Departure{Technology::gsm};
  }
  return std::nullopt;
}

void UmtsMode::considerOtherCells(const Surroundings& now, const UmtsSignal* signal) {
  const auto& heard = now.radio.umts();
  const bool isBetter = !heard.empty() && (signal == nullptr || heard.front().rscp > signal->rscp + kUmtsCellMargin);
  if (betterCell_.hasHeld(isBetter, now.nowMs)) camp(*heard.front().cell, now);
}

/// Registers or moves data on a dedicated channel, then on the common ones, then lets go.
void UmtsMode::stepConnection(const Surroundings& now) {
  switch (state_) {
    case State::KWCDMA_RRC_CONN_STATE_ESTABLISH:
      changeState(State::KWCDMA_RRC_CONN_STATE_CELL_DCH, now);
      dueMs_ = now.nowMs + 4000 + now.random.below(6000);
      return;
    case State::KWCDMA_RRC_CONN_STATE_CELL_DCH:
      changeState(State::KWCDMA_RRC_CONN_STATE_CELL_FACH, now);
      dueMs_ = now.nowMs + 2500;
      return;
    case State::KWCDMA_RRC_CONN_STATE_CELL_FACH:
      changeState(State::KWCDMA_RRC_CONN_STATE_RELEASE, now, std::nullopt, Release::KRRC_REL_NORMAL_EVENT);
      dueMs_ = now.nowMs + 200;
      return;
    case State::KWCDMA_RRC_CONN_STATE_RELEASE:
      changeState(State::KWCDMA_RRC_CONN_STATE_IDLE, now);
      dueMs_ = now.nowMs + 4000 + now.random.below(4000);
      return;
    default:
      changeState(State::KWCDMA_RRC_CONN_STATE_ESTABLISH, now,
                  now.registration.isRegisteredIn(area()) ? Establishment::KRRC_EST_ORIG_INTERACT_CALL
                                                          : Establishment::KRRC_EST_REGISTRATION);
      dueMs_ = now.nowMs + 300;
  }
}

void UmtsMode::changeState(State state, const Surroundings& now, std::optional<Establishment> establishment,
                           std::optional<Release> release) {
  const bool wasConnected = isConnected();
  state_ = state;
  KCellularWcdmaRrcConnectionState report;
  report.setState(state);
  if (establishment) report.setEstablishmentCause(*establishment);
  if (release) report.setReleaseCause(*release);
  now.outbox.tell(report);
  if (isConnected() != wasConnected || state == State::KWCDMA_RRC_CONN_STATE_IDLE) {
    auto configuration = makeUmtsConfiguration(isConnected());
    now.outbox.tell(configuration);
  }
}

void UmtsMode::camp(const UmtsCell& cell, const Surroundings& now) {
  serving_ = &cell;
  betterCell_.reset();
  auto info = makeUmtsCellInfo(cell);
  now.outbox.tell(info);
  auto selection = makeUmtsSelection(now.radio, *now.radio.of(&cell));
  now.outbox.tell(selection);
}

void UmtsMode::report(const Surroundings& now, const UmtsSignal& signal) {
  if (servingReport_.isDue(now.nowMs)) {
    auto serving = makeUmtsServing(signal, isConnected());
    now.outbox.tell(serving);
  }
  if (isConnected() && powerReport_.isDue(now.nowMs)) {
    auto power = makeUmtsTxPower(signal, now.random);
    now.outbox.tell(power);
  }
  if (neighbourReport_.isDue(now.nowMs)) {
    auto neighbours = makeUmtsNeighbours(now.radio, *serving_);
    now.outbox.tell(neighbours);
  }
}

}  // namespace vesk::handset
