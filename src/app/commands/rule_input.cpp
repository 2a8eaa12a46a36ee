#include "app/commands/rule_input.h"

#include <cerrno>
#include <cstring>
#include <string_view>
#include <variant>

#include "app/output/outcome.h"
#include "system/file.h"
#include "values/utf8.h"

namespace vesk {

namespace {

constexpr std::string_view kBlanks = " \t\r";

/// Without the blanks at its ends.
std::string_view trimmed(std::string_view text) {
  const std::size_t first = text.find_first_not_of(kBlanks);
  if (first == std::string_view::npos) return {};
  return text.substr(first, text.find_last_not_of(kBlanks) - first + 1);
}

/// Gathers the rules, and tells the user of what is none.
class RuleReading {
 public:
  void takeOption(const std::string& text) {
    if (const auto error = take(text))
      tell("--rule \"" + text + "\", column " + std::to_string(error->column) + ": " + error->reason);
  }

  void takeFile(const std::string& path) {
    const std::optional<Data> content = readFile(path);
    if (!content) return tell(path + ": " + std::strerror(errno));
    const auto bytes = content->bytes();
    std::string_view rest(reinterpret_cast<const char*>(bytes.data()), bytes.size());
    rest.remove_prefix(byteOrderMarkSize(rest));
    for (std::size_t number = 1; !rest.empty(); ++number) {
      const std::string_view line = rest.substr(0, rest.find('\n'));
      rest.remove_prefix(std::min(line.size() + 1, rest.size()));
      takeLine(line, path + ":" + std::to_string(number));
    }
  }

  [[nodiscard]] std::optional<std::vector<insight::Rule>> finish() {
    return areSound_ ? std::optional(std::move(rules_)) : std::nullopt;
  }

 private:
  void takeLine(std::string_view line, const std::string& place) {
    const std::string_view rule = trimmed(line.substr(0, line.find('#')));
    if (rule.empty()) return;
    const auto error = take(rule);
    if (!error) return;
    const auto indent = static_cast<std::size_t>(rule.data() - line.data());
    tell(place + ":" + std::to_string(indent + error->column) + ": " + error->reason);
  }

  std::optional<insight::RuleError> take(std::string_view text) {
    auto parsed = insight::parseRule(text);
    if (const auto* error = std::get_if<insight::RuleError>(&parsed)) return *error;
    rules_.push_back(std::get<insight::Rule>(std::move(parsed)));
    return std::nullopt;
  }

  void tell(const std::string& reason) {
    tellUser("vesk: " + reason);
    areSound_ = false;
  }

  std::vector<insight::Rule> rules_;
  bool areSound_ = true;
};

}  // namespace

std::optional<std::vector<insight::Rule>> readRules(const RuleInput& input) {
  RuleReading reading;
  for (const std::string& rule : input.rules)
    reading.takeOption(rule);
  if (input.file) reading.takeFile(*input.file);
  return reading.finish();
}

}  // namespace vesk
