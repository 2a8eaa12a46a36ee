#include "app/command_line.h"

#include <CLI/CLI.hpp>
#include <cerrno>
#include <charconv>
#include <cmath>
#include <cstring>
#include <functional>
#include <optional>
#include <string>

#include "app/decode_command.h"
#include "app/run_command.h"
#include "app/show_command.h"
#include "app/simulate_command.h"
#include "app/stores_command.h"
#include "platform/system_log.h"

namespace vesk {

namespace {

constexpr const char* kExamples =
    "Examples:\n"
    "  vesk                                   walk the screens of a simulated drive\n"
    "  vesk --replay drive.jsonl              walk the screens while a drive is replayed\n"
    "  vesk --replay drive.jsonl --speed 10   the same, ten times as fast\n"
    "  tail -f live.jsonl | vesk --replay -   the screens on a live pipe\n"
    "  vesk --headless --replay drive.jsonl   the diagnostic lines instead of screens\n"
    "\n"
    "A recording has one event a line:\n"
    "  {\"at\": 12.5, \"metric\": \"0x3C4E04\", \"payload\": \"0895…\"}";

constexpr const char* kDecodeExamples =
    "One JSON line an event:\n"
    "  {\"at\":12.5,\"metric\":\"0x3C4E04\",\"class\":\"KCellularLteRrcState\",\"status\":\"decoded\",\"fields\":{…}}\n"
    "status is decoded, undecodable (the payload is damaged) or ignored (no class knows the metric).\n"
    "\n"
    "Examples:\n"
    "  vesk decode drive.jsonl | jq -r '.fields.state // empty'\n"
    "  tail -f drive.jsonl | vesk decode -";

constexpr const char* kStoresExamples =
    "Examples:\n"
    "  vesk stores drive.jsonl | jq .LTE.SelReselCellInfo\n"
    "  vesk stores drive.jsonl | jq '.dictionaries | map_values(select(. != null)) | keys'";

constexpr const char* kShowExamples =
    "Examples:\n"
    "  vesk show LTE \"Serving Cell Meas\" drive.jsonl\n"
    "  vesk show UMTS \"Tx Power\" drive.jsonl --json | jq -r '.sections[].rows[].value'";

constexpr const char* kSimulateExamples =
    "Examples:\n"
    "  vesk simulate --seconds 600 > drive.jsonl\n"
    "  vesk simulate --seed 7 | vesk show LTE \"RRC State\" -";

/// Where the system log usually goes: that of the program with its screens, and that of a command that prints data.
constexpr const char* kProgramLog = "syslog";
constexpr const char* kDataLog = "none";

/// Where the system log goes.
bool openLog(const std::string& to) {
  if (to == "none") return true;
  if (to == "syslog") {
    SystemLog::setSink(makeSyslogSink());
    return true;
  }
  auto sink = to == "stderr" ? makeStandardErrorSink() : makeFileSink(to);
  if (sink == nullptr) {
    tellUser("vesk: the log cannot go to " + to + ": " + std::strerror(errno));
    return false;
  }
  SystemLog::setSink(std::move(sink));
  return true;
}

/// A positive number, or "max" for absent.
bool parseSpeed(const std::string& text, std::optional<double>& speed) {
  if (text == "max") {
    speed.reset();
    return true;
  }
  double number = 0;
  const auto result = std::from_chars(text.data(), text.data() + text.size(), number);
  const bool isWhole = result.ec == std::errc{} && result.ptr == text.data() + text.size();
  if (!isWhole || !std::isfinite(number) || number <= 0) return false;
  speed = number;
  return true;
}

class CommandLine {
 public:
  CommandLine() {
    program_.name("vesk");
    program_.set_version_flag("--version", "vesk " VESK_VERSION, "Print the version");
    program_.set_help_flag("-h,--help", "Print this help");
    program_.require_subcommand(0, 1);
    program_.footer(kExamples);
    addRunOptions();
    addDecode();
    addStores();
    addShow();
    addSimulate();
  }

  Outcome run(int argc, const char* const* argv) {
    try {
      program_.parse(argc, argv);
    } catch (const CLI::ParseError& error) {
      return program_.exit(error) == 0 ? Outcome::done : Outcome::wrongUsage;
    }
    const char* usualLog = program_.get_subcommands().empty() ? kProgramLog : kDataLog;
    if (!openLog(logTo_.value_or(usualLog))) return Outcome::failed;
    return command_();
  }

 private:
  void addRunOptions() {
    program_
        .add_option("--replay", run_.source.replay,
                    "Feed the program with a recording instead of the simulated handset; - is standard input")
        ->type_name("FILE");
    program_.add_flag("--headless", run_.isHeadless, "No screens: the diagnostic lines on standard output");
    program_
        .add_option_function<std::string>(
            "--speed",
            [this](const std::string& text) {
              if (parseSpeed(text, run_.source.playback.speed)) return;
              throw CLI::ValidationError("--speed", "expected a positive number or max, got " + text);
            },
            "How many seconds of the recording pass in one: a number, or max")
        ->type_name("N")
        ->default_str("1");
    program_.add_option("--seed", run_.source.seed, "Which drive of the simulated handset")->type_name("N");
    program_.add_flag("--loop", run_.source.playback.loops, "Replay from the start again at the end");
    program_
        .add_option_function<double>(
            "--seconds",
            [this](double seconds) {
              run_.duration =
                  std::chrono::duration_cast<std::chrono::nanoseconds>(std::chrono::duration<double>(seconds));
            },
            "End after that many seconds")
        ->type_name("N")
        ->check(CLI::Range(0.001, 1e9));
    addLogOption(program_, kProgramLog);
    program_.callback([this] {
      if (program_.get_subcommands().empty()) command_ = [this] { return runProgram(run_); };
    });
  }

  void addDecode() {
    CLI::App* decode = program_.add_subcommand("decode", "Print the events of a recording, one JSON line each");
    addRecording(*decode, recording_, "The recording; - or nothing for standard input");
    addLogOption(*decode, kDataLog);
    decode->footer(kDecodeExamples);
    decode->final_callback([this] { command_ = [this] { return runDecode(recording_.value_or("-")); }; });
  }

  void addStores() {
    CLI::App* stores = program_.add_subcommand("stores", "Print what the stores hold at the end of a recording");
    addRecording(*stores, recording_, "The recording; - or nothing for standard input");
    addLogOption(*stores, kDataLog);
    stores->footer(kStoresExamples);
    stores->final_callback([this] { command_ = [this] { return runStores(recording_.value_or("-")); }; });
  }

  void addShow() {
    CLI::App* show = program_.add_subcommand("show", "Print one screen as it is at the end of a recording");
    show->add_option("AREA", show_.area, "\"Device Info\", LTE, UMTS or GSM")->required()->type_name("");
    show->add_option("CATEGORY", show_.category, "A line of the area's screen, as \"Tx Power\"")
        ->required()
        ->type_name("");
    addRecording(*show, show_.path, "The recording; - for standard input, nothing for before any event");
    show->add_flag("--json", show_.asJson, "Print JSON");
    addLogOption(*show, kDataLog);
    show->footer(kShowExamples);
    show->final_callback([this] { command_ = [this] { return runShow(show_); }; });
  }

  void addSimulate() {
    CLI::App* simulate = program_.add_subcommand("simulate", "Print a drive of the simulated handset, as a recording");
    simulate->add_option("--seed", simulate_.seed, "Which drive")->type_name("N")->default_str("1");
    simulate->add_option("--seconds", simulate_.seconds, "How long it is")
        ->type_name("N")
        ->default_str("60")
        ->check(CLI::Range(0.0, 1e9));
    addLogOption(*simulate, kDataLog);
    simulate->footer(kSimulateExamples);
    simulate->final_callback([this] { command_ = [this] { return runSimulate(simulate_); }; });
  }

  static void addRecording(CLI::App& command, std::optional<std::string>& path, const std::string& description) {
    command.add_option("FILE", path, description)->type_name("");
  }

  void addLogOption(CLI::App& command, const std::string& usual) {
    command.add_option("--log", logTo_, "Where the system log goes: syslog, stderr, none or a file")
        ->type_name("TO")
        ->default_str(usual);
  }

  CLI::App program_{"Radio metrics of a cellular handset, decoded and shown"};
  RunOptions run_;
  ShowOptions show_;
  SimulateOptions simulate_;
  std::optional<std::string> recording_;
  std::optional<std::string> logTo_;
  std::function<Outcome()> command_;
};

}  // namespace

Outcome runCommandLine(int argc, const char* const* argv) {
  return CommandLine().run(argc, argv);
}

}  // namespace vesk
