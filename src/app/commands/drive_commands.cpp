#include "app/commands/drive_commands.h"

#include <string>

#include "app/source/watched_drive.h"
#include "insight/series.h"
#include "insight/summary_form.h"
#include "values/visible_text.h"

namespace vesk {

namespace {

/// An access point's name may hold anything.
std::string visibleLineOf(const insight::TimelineEvent& event) {
  std::string out;
  appendVisible(out, lineOf(event));
  return out;
}

std::string jsonOf(const insight::TimelineEvent& event) {
  std::string out;
  JsonWriter json(out);
  writeJson(json, event);
  json.finish();
  return out;
}

}  // namespace

Outcome runSummary(const RecordingInput& input, bool asJson) {
  DataOutput output;
  insight::Insight insight;
  return watchDrive(input, insight, output,
                    [&] { output.writeLine(asJson ? insight::summaryJson(insight) : insight::summaryText(insight)); });
}

Outcome runTimeline(const TimelineOptions& options) {
  auto rules = readRules(options.rules);
  if (!rules) return Outcome::wrongUsage;
  DataOutput output;
  insight::Insight insight;
  insight.setRules(*std::move(rules));
  insight.setStepHandler([&](const insight::Report& /*report*/, const insight::Step& step) {
    for (const insight::TimelineEvent& event : step)
      output.writeLine(options.asJson ? jsonOf(event) : visibleLineOf(event));
  });
  return watchDrive(options.input, insight, output);
}

Outcome runSeries(const RecordingInput& input, bool asCsv) {
  DataOutput output;
  insight::Insight insight;
  std::string line;
  if (asCsv) output.writeLine(insight::seriesHeader());
  insight.setStepHandler([&](const insight::Report& report, const insight::Step& /*step*/) {
    if (report.kpis.empty()) return;
    line.clear();
    if (asCsv) {
      insight::appendSeriesRow(line, insight);
    } else {
      insight::appendSeriesLine(line, insight);
    }
    output.writeLine(line);
  });
  return watchDrive(input, insight, output);
}

}  // namespace vesk
