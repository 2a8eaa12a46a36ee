#include "app/commands/show_command.h"

#include <algorithm>
#include <string>
#include <string_view>
#include <vector>

#include "app/commands/suggestion.h"
#include "app/output/data_output.h"
#include "app/output/word_list.h"
#include "app/source/play_recording.h"
#include "intake/metric_validator.h"
#include "screens/category_sources.h"
#include "screens/vesk_view_items.h"
#include "terminal/device/column_width.h"
#include "toolkit/interface_layout.h"
#include "toolkit/walk.h"
#include "values/json_form.h"
#include "values/visible_text.h"

namespace vesk {

namespace {

/// Opens the screen behind the label. No row has an unknown label: a cell that stands alone leads on from there.
void openLabel(const NavigationController& root, std::string_view label) {
  if (openRow(root, label)) return;
  TableViewController& screen = topTable(root);
  TableViewCell cell(""_text, CellStyle::Basic, CellAccessory::None);
  cell.setMainText(Text::copy(label));
  screen.performTransition(screen.interfaceLayout()->firstTransition(screen.nameInLayout())->identifier, &cell);
}

void appendJsonOrNull(std::string& out, const std::optional<Text>& text) {
  if (text) {
    appendJson(out, text->view());
  } else {
    out += "null";
  }
}

std::string asJson(const ShowOptions& options, const std::vector<ShownSection>& sections) {
  std::string out = "{\"area\":";
  appendJson(out, std::string_view(options.area));
  out += ",\"category\":";
  appendJson(out, std::string_view(options.category));
  out += ",\"sections\":[";
  std::string_view sectionSeparator;
  for (const ShownSection& section : sections) {
    out += sectionSeparator;
    sectionSeparator = ",";
    out += "{\"header\":";
    appendJsonOrNull(out, section.header);
    out += ",\"rows\":[";
    std::string_view rowSeparator;
    for (const auto& [key, value] : section.rows) {
      out += rowSeparator;
      rowSeparator = ",";
      out += "{\"key\":";
      appendJsonOrNull(out, key);
      out += ",\"value\":";
      appendJsonOrNull(out, value);
      out += '}';
    }
    out += "]}";
  }
  out += "]}";
  return out;
}

/// Field names come from the schema: one column a byte.
std::size_t widestKey(const std::vector<ShownSection>& sections) {
  std::size_t widest = 0;
  for (const ShownSection& section : sections) {
    for (const ShownRow& row : section.rows)
      widest = std::max(widest, row.key ? row.key->view().size() : 0);
  }
  return widest;
}

/// Appends the value's lines, the first one where it stands and the others under it.
void appendValue(std::string& out, std::string_view value, std::size_t column) {
  for (;;) {
    const std::size_t lineFeed = value.find('\n');
    appendVisible(out, value.substr(0, lineFeed));
    out += '\n';
    if (lineFeed == std::string_view::npos) return;
    value.remove_prefix(lineFeed + 1);
    out.append(column, ' ');
  }
}

std::string asText(const ShowOptions& options, const std::vector<ShownSection>& sections) {
  constexpr std::string_view kIndentation = "  ";
  constexpr std::size_t kGap = 2;
  const std::size_t keyWidth = widestKey(sections);
  std::string out;
  appendVisible(out, options.area);
  out += setUpCharacterLocale() ? " › " : " > ";
  appendVisible(out, options.category);
  out += '\n';
  for (const auto& [header, rows] : sections) {
    if (header) out += "\n" + std::string(header->view()) + "\n";
    for (const auto& [key, value] : rows) {
      if (!key && !value) continue;
      const std::string_view name = key ? key->view() : std::string_view{};
      out += kIndentation;
      out += name;
      const std::size_t column = kIndentation.size() + keyWidth + kGap;
      out.append(keyWidth - name.size() + kGap, ' ');
      appendValue(out, value ? value->view() : std::string_view{}, column);
    }
  }
  out.pop_back();
  return out;
}

std::vector<std::string> namesOf(const std::vector<Text>& labels) {
  std::vector<std::string> names;
  names.reserve(labels.size());
  for (const Text& label : labels)
    names.emplace_back(label.view());
  return names;
}

/// Whether the menu has these labels. The user is told which ones there are when it has not.
bool checkLabels(const ShowOptions& options) {
  const VeskViewItems& menu = VeskViewItems::shared();
  const std::vector<std::string> areas = namesOf(menu.launchViewItemNames);
  const std::vector<std::string> categories = namesOf(menu.categoriesOf(options.area));
  if (categories.empty()) {
    tellUser("vesk: no area \"" + options.area + "\"" + suggestionFor(options.area, areas, "\"") +
             "; there are: " + listOf(areas));
    return false;
  }
  if (std::find(categories.begin(), categories.end(), options.category) == categories.end()) {
    tellUser("vesk: no category \"" + options.category + "\" in " + options.area +
             suggestionFor(options.category, categories, "\"") + "; there are: " + listOf(categories));
    return false;
  }
  return true;
}

/// A metric that came is looked for in vain where it has not filled the list.
void tellMissingList(const ShowOptions& options) {
  const Stores& stores = MetricValidator::shared()->stores;
  const CategorySource& source = sourceOf(options.area, options.category);
  if (source.metric && latestRecordOf(stores, *source.metric) != nullptr && !isListFilled(source, stores))
    tellUser("vesk: what fills " + options.area + ", " + options.category + " came, but without this list");
}

}  // namespace

Outcome runShow(const ShowOptions& options) {
  DataOutput output;
  const bool areLabelsKnown = checkLabels(options);
  Outcome outcome = playRecording(options.input, [&](NavigationController& root) {
    openLabel(root, options.area);
    openLabel(root, options.category);
    const std::vector<ShownSection> sections = sectionsOf(topTable(root).tableView());
    output.writeLine(options.asJson ? asJson(options, sections) : asText(options, sections));
    tellMissingList(options);
  });
  if (outcome == Outcome::done && !areLabelsKnown) outcome = Outcome::wrongUsage;
  return output.finish(outcome);
}

}  // namespace vesk
