#include "web/screen_json.h"

#include <vector>

namespace vesk::web {

namespace {

void writeTextOrNull(JsonWriter& json, const std::optional<Text>& text) {
  if (text) {
    json.write(*text);
  } else {
    json.writeNull();
  }
}

std::vector<Text> labelsOf(TableViewController& screen) {
  std::vector<Text> labels;
  for (const ShownSection& section : sectionsOf(screen.tableView()))
    for (const ShownRow& row : section.rows)
      if (row.key) labels.push_back(*row.key);
  return labels;
}

std::string_view titleOf(const ViewController& screen) {
  return screen.title() ? screen.title()->view() : std::string_view{};
}

/// Calls `visit` with each area and the labels of its categories.
template <class Visit>
void visitAreas(const InterfaceLayout& layout, Visit visit) {
  NavigationController stack(layout.makeFirstScreen());
  stack.loadViewIfNeeded();
  for (const Text& area : labelsOf(topTable(stack))) {
    openRow(stack, area.view());
    visit(area, labelsOf(topTable(stack)));
    stack.popToDepth(1);
  }
}

}  // namespace

ScreenWalk::ScreenWalk(const InterfaceLayout& layout) : stack_(layout.makeFirstScreen()) {
  stack_.loadViewIfNeeded();
}

ScreenWalk::~ScreenWalk() {
  stack_.popToDepth(1);
}

bool ScreenWalk::open(std::string_view area, std::string_view category) {
  stack_.popToDepth(1);
  return openRow(stack_, area) && openRow(stack_, category);
}

void ScreenWalk::writeJson(JsonWriter& json, const RowReadings& readings) const {
  const auto& screens = stack_.stack();
  const std::string_view area = screens.size() > 1 ? titleOf(*screens[1]) : std::string_view{};
  const std::string_view category = screens.size() > 2 ? titleOf(*screens[2]) : std::string_view{};
  JsonObject fields(json);
  fields.plainKey("area");
  json.write(area);
  fields.plainKey("category");
  json.write(category);
  fields.plainKey("sections");
  std::size_t sectionNumber = 0;
  writeJsonArray(json, sectionsOf(topTable(stack_).tableView()), [&](const ShownSection& section) {
    JsonObject shown(json);
    shown.plainKey("header");
    writeTextOrNull(json, section.header);
    shown.plainKey("rows");
    std::size_t rowNumber = 0;
    writeJsonArray(json, section.rows, [&](const ShownRow& row) {
      JsonObject cells(json);
      cells.plainKey("key");
      writeTextOrNull(json, row.key);
      cells.plainKey("value");
      writeTextOrNull(json, row.value);
      cells.plainKey("reading");
      const auto reading = readings ? readings(area, category, sectionNumber, rowNumber) : std::nullopt;
      ++rowNumber;
      if (reading) {
        insight::writeReading(json, *reading);
      } else {
        json.writeNull();
      }
      cells.end();
    });
    ++sectionNumber;
    shown.end();
  });
  fields.end();
}

void writeScreensJson(JsonWriter& json, const InterfaceLayout& layout, const RowReadings& readings) {
  ScreenWalk walk(layout);
  char separator = '[';
  visitAreas(layout, [&](const Text& area, const std::vector<Text>& categories) {
    for (const Text& category : categories) {
      if (!walk.open(area.view(), category.view())) continue;
      json.put(separator);
      separator = ',';
      walk.writeJson(json, readings);
    }
  });
  if (separator == '[') json.put('[');
  json.put(']');
}

void writeMenuJson(JsonWriter& json, const InterfaceLayout& layout) {
  char separator = '[';
  visitAreas(layout, [&](const Text& area, const std::vector<Text>& categories) {
    json.put(separator);
    separator = ',';
    JsonObject fields(json);
    fields.plainKey("area");
    json.write(area);
    fields.plainKey("categories");
    writeJsonArray(json, categories, [&](const Text& category) { json.write(category); });
    fields.end();
  });
  json.put(']');
}

}  // namespace vesk::web
