#pragma once

#include "app/commands/rule_input.h"
#include "app/output/outcome.h"
#include "app/source/recording_input.h"

/// The commands that play a recording and print what the drive was.
namespace vesk {

/// The whole of it: as at most 24 lines of 80 columns, or as one JSON object.
[[nodiscard]] Outcome runSummary(const RecordingInput& input, bool asJson);

struct TimelineOptions {
  RecordingInput input;
  RuleInput rules;
  bool asJson = false;
};

/// What happened, one event a line, as text or JSON. The outcome tells whether a rule fired; rules that are none are
/// wrong usage.
[[nodiscard]] Outcome runTimeline(const TimelineOptions& options);

/// A line for each event that reports a KPI, with all that are known then: as text, or as CSV with a header.
[[nodiscard]] Outcome runSeries(const RecordingInput& input, bool asCsv);

}  // namespace vesk
