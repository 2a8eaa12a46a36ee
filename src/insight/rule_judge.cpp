#include "insight/rules.h"

namespace vesk::insight {

void RuleJudge::setRules(std::vector<Rule> rules) {
  rules_.clear();
  for (Rule& rule : rules)
    rules_.push_back({std::move(rule)});
}

void RuleJudge::judge(const KnownKpis& kpis, const Moment& moment, std::vector<TimelineEvent>& events) {
  const std::size_t happened = events.size();
  Step alerts(moment, events);
  for (Judged& judged : rules_) {
    if (const auto* rule = std::get_if<KpiRule>(&judged.rule.condition)) {
      judgeKpi(judged, *rule, kpis, alerts);
      continue;
    }
    const EventKind kind = std::get<EventRule>(judged.rule.condition).kind;
    for (std::size_t index = 0; index < happened; ++index) {
      if (events[index].kind != kind) continue;
      ++fired_;
      alerts.add(EventKind::alert, Alert{judged.rule.text, moment.time, std::nullopt});
    }
  }
}

void RuleJudge::judgeKpi(Judged& judged, const KpiRule& rule, const KnownKpis& kpis, Step& alerts) {
  const auto value = kpis.at(rule.kpi, alerts.now());
  if (!value || !rule.compare(*value, rule.limit)) {
    judged.since.reset();
    judged.isTold = false;
    return;
  }
  if (!judged.since) judged.since = alerts.now();
  if (judged.isTold || static_cast<double>(alerts.now() - *judged.since) < rule.duration) return;
  judged.isTold = true;
  ++fired_;
  alerts.add(EventKind::alert, Alert{judged.rule.text, *judged.since, value});
}

void RuleJudge::forget() {
  for (Judged& judged : rules_) {
    judged.since.reset();
    judged.isTold = false;
  }
}

}  // namespace vesk::insight
