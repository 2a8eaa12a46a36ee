#include "insight/rules.h"

namespace vesk::insight {

void RuleJudge::setRules(std::vector<Rule> rules) {
  rules_.clear();
  for (Rule& rule : rules)
    rules_.push_back({std::move(rule)});
}

void RuleJudge::judge(const KnownKpis& kpis, Step& step) {
  const std::size_t happened = step.size();
  for (Judged& judged : rules_) {
    if (const auto* rule = std::get_if<KpiRule>(&judged.rule.condition)) {
      judgeKpi(judged, *rule, kpis, step);
      continue;
    }
    const EventKind kind = std::get<EventRule>(judged.rule.condition).kind;
    for (std::size_t index = 0; index < happened; ++index) {
      if (step[index].kind != kind) continue;
      ++fired_;
      step.add(EventKind::alert, Alert{judged.rule.text, step.now(), std::nullopt});
    }
  }
}

void RuleJudge::judgeKpi(Judged& judged, const KpiRule& rule, const KnownKpis& kpis, Step& step) {
  const auto value = kpis.at(rule.kpi, step.now());
  if (!value || !rule.compare(*value, rule.limit)) {
    judged.since.reset();
    judged.isTold = false;
    return;
  }
  if (!judged.since) judged.since = step.now();
  if (judged.isTold || static_cast<double>(step.now() - *judged.since) < rule.duration) return;
  judged.isTold = true;
  ++fired_;
  step.add(EventKind::alert, Alert{judged.rule.text, *judged.since, value});
}

void RuleJudge::forget() {
  for (Judged& judged : rules_) {
    judged.since.reset();
    judged.isTold = false;
  }
}

}  // namespace vesk::insight
