#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "insight/kpis.h"
#include "insight/step.h"

namespace vesk::insight {

/// "lte.rsrp < -110 for 10 s".
struct KpiRule {
  Kpi kpi;
  bool (*compare)(double value, double limit);
  double limit;
  /// Milliseconds for which it must have held.
  double duration;
};

/// "event no-service".
struct EventRule {
  EventKind kind;
};

struct Rule {
  /// As given.
  std::string text;
  std::variant<KpiRule, EventRule> condition;
};

/// Why a text is no rule.
struct RuleError {
  /// Where, counted from 1.
  std::size_t column;
  /// "expected a number, got \"x\"".
  std::string reason;
};

[[nodiscard]] std::variant<Rule, RuleError> parseRule(std::string_view text);

/// Judges rules at every step of the timeline.
class RuleJudge {
 public:
  void setRules(std::vector<Rule> rules);
  [[nodiscard]] bool empty() const { return rules_.empty(); }

  /// Adds an alert to the step for each rule that fires, in the order of the rules.
  void judge(const KnownKpis& kpis, Step& step);
  /// At a gap every rule starts anew.
  void forget();

  /// How often any rule fired.
  [[nodiscard]] std::uint64_t fired() const { return fired_; }

 private:
  struct Judged {
    Rule rule;
    /// Since when it has held; absent while it does not.
    std::optional<std::int64_t> since{};
    /// Whether that was told.
    bool isTold = false;
  };

  void judgeKpi(Judged& judged, const KpiRule& rule, const KnownKpis& kpis, Step& step);

  std::vector<Judged> rules_;
  std::uint64_t fired_ = 0;
};

}  // namespace vesk::insight
