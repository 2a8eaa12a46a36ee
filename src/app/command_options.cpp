#include "app/command_options.h"

#include <cmath>
#include <string>

#include "values/parse_number.h"

namespace vesk {

namespace {

/// A positive number, or "max" for absent.
bool parseSpeed(const std::string& text, std::optional<double>& speed) {
  if (text == "max") {
    speed.reset();
    return true;
  }
  const auto number = parseNumber<double>(text);
  if (!number || !std::isfinite(*number) || *number <= 0) return false;
  speed = number;
  return true;
}

/// Whose packets are taken.
void addSimOption(CLI::App& command, std::optional<std::uint32_t>& sim) {
  const auto reasonAgainst = [](const std::string& text) -> std::string {
    return parseNumber<std::uint32_t>(text).value_or(0) > 0 ? "" : "expected a SIM's number, from 1, got " + text;
  };
  command.add_option("--sim", sim, "Take one SIM's packets only, from 1; refused for a recording")
      ->type_name("N")
      ->check(CLI::Validator(reasonAgainst, ""));
}

}  // namespace

CLI::Validator secondsFrom(double least) {
  const auto reasonAgainst = [least](const std::string& text) -> std::string {
    const auto seconds = parseNumber<double>(text);
    if (seconds && *seconds >= least && *seconds <= 1e9) return "";
    return "expected a number of seconds, got " + text;
  };
  return {reasonAgainst, ""};
}

void addSourceOptions(CLI::App& command, SourceOptions& source) {
  CLI::Option* replay =
      command.add_option("--replay", source.replay, "Feed it a recording or a capture; - is stdin")->type_name("FILE");
  CLI::Option* port = command.add_option("--diag", source.port, "Feed it a modem's diagnostic port")
                          ->type_name("PORT")
                          ->excludes(replay);
  addSimOption(command, source.sim);
  command.parse_complete_callback([&source] {
    if (source.sim && !source.port && !source.replay)
      throw CLI::ValidationError("--sim", "goes with --diag or --replay: the simulated handset has one SIM");
  });
  command.add_option("--record", source.record, "Keep what comes: of a port the capture, else a recording")
      ->type_name("FILE");
  command
      .add_option_function<std::string>(
          "--speed",
          [&source](const std::string& text) {
            if (parseSpeed(text, source.playback.speed)) return;
            throw CLI::ValidationError("--speed", "expected a positive number or max, got " + text);
          },
          "Replay so many seconds in one: a number, or max")
      ->type_name("N")
      ->default_str("1")
      ->needs(replay);
  command.add_option("--seed", source.seed, "Which drive of the simulated handset")
      ->type_name("N")
      ->check(CLI::NonNegativeNumber.description(""))
      ->excludes(replay)
      ->excludes(port);
  command.add_flag("--real-pauses", source.playback.keepsPauses, "Do not shorten pauses of more than a minute")
      ->needs(replay);
  command.add_flag("--loop", source.playback.loops, "Replay from the start again at the end")->needs(replay);
}

void addDurationOption(CLI::App& command, std::optional<std::chrono::nanoseconds>& duration) {
  command
      .add_option_function<double>(
          "--seconds",
          [&duration](double seconds) {
            duration = std::chrono::duration_cast<std::chrono::nanoseconds>(std::chrono::duration<double>(seconds));
          },
          "End after that many seconds")
      ->type_name("N")
      ->check(secondsFrom(0.001));
}

void addRecording(CLI::App& command, RecordingInput& input) {
  input.path = "-";
  addFile(command, input, "A recording or capture; - or nothing for standard input");
  addRedactOption(command, input.isRedacted);
}

void addRecordingIfAny(CLI::App& command, RecordingInput& input) {
  addFile(command, input, "A recording or capture; - is stdin, nothing: no events yet");
  addRedactOption(command, input.isRedacted);
}

void addFile(CLI::App& command, RecordingInput& input, const std::string& description) {
  command.add_option("FILE", input.path, description)->type_name("");
  addSimOption(command, input.sim);
}

void addRedactOption(CLI::App& command, bool& isRedacted) {
  command.add_flag("--redact", isRedacted, "Without the subscriber's identities and addresses");
}

/// Each --rule takes one.
void addRuleOptions(CLI::App& command, RuleInput& rules) {
  command.add_option("--rule", rules.rules, "Tell when it fires: \"lte.rsrp < -110 for 10 s\", \"event drop\"")
      ->type_name("RULE")
      ->allow_extra_args(false);
  command.add_option("--rules", rules.file, "A file of such rules, one a line")->type_name("FILE");
}

}  // namespace vesk
