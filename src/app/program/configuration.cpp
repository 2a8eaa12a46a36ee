#include "app/program/configuration.h"

#include <algorithm>
#include <array>
#include <cstdlib>
#include <filesystem>
#include <string_view>
#include <utility>
#include <variant>

#define TOML_EXCEPTIONS 0
#include <toml++/toml.h>

#include "app/output/outcome.h"
#include "screens/vesk_view_items.h"

namespace vesk {

namespace {

constexpr std::array kViews{
    std::pair{std::string_view("overview"), Action::Overview}, std::pair{std::string_view("trend"), Action::Trend},
    std::pair{std::string_view("timeline"), Action::Timeline}, std::pair{std::string_view("cells"), Action::Cells}};

/// "LTE" or "LTE/RRC State"; absent when the menu has no such screen.
std::optional<StartView> screenNamed(std::string_view path) {
  const std::size_t slash = path.find('/');
  StartView start{std::nullopt, std::string(path.substr(0, slash)), {}};
  const std::vector<Text>& categories = VeskViewItems::shared().categoriesOf(start.area);
  if (categories.empty()) return std::nullopt;
  if (slash == std::string_view::npos) return start;
  start.category = path.substr(slash + 1);
  const bool isThere = std::any_of(categories.begin(), categories.end(),
                                   [&](const Text& each) { return each.view() == start.category; });
  return isThere ? std::optional(start) : std::nullopt;
}

/// Gathers what a file says, and tells the user of what it may not say.
class Reading {
 public:
  explicit Reading(const std::string& path) : path_(path) {}

  std::optional<Configuration> read() {
    take();
    std::stable_sort(mistakes_.begin(), mistakes_.end(),
                     [](const Mistake& one, const Mistake& other) { return one.line < other.line; });
    for (const Mistake& each : mistakes_)
      tellUser("vesk: " + path_ + ":" + std::to_string(each.line) + ": " + each.reason);
    return mistakes_.empty() ? std::optional(std::move(configuration_)) : std::nullopt;
  }

 private:
  struct Mistake {
    toml::source_index line;
    std::string reason;
  };
  struct Key {
    std::string_view name;
    void (Reading::*take)(const toml::node& value);
  };
  static const std::array<Key, 4> kKeys;

  void take() {
    const toml::parse_result parsed = toml::parse_file(path_);
    if (!parsed) return tell(parsed.error().source().begin.line, std::string(parsed.error().description()));
    for (const auto& [key, value] : parsed.table()) {
      const auto* known =
          std::find_if(kKeys.begin(), kKeys.end(), [name = key.str()](const Key& each) { return each.name == name; });
      if (known != kKeys.end()) {
        (this->*known->take)(value);
      } else {
        tell(key.source().begin.line,
             "unknown key " + std::string(key.str()) + ": expected start, signs, rules or [colors]");
      }
    }
  }

  void takeStart(const toml::node& value) {
    const std::string_view name = value.value_or(std::string_view());
    if (name == "menu") return;
    if (const auto* view =
            std::find_if(kViews.begin(), kViews.end(), [&](const auto& each) { return each.first == name; });
        view != kViews.end()) {
      configuration_.start.action = view->second;
    } else if (auto screen = screenNamed(name)) {
      configuration_.start = *std::move(screen);
    } else {
      tell(value,
           "start: expected \"menu\", \"overview\", \"trend\", \"timeline\", \"cells\", an area, or an area "
           "and a category as \"LTE/RRC State\"");
    }
  }

  void takeSigns(const toml::node& value) {
    configuration_.appearance.signs = signsNamed(value.value_or(std::string_view()));
    if (!configuration_.appearance.signs) tell(value, "signs: expected \"braille\", \"block\" or \"ascii\"");
  }

  void takeRules(const toml::node& value) {
    const toml::array* rules = value.as_array();
    if (rules == nullptr) return tell(value, "rules: expected a list of texts");
    for (const toml::node& each : *rules) {
      const auto text = each.value<std::string_view>();
      if (!text || !each.is_string()) {
        tell(each, "rules: expected a text");
        continue;
      }
      auto rule = insight::parseRule(*text);
      if (const auto* error = std::get_if<insight::RuleError>(&rule)) {
        tell(each,
             "rule \"" + std::string(*text) + "\", column " + std::to_string(error->column) + ": " + error->reason);
      } else {
        configuration_.rules.push_back(std::get<insight::Rule>(std::move(rule)));
      }
    }
  }

  void takeColors(const toml::node& value) {
    const toml::table* colors = value.as_table();
    if (colors == nullptr) return tell(value, "colors: expected a table of looks");
    for (const auto& [key, look] : *colors) {
      const auto role = roleNamed(key.str());
      if (!role) {
        tell(key.source().begin.line, "unknown key colors." + std::string(key.str()) + ": expected " + roleNames());
        continue;
      }
      const auto parsed = parseLook(look.value_or(std::string_view()));
      if (parsed) {
        configuration_.appearance.looks.emplace_back(*role, *parsed);
      } else {
        tell(look, std::string(key.str()) +
                       ": expected words such as \"bold white on blue\": bold, reverse, underline, plain, and colours "
                       "black red green yellow blue magenta cyan white or 0 to 255");
      }
    }
  }

  void tell(const toml::node& place, std::string reason) { tell(place.source().begin.line, std::move(reason)); }
  void tell(toml::source_index line, std::string reason) { mistakes_.push_back({line, std::move(reason)}); }

  const std::string& path_;
  Configuration configuration_;
  std::vector<Mistake> mistakes_;
};

const std::array<Reading::Key, 4> Reading::kKeys{Key{"start", &Reading::takeStart}, Key{"signs", &Reading::takeSigns},
                                                 Key{"rules", &Reading::takeRules},
                                                 Key{"colors", &Reading::takeColors}};

}  // namespace

std::string configurationPath() {
  const char* configured = std::getenv("XDG_CONFIG_HOME");
  const char* home = std::getenv("HOME");
  // A relative path is to be passed over.
  if (configured != nullptr && *configured == '/') return std::string(configured) + "/vesk/config.toml";
  return home != nullptr && *home != '\0' ? std::string(home) + "/.config/vesk/config.toml" : std::string();
}

std::optional<Configuration> readConfiguration(const std::string& path) {
  std::error_code error;
  if (path.empty() || !std::filesystem::exists(path, error)) return Configuration{};
  return Reading(path).read();
}

}  // namespace vesk
