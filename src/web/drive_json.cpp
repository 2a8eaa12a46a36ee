#include "web/drive_json.h"

#include <array>
#include <span>
#include <string_view>

#include "insight/enumeration_names.h"
#include "insight/json_fields.h"
#include "values/json_form.h"

namespace vesk::web {

namespace {

using insight::KpiDescription;
using insight::writeField;

constexpr std::array<std::string_view, kMarkCount> kMarkNames{"change", "reestablished", "drop", "technology"};

/// Writes one JSON array of numbers, pair by pair.
class Pairs {
 public:
  explicit Pairs(JsonWriter& json) : json_(json) {}

  void addPosition(std::int64_t position) {
    separate();
    json_.write(position);
  }
  void addValue(double value) {
    separate();
    insight::writeRounded(json_, value);
  }
  void end() {
    if (separator_ == '[') json_.put('[');
    json_.put(']');
  }

 private:
  void separate() {
    json_.put(separator_);
    separator_ = ',';
  }

  JsonWriter& json_;
  char separator_ = '[';
};

void writeKpiDescriptions(JsonWriter& json) {
  writeJsonArray(json, insight::kKpis, [&](const KpiDescription& each) {
    JsonObject fields(json);
    writeField(json, fields, "name", each.name);
    writeField(json, fields, "unit", each.quantity->unit);
    writeField(json, fields, "steps", each.quantity->steps, [&](const insight::GradeSteps& steps) {
      writeJsonArray(json, std::array{steps.excellent, steps.good, steps.fair},
                     [&](double step) { insight::writeRounded(json, step); });
    });
    writeField(json, fields, "high", each.quantity->high);
    fields.end();
  });
}

void writeCourse(JsonWriter& json, const std::vector<MeasuredPoint>& points) {
  Pairs pairs(json);
  for (const MeasuredPoint& point : points) {
    const bool isLeastFirst = point.leastAt <= point.greatestAt;
    pairs.addPosition(isLeastFirst ? point.leastAt : point.greatestAt);
    pairs.addValue(isLeastFirst ? point.least : point.greatest);
    if (point.leastAt == point.greatestAt) continue;
    pairs.addPosition(isLeastFirst ? point.greatestAt : point.leastAt);
    pairs.addValue(isLeastFirst ? point.greatest : point.least);
  }
  pairs.end();
}

void writeSeries(JsonWriter& json, const DriveRecord& record) {
  JsonObject series(json);
  for (const KpiDescription& each : insight::kKpis) {
    const std::vector<MeasuredPoint> points = record.course(each.kpi);
    if (points.empty()) continue;
    series.plainKey(each.name);
    writeCourse(json, points);
  }
  series.end();
}

void writeServing(JsonWriter& json, const DriveRecord& record) {
  Pairs pairs(json);
  for (const ServingPoint& point : record.serving()) {
    pairs.addPosition(point.position);
    pairs.addPosition(point.cell ? static_cast<std::int64_t>(*point.cell) : -1);
  }
  pairs.end();
}

void writeMarks(JsonWriter& json, const DriveRecord& record) {
  JsonObject marks(json);
  for (std::size_t mark = 0; mark < kMarkCount; ++mark) {
    marks.plainKey(kMarkNames[mark]);
    writeJsonArray(json, record.marks(static_cast<Mark>(mark)),
                   [&](const MarkPoint& point) { json.write(point.position); });
  }
  marks.end();
}

void writeEvents(JsonWriter& json, const DriveRecord& record) {
  writeJsonArray(json, record.events(), [&](const DriveRecord::Event* each) {
    json.put('[');
    json.write(each->event.moment.position);
    json.put(',');
    json.write(each->event.moment.time);
    json.put(',');
    json.write(nameOf(each->event.kind));
    json.put(',');
    json.write(std::string_view(textOf(each->event)));
    json.put(']');
  });
}

void writeKnownKpis(JsonWriter& json, const insight::Insight& insight) {
  JsonObject kpis(json);
  for (const KpiDescription& each : insight::kKpis) {
    const auto value = insight.value(each.kpi);
    if (!value) continue;
    kpis.plainKey(each.name);
    JsonObject fields(json);
    writeField(json, fields, "value", value);
    writeField(json, fields, "age_ms", insight.age(each.kpi));
    fields.end();
  }
  kpis.end();
}

void writeNow(JsonWriter& json, const insight::Insight& insight) {
  const insight::Timeline& timeline = insight.timeline();
  const insight::Mobility& mobility = timeline.mobility();
  const auto& technology = mobility.technology();
  JsonObject fields(json);
  writeField(json, fields, "time", insight.now());
  writeField(json, fields, "position", std::optional(insight.clock().counted()));
  writeField(json, fields, "events", std::optional(static_cast<std::int64_t>(insight.counts().all)));
  writeField(json, fields, "technology", technology);
  writeField(json, fields, "cell", mobility.cell(), [&](const insight::ServingCell& cell) {
    json.write(std::string_view(insight::textOf(cell.technology, cell.identity, true)));
  });
  insight::writeName(json, fields, "rrc", technology ? timeline.connections().state(*technology) : std::nullopt);
  const auto& area = mobility.area(insight::Area::tracking);
  writeField(json, fields, "area", area ? std::optional(textOf(*area)) : std::nullopt);
  const insight::Registrations& registrations = timeline.registrations();
  insight::writeName(json, fields, "emm", registrations.status(insight::Registration::emm));
  insight::writeName(json, fields, "mm", registrations.status(insight::Registration::mm));
  insight::writeName(json, fields, "gmm", registrations.status(insight::Registration::gmm));
  fields.plainKey("kpis");
  writeKnownKpis(json, insight);
  fields.plainKey("heard");
  writeJson(json, insight.cellsHeard());
  fields.end();
}

/// What both forms have: from `firstCell` on the cells' names.
void writeDrive(JsonWriter& json, JsonObject& drive, const DriveRecord& record, const insight::Insight& insight,
                std::size_t firstCell) {
  drive.plainKey("stretches");
  Pairs stretches(json);
  for (const StretchBegin& each : record.stretches().begins()) {
    stretches.addPosition(each.position);
    stretches.addPosition(each.time);
  }
  stretches.end();
  drive.plainKey("time_error");
  json.write(record.stretches().error());
  drive.plainKey("series");
  writeSeries(json, record);
  drive.plainKey("cells");
  writeJsonArray(json, std::span(record.cells()).subspan(firstCell),
                 [&](const std::string& cell) { json.write(std::string_view(cell)); });
  drive.plainKey("serving");
  writeServing(json, record);
  drive.plainKey("serving_width");
  json.write(record.servingWidth());
  drive.plainKey("marks");
  writeMarks(json, record);
  drive.plainKey("events");
  writeEvents(json, record);
  drive.plainKey("now");
  writeNow(json, insight);
  drive.end();
  json.finish();
}

}  // namespace

void appendDriveJson(std::string& out, const DriveRecord& record, const insight::Insight& insight) {
  JsonWriter json(out);
  JsonObject drive(json);
  drive.plainKey("kpis");
  writeKpiDescriptions(json);
  writeDrive(json, drive, record, insight, 0);
}

void appendNewsJson(std::string& out, const DriveRecord& record, const insight::Insight& insight) {
  JsonWriter json(out);
  JsonObject drive(json);
  writeDrive(json, drive, record, insight, record.firstNewCell());
}

}  // namespace vesk::web
