#pragma once

#include <string>
#include <vector>

#include "handset/behaviour/carrier_aggregation.h"
#include "handset/behaviour/mode.h"
#include "handset/behaviour/timing.h"
#include "handset/reports/lte_reports.h"

namespace vesk::handset {

/// LTE: camps, connects for a while and lets go again, hands over (event A3), fails now and then, and leaves where
/// the level falls and another technology is better (event B2).
class LteMode final : public Mode {
 public:
  void enter(const StepContext& now, bool isHandover) override;
  [[nodiscard]] std::optional<Departure> step(const StepContext& now) override;

 private:
  using State = metrics::LteRrcState;
  using Cause = metrics::LteRrcCause;

  void changeState(State state, Cause cause, const StepContext& now);
  void camp(const LteCell& cell, const StepContext& now);
  [[nodiscard]] bool isConnected() const { return state_ == State::KLTE_RRC_STATE_CONNECTED; }
  [[nodiscard]] Area area() const { return {true, serving_->trackingAreaCode}; }

  [[nodiscard]] std::optional<Departure> stepIdle(const StepContext& now, const LteSignal* signal);
  void stepAttempt(const StepContext& now);
  void stepConnected(const StepContext& now, const LteSignal* signal);
  [[nodiscard]] std::optional<Departure> leave(Cause cause, bool isHandover, const StepContext& now);

  void startConnection(Cause cause, const StepContext& now);
  void endConnection(Cause cause, const StepContext& now);
  void handOver(const LteCell& target, const StepContext& now);
  void failLink(Cause cause, const StepContext& now);
  /// The cell that is better than `signal` by `margin` dB, and by 2 more on another frequency; null for none.
  [[nodiscard]] static const LteCell* betterCell(const Radio& radio, const LteSignal* signal, double margin);

  void report(const StepContext& now, const LteSignal& signal);
  void takeSample(const StepContext& now, const LteSignal& signal);

  const LteCell* serving_ = nullptr;
  State state_ = State::KLTE_RRC_STATE_NULL;
  std::int64_t stateSinceMs_ = 0;
  /// When the state ends by itself.
  std::int64_t dueMs_ = 0;
  Cause establishmentCause_ = Cause::KLTE_RRC_CAUSE_EST_MO_SIGNAL;
  bool isReestablishing_ = false;
  std::string callId_;
  CarrierAggregation aggregation_;

  TimeToTrigger reselection_{1000};
  TimeToTrigger outOfReach_{600};
  TimeToTrigger eventA3_{320};
  TimeToTrigger eventB2_{480};
  TimeToTrigger outOfSync_{1000};

  std::vector<LteSample> samples_;
  Periodic servingReport_{2000};
  Periodic powerReport_{1000};
  Periodic neighbourReport_{1000};
  Periodic otherTechnologyReport_{4000};
};

}  // namespace vesk::handset
