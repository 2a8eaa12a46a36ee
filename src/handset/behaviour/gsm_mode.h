#pragma once

#include "handset/behaviour/mode.h"
#include "handset/behaviour/timing.h"

namespace vesk::handset {

/// GSM, where nothing else reaches: camps, makes a call now and then, and goes up to UMTS or LTE between calls as soon
/// as one is usable.
class GsmMode final : public Mode {
 public:
  void enter(const StepContext& now, bool isHandover) override;
  [[nodiscard]] std::optional<Departure> step(const StepContext& now) override;

 private:
  void camp(const GsmCell& cell, const StepContext& now);
  void setDedicated(bool isDedicated, const StepContext& now);
  void considerOtherCells(const StepContext& now, const GsmSignal* signal);
  void report(const StepContext& now, const GsmSignal& signal);
  [[nodiscard]] Area area() const { return {false, serving_->locationAreaCode}; }

  const GsmCell* serving_ = nullptr;
  bool isDedicated_ = false;
  /// When the call, or the time without one, ends.
  std::int64_t dueMs_ = 0;

  TimeToTrigger betterCell_{1500};
  TimeToTrigger lteIsBack_{2000};
  TimeToTrigger umtsIsBack_{2000};

  Periodic servingReport_{960};
  Periodic neighbourReport_{2000};
};

}  // namespace vesk::handset
