#include "app/commands/readings_command.h"

#include <algorithm>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "app/source/watched_drive.h"
#include "insight/readings.h"
#include "insight/text_forms.h"
#include "intake/metric_validator.h"
#include "screens/category_sources.h"
#include "screens/detail_text.h"
#include "terminal/device/column_width.h"
#include "values/visible_text.h"

namespace vesk {

namespace {

void writeSection(JsonWriter& json, std::string_view messageClass, const Record& record) {
  writeJsonArray(json, record, [&](const Dictionary::Entry& entry) {
    JsonObject row(json);
    row.key("key");
    json.write(entry.key);
    row.key("reading");
    if (const auto reading = insight::readingOf(messageClass, record, entry)) {
      insight::writeReading(json, *reading);
    } else {
      json.writeNull();
    }
    row.end();
  });
}

std::string readingsJson(const Stores& stores, const insight::Insight& insight) {
  std::string out;
  JsonWriter json(out);
  JsonObject object(json);
  object.key("screens");
  char separator = '[';
  for (const CategorySource& source : categorySources()) {
    json.put(std::exchange(separator, ','));
    JsonObject screen(json);
    screen.key("area");
    json.write(source.area);
    screen.key("category");
    json.write(source.category);
    screen.key("sections");
    writeJsonArray(json, shownRecords(source, stores),
                   [&](const Record& record) { writeSection(json, messageClassOf(source), record); });
    screen.end();
  }
  json.put(']');
  object.key("heard");
  insight::writeJson(json, insight.cellsHeard());
  object.end();
  json.finish();
  return out;
}

using Columns = std::vector<std::string>;

/// Appends the rows below each other, with the cells of a column at the same place.
void appendTable(std::string& out, const std::vector<Columns>& rows) {
  constexpr std::size_t kGap = 2;
  std::vector<std::size_t> widths;
  for (const Columns& row : rows) {
    widths.resize(std::max(widths.size(), row.size()));
    for (std::size_t column = 0; column < row.size(); ++column)
      widths[column] = std::max(widths[column], row[column].size());
  }
  for (const Columns& row : rows) {
    out.append(kGap, ' ');
    for (std::size_t column = 0; column < row.size(); ++column) {
      out += row[column];
      if (column + 1 < row.size()) out.append(widths[column] - row[column].size() + kGap, ' ');
    }
    out += '\n';
  }
}

/// The rows that have a reading: key, value, what it means.
std::vector<Columns> readRows(std::string_view messageClass, const Record& record) {
  std::vector<Columns> rows;
  for (const Dictionary::Entry& entry : record) {
    const auto reading = insight::readingOf(messageClass, record, entry);
    if (!reading) continue;
    std::string value;
    // Of what stands on several lines the reading tells more than the first.
    if (entry.value.dictionary() == nullptr) appendVisible(value, detailTextOf(entry.value).view());
    rows.push_back({std::string(entry.key.view()), std::move(value), reading->text});
  }
  return rows;
}

std::string orDash(const std::optional<double>& number, std::string_view unit) {
  return number ? insight::numberText(*number) + std::string(unit) : "-";
}

std::vector<Columns> heardRows(const std::vector<insight::HeardCell>& cells) {
  std::vector<Columns> rows{{"technology", "channel", "code", "role", "level", "quality", "difference", "age"}};
  const auto number = [](const std::optional<std::int64_t>& value) { return value ? std::to_string(*value) : "-"; };
  for (const insight::HeardCell& cell : cells)
    rows.push_back({std::string(nameOf(cell.key.technology)), number(cell.key.channel), number(cell.key.code),
                    std::string(nameOf(cell.role)), orDash(cell.level, " dBm"), orDash(cell.quality, " dB"),
                    orDash(cell.difference, " dB"),
                    insight::durationText(static_cast<std::uint64_t>(std::max<std::int64_t>(cell.age, 0)))});
  return rows;
}

std::string readingsText(const Stores& stores, const insight::Insight& insight) {
  std::string out;
  for (const CategorySource& source : categorySources()) {
    bool isFirst = true;
    for (const Record& record : shownRecords(source, stores)) {
      const std::vector<Columns> rows = readRows(messageClassOf(source), record);
      if (rows.empty()) continue;
      if (std::exchange(isFirst, false)) {
        out +=
            std::string(source.area) + (setUpCharacterLocale() ? " › " : " > ") + std::string(source.category) + '\n';
      } else {
        out += '\n';
      }
      appendTable(out, rows);
    }
    if (!isFirst) out += '\n';
  }
  out += "Cells heard\n";
  appendTable(out, heardRows(insight.cellsHeard()));
  out.pop_back();
  return out;
}

}  // namespace

Outcome runReadings(const RecordingInput& input, bool asJson) {
  DataOutput output;
  insight::Insight insight;
  return watchDrive(input, insight, output, [&] {
    const Stores& stores = MetricValidator::shared()->stores;
    output.writeLine(asJson ? readingsJson(stores, insight) : readingsText(stores, insight));
  });
}

}  // namespace vesk
