#include <algorithm>
#include <array>
#include <charconv>

#include "insight/rules.h"

namespace vesk::insight {

namespace {

using Compare = bool (*)(double, double);

struct Operator {
  std::string_view sign;
  Compare compare;
};

/// Those of two characters first: none is taken for its begin.
constexpr std::array<Operator, 6> kOperators{{
    {"<=", [](double value, double limit) { return value <= limit; }},
    {">=", [](double value, double limit) { return value >= limit; }},
    {"==", [](double value, double limit) { return value == limit; }},
    {"!=", [](double value, double limit) { return value != limit; }},
    {"<", [](double value, double limit) { return value < limit; }},
    {">", [](double value, double limit) { return value > limit; }},
}};

struct Unit {
  std::string_view name;
  double milliseconds;
};

constexpr std::array<Unit, 3> kUnits{{{"ms", 1}, {"s", 1000}, {"min", 60'000}}};

constexpr bool isBlank(char character) {
  return character == ' ' || character == '\t';
}
constexpr bool isDigit(char character) {
  return character >= '0' && character <= '9';
}
/// What ends neither a KPI nor a kind of event nor a unit.
constexpr bool isOfWord(char character) {
  return isDigit(character) || (character >= 'a' && character <= 'z') || (character >= 'A' && character <= 'Z') ||
         character == '.' || character == '_' || character == '-';
}

/// Reads a rule from left to right; the first thing that is not as expected is its error.
class RuleParser {
 public:
  explicit RuleParser(std::string_view text) : text_(text) {}

  std::variant<Rule, RuleError> parse() {
    skipBlanks();
    const std::string_view subject = word();
    const bool isRead = subject == "event" ? readEvent() : readKpi(subject);
    skipBlanks();
    if (isRead && place_ != text_.size()) fail(place_, isEvent() ? "the end" : "for, or the end");
    if (error_) return *error_;
    return Rule{std::string(text_), *condition_};
  }

 private:
  [[nodiscard]] bool isEvent() const { return std::holds_alternative<EventRule>(*condition_); }

  bool readEvent() {
    skipBlanks();
    const std::size_t start = place_;
    const auto kind = eventKindNamed(word());
    if (!kind || *kind == EventKind::alert) return fail(start, "a kind of event, such as handover or no-service");
    condition_ = EventRule{*kind};
    return true;
  }

  bool readKpi(std::string_view name) {
    const auto* kpi = std::find_if(kKpis.begin(), kKpis.end(), [&](const auto& each) { return each.name == name; });
    if (kpi == kKpis.end()) return fail(static_cast<std::size_t>(name.data() - text_.data()), subjects());
    skipBlanks();
    const auto* sign = std::find_if(kOperators.begin(), kOperators.end(), [this](const Operator& each) {
      return text_.substr(place_).starts_with(each.sign);
    });
    if (sign == kOperators.end()) return fail(place_, "<, <=, >, >=, == or !=");
    place_ += sign->sign.size();
    const auto limit = number();
    if (!limit) return false;
    KpiRule rule{kpi->kpi, sign->compare, *limit, 0};
    if (!readDuration(rule)) return false;
    condition_ = rule;
    return true;
  }

  /// What may follow the limit.
  bool readDuration(KpiRule& rule) {
    const std::size_t afterLimit = place_;
    skipBlanks();
    const std::size_t start = place_;
    if (place_ == text_.size()) return true;
    if (start == afterLimit || word() != "for") return fail(start, "for, or the end");
    if (place_ < text_.size() && !isBlank(text_[place_])) return fail(place_, "a blank");
    const auto count = number();
    if (!count) return false;
    skipBlanks();
    const std::size_t unitStart = place_;
    const std::string_view name = word();
    const auto* unit = std::find_if(kUnits.begin(), kUnits.end(), [&](const Unit& each) { return each.name == name; });
    if (unit == kUnits.end()) return fail(unitStart, "ms, s or min");
    rule.duration = *count * unit->milliseconds;
    return true;
  }

  /// Decimal, with an optional sign and fraction; absent, and an error, for anything else.
  std::optional<double> number() {
    skipBlanks();
    const std::size_t start = place_;
    const bool isPositive = place_ < text_.size() && text_[place_] == '+';
    if (place_ < text_.size() && (isPositive || text_[place_] == '-')) ++place_;
    bool isNumber = skipDigits();
    if (isNumber && place_ < text_.size() && text_[place_] == '.') {
      ++place_;
      isNumber = skipDigits();
    }
    double value = 0;
    const char* const begin = text_.data() + start + (isPositive ? 1 : 0);
    if (isNumber) isNumber = std::from_chars(begin, text_.data() + place_, value).ec == std::errc{};
    if (isNumber) return value;
    place_ = start;
    fail(start, "a number");
    return std::nullopt;
  }

  bool skipDigits() {
    const std::size_t start = place_;
    while (place_ < text_.size() && isDigit(text_[place_]))
      ++place_;
    return place_ > start;
  }

  void skipBlanks() {
    while (place_ < text_.size() && isBlank(text_[place_]))
      ++place_;
  }

  std::string_view word() {
    const std::size_t start = place_;
    while (place_ < text_.size() && isOfWord(text_[place_]))
      ++place_;
    return text_.substr(start, place_ - start);
  }

  /// Always false. What is there instead goes up to the next blank.
  bool fail(std::size_t place, const std::string& expected) {
    const std::string_view rest = text_.substr(place);
    const std::string_view found = rest.substr(0, rest.find_first_of(" \t"));
    if (!error_)
      error_ = {place + 1, "expected " + expected + ", got " + (found.empty() ? "nothing" : std::string(found))};
    return false;
  }

  static std::string subjects() {
    std::string out = "event, or one of";
    for (const KpiDescription& each : kKpis)
      out += (each.kpi == kKpis.front().kpi ? " " : ", ") + std::string(each.name);
    return out;
  }

  std::string_view text_;
  std::size_t place_ = 0;
  std::optional<std::variant<KpiRule, EventRule>> condition_;
  std::optional<RuleError> error_;
};

}  // namespace

std::variant<Rule, RuleError> parseRule(std::string_view text) {
  return RuleParser(text).parse();
}

}  // namespace vesk::insight
