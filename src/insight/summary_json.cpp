#include "insight/json_fields.h"
#include "insight/summary_form.h"

namespace vesk::insight {

namespace {

/// The parts of the summary, each written as one JSON value.
class SummaryWriter {
 public:
  SummaryWriter(JsonWriter& json, const Insight& insight)
      : json_(json), insight_(insight), summary_(insight.summary()) {}

  void writeAll() {
    const EventCounts& counts = insight_.counts();
    object([&](JsonObject& fields) {
      number(fields, "events", counts.all);
      number(fields, "stored", counts.stored);
      number(fields, "undecodable", counts.undecodable);
      number(fields, "ignored", counts.ignored);
      number(fields, "untimed", counts.untimed);
      writeField(json_, fields, "first", insight_.clock().first());
      writeField(json_, fields, "last", insight_.now());
      number(fields, "counted_ms", insight_.clock().counted());
      number(fields, "stretches", insight_.clock().stretches());
      part(fields, "technologies", &SummaryWriter::writeTechnologies);
      part(fields, "cells", &SummaryWriter::writeCells);
      part(fields, "kpis", &SummaryWriter::writeKpis);
      part(fields, "grades", &SummaryWriter::writeGrades);
      part(fields, "connections", &SummaryWriter::writeConnections);
      part(fields, "mobility", &SummaryWriter::writeMobility);
      part(fields, "carrier_aggregation", &SummaryWriter::writeCarriers);
      part(fields, "tx_power", &SummaryWriter::writeTxPower);
      part(fields, "registration", &SummaryWriter::writeRegistration);
      part(fields, "bearers", &SummaryWriter::writeBearers);
      part(fields, "no_service", &SummaryWriter::writeNoService);
      part(fields, "gaps", &SummaryWriter::writeGaps);
      part(fields, "kinds", &SummaryWriter::writeKinds);
    });
  }

 private:
  void writeTechnologies() {
    std::vector<std::optional<Technology>> present;
    for (const Technology each : kTechnologies)
      if (summary_.time(each) > 0) present.emplace_back(each);
    if (summary_.time(std::nullopt) > 0) present.emplace_back(std::nullopt);
    writeJsonArray(json_, present, [&](const std::optional<Technology>& technology) {
      object([&](JsonObject& fields) {
        writeField(json_, fields, "technology", technology);
        number(fields, "ms", summary_.time(technology));
        share(fields, "share", summary_.time(technology), insight_.clock().counted());
      });
    });
  }

  void writeCells() {
    writeJsonArray(json_, summary_.cells().byTime(), [&](const VisitedCell* cell) {
      object([&](JsonObject& fields) {
        writeField(json_, fields, "technology", nameOf(cell->technology));
        writeField(json_, fields, "channel", cell->identity.channel);
        writeField(json_, fields, "code", cell->identity.code);
        writeField(json_, fields, "cell_id", cell->identity.cellId);
        number(fields, "ms", cell->time);
        number(fields, "visits", cell->visits);
        stats(fields, "level", cell->level);
        stats(fields, "quality", cell->quality);
        stats(fields, "sinr", cell->sinr);
      });
    });
  }

  void writeKpis() {
    forKpis([](const KpiDescription&) { return true; },
            [&](JsonObject& fields, const KpiDescription& each, const KpiSummary& kpi) {
              stats(fields, each.name, kpi.values);
            });
  }

  void writeGrades() {
    forKpis([](const KpiDescription& each) { return each.isGraded; },
            [&](JsonObject& fields, const KpiDescription& each, const KpiSummary& kpi) {
              fields.plainKey(each.name);
              object([&](JsonObject& grades) {
                for (const Grade grade : {Grade::excellent, Grade::good, Grade::fair, Grade::poor})
                  number(grades, nameOf(grade), kpi.graded(grade));
              });
            });
  }

  void writeConnections() {
    byTechnology([&](JsonObject& fields, Technology technology) {
      const ConnectionCounts& counts = insight_.timeline().connections().counts(technology);
      number(fields, "attempted", counts.attempted);
      number(fields, "established", counts.established);
      causes(fields, "failed", counts.failed);
      causes(fields, "dropped", counts.dropped);
      causes(fields, "released", counts.released);
      causes(fields, "reestablishments", counts.reestablishments);
      number(fields, "reestablished", counts.reestablished);
    });
  }

  void writeMobility() {
    byTechnology([&](JsonObject& fields, Technology technology) {
      const MobilityCounts& counts = summary_.mobility(technology);
      number(fields, "handovers", counts.handovers);
      number(fields, "reselections", counts.reselections);
      number(fields, "reestablishments", counts.reestablishments);
      number(fields, "unknown", counts.unknown);
      number(fields, "pingpongs", counts.pingPongs);
    });
  }

  void writeCarriers() {
    object([&](JsonObject& fields) {
      number(fields, "configured_ms", summary_.carriersConfigured());
      number(fields, "activated_ms", summary_.carriersActivated());
      share(fields, "share", summary_.carriersConfigured(), summary_.time(Technology::lte));
    });
  }

  void writeTxPower() {
    forKpis([](const KpiDescription& each) { return each.isTransmitPower; },
            [&](JsonObject& fields, const KpiDescription& each, const KpiSummary& kpi) {
              fields.plainKey(each.name);
              object([&](JsonObject& power) {
                writeField(json_, power, "max", std::optional(kpi.values.stats()->max));
                number(power, "ms", kpi.known());
                number(power, "ms_high", kpi.high());
                share(power, "share", kpi.high(), kpi.known());
              });
            });
  }

  void writeRegistration() {
    object([&](JsonObject& fields) {
      number(fields, "emm", summary_.count(EventKind::emm));
      number(fields, "mm", summary_.count(EventKind::mm));
      number(fields, "gmm", summary_.count(EventKind::gmm));
      fields.plainKey("rejects");
      object([&](JsonObject& rejects) {
        for (const Registration each : {Registration::emm, Registration::mm, Registration::gmm})
          causes(rejects, nameOf(each), insight_.timeline().registrations().rejects(each));
      });
    });
  }

  void writeBearers() {
    object([&](JsonObject& fields) {
      number(fields, "up", summary_.count(EventKind::bearerUp));
      number(fields, "down", summary_.count(EventKind::bearerDown));
      fields.plainKey("active");
      writeJsonArray(json_, insight_.timeline().bearers().active(),
                     [&](const Bearer& bearer) { json_.write(bearer.number); });
    });
  }

  void writeNoService() {
    object([&](JsonObject& fields) {
      number(fields, "count", summary_.count(EventKind::noService));
      number(fields, "ms", summary_.noService());
    });
  }

  void writeGaps() {
    writeJsonArray(json_, summary_.gaps(), [&](const Gap& gap) {
      object([&](JsonObject& fields) {
        number(fields, "from", gap.from);
        number(fields, "to", gap.to);
        number(fields, "jump_ms", gap.jump());
      });
    });
  }

  void writeKinds() {
    object([&](JsonObject& fields) {
      for (std::size_t index = 0; index < kEventKindCount; ++index) {
        const auto kind = static_cast<EventKind>(index);
        if (summary_.count(kind) > 0) number(fields, nameOf(kind), summary_.count(kind));
      }
    });
  }

  void part(JsonObject& fields, std::string_view key, void (SummaryWriter::*writePart)()) {
    fields.plainKey(key);
    (this->*writePart)();
  }

  template <class Write>
  void object(Write write) {
    JsonObject fields(json_);
    write(fields);
    fields.end();
  }

  /// An object with a field for each of the KPIs meant that have values.
  template <class IsMeant, class Write>
  void forKpis(IsMeant isMeant, Write write) {
    object([&](JsonObject& fields) {
      for (const KpiDescription& each : kKpis) {
        const KpiSummary& kpi = summary_.kpi(each.kpi);
        if (isMeant(each) && !kpi.values.empty()) write(fields, each, kpi);
      }
    });
  }

  template <class Write>
  void byTechnology(Write write) {
    object([&](JsonObject& technologies) {
      for (const Technology each : kTechnologies) {
        technologies.plainKey(nameOf(each));
        object([&](JsonObject& fields) { write(fields, each); });
      }
    });
  }

  template <class Number>
  void number(JsonObject& fields, std::string_view key, Number value) {
    fields.plainKey(key);
    json_.write(value);
  }

  void share(JsonObject& fields, std::string_view key, std::int64_t part, std::int64_t whole) {
    const auto value =
        whole == 0 ? std::nullopt : std::optional(static_cast<double>(part) / static_cast<double>(whole));
    writeField(json_, fields, key, value, [&](double each) { writeNumber(json_, each); });
  }

  void stats(JsonObject& fields, std::string_view key, const Histogram& histogram) {
    writeField(json_, fields, key, histogram.stats(), [&](const Stats& values) {
      object([&](JsonObject& each) {
        number(each, "count", values.count);
        figure(each, "min", values.min);
        figure(each, "mean", values.mean);
        figure(each, "median", values.median);
        figure(each, "max", values.max);
      });
    });
  }

  void figure(JsonObject& fields, std::string_view key, double value) {
    fields.plainKey(key);
    writeNumber(json_, value);
  }

  void causes(JsonObject& fields, std::string_view key, const CauseCounts& counts) {
    fields.plainKey(key);
    object([&](JsonObject& each) {
      for (const auto& [cause, count] : counts.byCause()) {
        each.key(cause);
        json_.write(count);
      }
    });
  }

  JsonWriter& json_;
  const Insight& insight_;
  const Summary& summary_;
};

}  // namespace

std::string summaryJson(const Insight& insight) {
  std::string out;
  JsonWriter json(out);
  SummaryWriter(json, insight).writeAll();
  json.finish();
  return out;
}

}  // namespace vesk::insight
