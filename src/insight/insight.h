#pragma once

#include <cstddef>
#include <cstdint>
#include <deque>
#include <functional>
#include <optional>
#include <vector>

#include "insight/drive_clock.h"
#include "insight/heard_cells.h"
#include "insight/report_reader.h"
#include "insight/rules.h"
#include "insight/summary.h"
#include "insight/timeline.h"
#include "insight/trend.h"
#include "intake/metric_validator.h"

/// What the numbers mean and what happened. Main interface to the room: start here.
namespace vesk::insight {

/// Observes a drive's metric events one by one and knows what they come to: what holds now, what happened, and how the
/// whole drive was. Its time is that of the events; its memory stays bounded however long the drive is. Main queue
/// only.
class Insight {
 public:
  /// An event with where it lies in the drive's counted time, without its gaps: milliseconds.
  struct Happening {
    TimelineEvent event;
    std::int64_t position;
  };

  using StepHandler = std::function<void(const Report& report, const std::vector<TimelineEvent>& events)>;

  /// Takes an event that the intake has just taken into `stores`.
  void observe(const TakenEvent& event, const Stores& stores);
  /// Has `intake` tell it every event, for as long as both live.
  void observeEventsOf(MetricValidator& intake);

  /// Forgets the whole drive, so that another one, or the same once more, can be followed. Rules and handler stay.
  void startAnew();

  /// Rules to judge from the next event on.
  void setRules(std::vector<Rule> rules) { judge_.setRules(std::move(rules)); }
  /// Called after every event that takes part, with what it reported and what happened, often nothing.
  void setStepHandler(StepHandler handler) { onStep_ = std::move(handler); }

  /// The drive's time: milliseconds since 1970-01-01 00:00:00 UTC; absent before the first event with a time.
  [[nodiscard]] std::optional<std::int64_t> now() const { return clock_.now(); }
  [[nodiscard]] const DriveClock& clock() const { return clock_; }
  [[nodiscard]] const EventCounts& counts() const { return counts_; }

  /// What is known now: technology, serving cell, area, connection, registration, carriers, bearers, C-DRX.
  [[nodiscard]] const Timeline& timeline() const { return timeline_; }
  /// The value of a KPI while it is known, and its age in milliseconds.
  [[nodiscard]] std::optional<double> value(Kpi kpi) const { return timeline_.kpis().at(kpi, time()); }
  [[nodiscard]] std::optional<std::int64_t> age(Kpi kpi) const { return timeline_.kpis().age(kpi, time()); }
  [[nodiscard]] std::vector<HeardCell> cellsHeard() const { return heard_.cells(timeline_, time()); }

  /// The last events, oldest first.
  [[nodiscard]] const std::deque<Happening>& happenings() const { return happenings_; }
  [[nodiscard]] const Trend& trend() const { return trend_; }
  [[nodiscard]] const Summary& summary() const { return summary_; }
  /// How often any rule fired.
  [[nodiscard]] std::uint64_t alerts() const { return judge_.fired(); }

 private:
  static constexpr std::size_t kMostHappenings = 2000;

  [[nodiscard]] std::int64_t time() const { return clock_.now().value_or(0); }
  void take(const TakenEvent& event, const Stores& stores, std::uint64_t number);
  void keep(const std::vector<TimelineEvent>& events);

  DriveClock clock_;
  EventCounts counts_;
  ReportReader reader_;
  Timeline timeline_;
  HeardCells heard_;
  Summary summary_;
  RuleJudge judge_;
  Trend trend_;
  std::deque<Happening> happenings_;
  /// Of the step under way; kept for its storage.
  std::vector<TimelineEvent> events_;
  StepHandler onStep_;
};

}  // namespace vesk::insight
