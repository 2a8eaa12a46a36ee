#include "app/timeline_command.h"

#include <string>

#include "app/watched_drive.h"
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

Outcome runTimeline(const TimelineOptions& options) {
  auto rules = readRules(options.rules);
  if (!rules) return Outcome::wrongUsage;
  DataOutput output;
  insight::Insight insight;
  insight.setRules(*std::move(rules));
  insight.setStepHandler([&](const insight::Report& /*report*/, const std::vector<insight::TimelineEvent>& events) {
    for (const insight::TimelineEvent& event : events)
      output.writeLine(options.asJson ? jsonOf(event) : visibleLineOf(event));
  });
  return watchDrive(options.input, insight, output);
}

}  // namespace vesk
