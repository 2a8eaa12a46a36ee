#pragma once

#include <chrono>
#include <optional>

#include "app/commands/rule_input.h"
#include "app/output/outcome.h"
#include "app/source/event_source.h"
#include "web/http/http_server.h"

namespace vesk {

struct ServeOptions {
  SourceOptions source;
  /// Without identities.
  bool isRedacted = false;
  RuleInput rules;
  web::ServerOptions server;
  /// How long; absent until SIGINT or SIGTERM.
  std::optional<std::chrono::nanoseconds> duration;
};

/// Runs the program and serves its live page, also when a recording has ended. Where that is, is told on standard
/// error. Once a rule has fired, that is the outcome.
[[nodiscard]] Outcome runServe(const ServeOptions& options);

}  // namespace vesk
