#pragma once

#include "app/outcome.h"
#include "app/recording_input.h"
#include "app/rule_input.h"

namespace vesk {

struct TimelineOptions {
  RecordingInput input;
  RuleInput rules;
  bool asJson = false;
};

/// Plays the recording and prints what happened, one event a line, as text or JSON. The outcome tells whether a rule
/// fired; rules that are none are wrong usage.
[[nodiscard]] Outcome runTimeline(const TimelineOptions& options);

}  // namespace vesk
