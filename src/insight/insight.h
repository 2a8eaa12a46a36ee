#pragma once

#include <cstdint>
#include <functional>
#include <vector>

#include "insight/present.h"
#include "insight/report_reader.h"
#include "insight/rules.h"
#include "insight/summary.h"
#include "intake/metric_validator.h"

/// What the numbers mean and what happened. Main interface to the room: start here.
namespace vesk::insight {

/// Observes a drive's metric events one by one and knows what they come to: what holds now, what happened, and how the
/// whole drive was. Its time is that of the events; its memory stays bounded however long the drive is. Main queue
/// only.
class Insight : public Present {
 public:
  using StepHandler = std::function<void(const Report& report, const Step& step)>;

  /// Takes an event that the intake has just taken into `stores`.
  void observe(const TakenEvent& event, const Stores& stores);
  /// Has `intake` tell it every event, for as long as both live.
  void observeEventsOf(MetricValidator& intake);

  /// Forgets the whole drive, so that another one, or the same once more, can be followed. Rules and handler stay.
  void startAnew();

  /// Rules to judge from the next event on.
  void setRules(std::vector<Rule> rules) { judge_.setRules(std::move(rules)); }
  /// Called after every event that takes part, with what it reported and what happened, often nothing. happenings()
  /// then has the step, too.
  void setStepHandler(StepHandler handler) { onStep_ = std::move(handler); }

  [[nodiscard]] const Summary& summary() const { return summary_; }
  /// How often any rule fired.
  [[nodiscard]] std::uint64_t alerts() const { return judge_.fired(); }

 private:
  void take(const TakenEvent& event, const Stores& stores, std::uint64_t number);

  ReportReader reader_;
  Summary summary_;
  RuleJudge judge_;
  StepHandler onStep_;
};

}  // namespace vesk::insight
