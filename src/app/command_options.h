#pragma once

#include <CLI/CLI.hpp>
#include <chrono>
#include <optional>

#include "app/commands/rule_input.h"
#include "app/source/event_source.h"
#include "app/source/recording_input.h"

/// Options that several commands have. What they are written to must outlive the command.
namespace vesk {

/// Where the events of a running program come from.
void addSourceOptions(CLI::App& command, SourceOptions& source);
/// How long it runs.
void addDurationOption(CLI::App& command, std::optional<std::chrono::nanoseconds>& duration);

/// The recording that a command reads: standard input where no file is named.
void addRecording(CLI::App& command, RecordingInput& input);
void addRecordingIfAny(CLI::App& command, RecordingInput& input);
/// The same without the option to redact it.
void addFile(CLI::App& command, RecordingInput& input, const std::string& description);

void addRedactOption(CLI::App& command, bool& isRedacted);
void addRuleOptions(CLI::App& command, RuleInput& rules);

/// Seconds from `least` to a billion.
[[nodiscard]] CLI::Validator secondsFrom(double least);

}  // namespace vesk
