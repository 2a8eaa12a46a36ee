#pragma once

#include <optional>

#include "handset/behaviour/mode.h"
#include "handset/behaviour/timing.h"
#include "messages/wcdma/wcdma.h"

namespace vesk::handset {

/// UMTS, where LTE does not reach: registers, moves data now and then, and goes back to LTE as soon as that is
/// usable, or on to GSM where UMTS ends too.
class UmtsMode final : public Mode {
 public:
  void enter(const StepContext& now, bool isHandover) override;
  [[nodiscard]] std::optional<Departure> step(const StepContext& now) override;

 private:
  using State = metrics::WcdmaRrcConnState;
  using Establishment = metrics::RrcEstablishmentCause;
  using Release = metrics::RrcReleaseCause;

  void changeState(State state, const StepContext& now, std::optional<Establishment> establishment = std::nullopt,
                   std::optional<Release> release = std::nullopt);
  void camp(const UmtsCell& cell, const StepContext& now);
  [[nodiscard]] bool isConnected() const;
  [[nodiscard]] Area area() const { return {false, serving_->locationAreaCode}; }

  [[nodiscard]] std::optional<Departure> considerLeaving(const StepContext& now, const UmtsSignal* signal);
  void considerOtherCells(const StepContext& now, const UmtsSignal* signal);
  void stepConnection(const StepContext& now);
  void report(const StepContext& now, const UmtsSignal& signal);

  const UmtsCell* serving_ = nullptr;
  State state_ = State::KWCDMA_RRC_CONN_STATE_INVALID;
  /// When the state ends by itself.
  std::int64_t dueMs_ = 0;

  TimeToTrigger betterCell_{640};
  TimeToTrigger lteIsBack_{2000};
  TimeToTrigger outOfReach_{600};

  Periodic servingReport_{1000};
  Periodic powerReport_{1000};
  Periodic neighbourReport_{2000};
};

}  // namespace vesk::handset
