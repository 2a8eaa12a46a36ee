#pragma once

#include <chrono>
#include <optional>

#include "app/commands/rule_input.h"
#include "app/output/outcome.h"
#include "app/source/event_source.h"

namespace vesk {

struct RunOptions {
  SourceOptions source;
  /// Without identities.
  bool isRedacted = false;
  RuleInput rules;
  /// No screens: the program's lines on standard output. So it also runs where there is no terminal for screens.
  bool isHeadless = false;
  /// How long; absent until the user quits, or without screens until the recording has ended.
  std::optional<std::chrono::nanoseconds> duration;
};

/// Runs the program: its screens, or headless; then the outcome tells whether a rule fired. Rules that are none are
/// wrong usage. SIGINT and SIGTERM end it in good order.
[[nodiscard]] Outcome runProgram(const RunOptions& options);

}  // namespace vesk
