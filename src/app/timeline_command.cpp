#include "app/timeline_command.h"

#include <string>

#include "app/watched_drive.h"

namespace vesk {

namespace {

std::string jsonOf(const insight::TimelineEvent& event) {
  std::string out;
  JsonWriter json(out);
  writeJson(json, event);
  json.finish();
  return out;
}

}  // namespace

Outcome runTimeline(const TimelineOptions& options) {
  auto rules = readRules(options.rules);
  if (!rules) return Outcome::wrongUsage;
  DataOutput output;
  insight::Insight insight;
  insight.setRules(*std::move(rules));
  insight.setStepHandler([&](const insight::Report& /*report*/, const std::vector<insight::TimelineEvent>& events) {
    for (const insight::TimelineEvent& event : events)
      output.writeLine(options.asJson ? jsonOf(event) : lineOf(event));
  });
  return watchDrive(options.input, insight, output);
}

}  // namespace vesk
