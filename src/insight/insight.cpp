#include "insight/insight.h"

namespace vesk::insight {

void Insight::observeEventsOf(MetricValidator& intake) {
  intake.setEventObserver([this, &intake](const TakenEvent& event) { observe(event, intake.stores); });
}

void Insight::startAnew() {
  static_cast<Present&>(*this) = {};
  summary_ = {};
  judge_.forget();
}

void Insight::observe(const TakenEvent& event, const Stores& stores) {
  const std::uint64_t number = counts_.all++;
  switch (event.fate) {
    case EventFate::stored:
      ++counts_.stored;
      take(event, stores, number);
      break;
    case EventFate::undecodable:
      ++counts_.undecodable;
      break;
    case EventFate::ignored:
      ++counts_.ignored;
      break;
  }
}

void Insight::take(const TakenEvent& event, const Stores& stores, std::uint64_t number) {
  const std::int64_t before = time();
  const auto passing = clock_.take(event.timestamp);
  if (!passing) {
    ++counts_.untimed;
    return;
  }
  later_ = 0;
  if (passing->passed > 0) summary_.pass(passing->passed, before, timeline_);
  const Moment moment{time(), number, clock_.counted()};
  Step step(moment, happenings_);
  if (passing->gap) {
    summary_.takeGap(*passing->gap);
    timeline_.forget();
    details_.forget();
    heard_.forget();
    judge_.forget();
    step.add(EventKind::gap, *passing->gap);
  }
  const Report& report = reader_.read(*event.metricId, *event.record, stores);
  timeline_.take(report, step);
  details_.take(report, timeline_.mobility(), moment.time);
  heard_.take(report, timeline_, moment.time);
  if (!judge_.empty()) judge_.judge(timeline_.kpis(), step);
  summary_.take(report, step, timeline_);
  trend_.take(report.kpis, moment);
  if (onStep_) onStep_(report, step);
  if (!step.empty()) forgetOldHappenings();
}

}  // namespace vesk::insight
