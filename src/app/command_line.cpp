#include "app/command_line.h"

#include <CLI/CLI.hpp>
#include <algorithm>
#include <cerrno>
#include <cstring>
#include <functional>
#include <optional>
#include <sstream>
#include <string>
#include <vector>

#include "app/command_examples.h"
#include "app/command_options.h"
#include "app/commands/decode_command.h"
#include "app/commands/drive_commands.h"
#include "app/commands/import_command.h"
#include "app/commands/readings_command.h"
#include "app/commands/redact_command.h"
#include "app/commands/report_command.h"
#include "app/commands/run_command.h"
#include "app/commands/serve_command.h"
#include "app/commands/show_command.h"
#include "app/commands/simulate_command.h"
#include "app/commands/stores_command.h"
#include "app/commands/suggestion.h"
#include "app/output/data_output.h"
#include "system/system_log.h"

namespace vesk {

namespace {

/// So narrow that the descriptions beside the options end before column 80.
constexpr std::size_t kOptionColumn = 20;

/// Where the system log usually goes: that of the program with its screens, and that of a command that prints data.
constexpr const char* kProgramLog = "syslog";
constexpr const char* kDataLog = "none";

/// Opens the log; false, and the user is told, when it cannot be.
bool openLog(const std::string& to) {
  if (to == "none") return true;
  if (to == "syslog") {
    SystemLog::setSink(makeSyslogSink());
    return true;
  }
  auto sink = to == "stderr" ? makeStandardErrorSink() : makeFileSink(to);
  if (sink == nullptr) {
    const char* reason =
        errno == ELOOP ? "it is a link, in a directory that others may write to" : std::strerror(errno);
    tellUser("vesk: the log cannot go to " + to + ": " + reason);
    return false;
  }
  SystemLog::setSink(std::move(sink));
  return true;
}

class CommandLine {
 public:
  CommandLine() {
    program_.name("vesk");
    program_.get_formatter()->column_width(kOptionColumn);
    program_.set_version_flag("--version", "vesk " VESK_VERSION, "Print the version");
    program_.set_help_flag("-h,--help", "Print this help");
    program_.require_subcommand(0, 1);
    program_.footer(kExamples);
    addRunOptions();
    addDecode();
    addStores();
    addShow();
    addSummary();
    addTimeline();
    addSeries();
    addReadings();
    addReport();
    addServe();
    addRedact();
    addSimulate();
    addImport();
  }

  Outcome run(int argc, const char* const* argv) {
    try {
      program_.parse(argc, argv);
    } catch (const CLI::ParseError& error) {
      if (error.get_exit_code() == 0) {
        return printAnswer(error);
      }
      tellMistake(error);
      return Outcome::wrongUsage;
    }
    if (const std::string stray = optionBeforeCommand(); !stray.empty()) {
      tellUser("vesk: " + stray + " goes without a subcommand; see vesk --help");
      return Outcome::wrongUsage;
    }
    const char* usualLog = program_.get_subcommands().empty() ? kProgramLog : kDataLog;
    if (!openLog(logTo_.value_or(usualLog))) return Outcome::failed;
    return command_();
  }

 private:
  void addRunOptions() {
    program_.add_flag("--headless", run_.isHeadless, "No screens: diagnostic lines on standard output");
    addSourceOptions(program_, run_.source);
    addRedactOption(program_, run_.isRedacted);
    addRuleOptions(program_, run_.rules);
    addDurationOption(program_, run_.duration);
    addLogOption(program_, kProgramLog);
    program_.callback([this] {
      if (program_.get_subcommands().empty()) command_ = [this] { return runProgram(run_); };
    });
  }

  void addServe() {
    CLI::App* serve = program_.add_subcommand("serve", "Show the live page to browsers, and metrics to Prometheus");
    serve->add_option("--port", serve_.server.port, "Where; 0 for any that is free")
        ->type_name("N")
        ->check(CLI::Range(0, 65535).description(""))
        ->default_str("8080");
    serve
        ->add_option("--bind", serve_.server.address, "Listen here; 0.0.0.0 lets everybody in who reaches this machine")
        ->type_name("ADDRESS")
        ->default_str("127.0.0.1");
    serve->add_option("--host", serve_.server.names, "A name of this machine that browsers may ask for")
        ->type_name("NAME")
        ->allow_extra_args(false);
    addSourceOptions(*serve, serve_.source);
    addRedactOption(*serve, serve_.isRedacted);
    addRuleOptions(*serve, serve_.rules);
    addDurationOption(*serve, serve_.duration);
    addLogOption(*serve, kDataLog);
    serve->footer(kServeExamples);
    serve->final_callback([this] { command_ = [this] { return runServe(serve_); }; });
  }

  void addDecode() {
    CLI::App* decode = program_.add_subcommand("decode", "Print the events of a recording, one JSON line each");
    addRecording(*decode, input_);
    addLogOption(*decode, kDataLog);
    decode->footer(kDecodeExamples);
    decode->final_callback([this] { command_ = [this] { return runDecode(input_); }; });
  }

  void addStores() {
    CLI::App* stores = program_.add_subcommand("stores", "Print what the stores hold at the end of a recording");
    addRecording(*stores, input_);
    addLogOption(*stores, kDataLog);
    stores->footer(kStoresExamples);
    stores->final_callback([this] { command_ = [this] { return runStores(input_); }; });
  }

  void addShow() {
    CLI::App* show = program_.add_subcommand("show", "Print one screen as it is at the end of a recording");
    show->add_option("AREA", show_.area, "\"Device Info\", LTE, UMTS or GSM")->required()->type_name("");
    show->add_option("CATEGORY", show_.category, "A line of the area's screen, as \"Tx Power\"")
        ->required()
        ->type_name("");
    addRecordingIfAny(*show, show_.input);
    show->add_flag("--json", show_.asJson, "Print JSON");
    addLogOption(*show, kDataLog);
    show->footer(kShowExamples);
    show->final_callback([this] { command_ = [this] { return runShow(show_); }; });
  }

  void addSummary() {
    CLI::App* summary = program_.add_subcommand("summary", "Print what a whole drive was, on 24 lines");
    addRecording(*summary, input_);
    summary->add_flag("--json", asJson_, "Print one JSON object");
    addLogOption(*summary, kDataLog);
    summary->footer(kSummaryExamples);
    summary->final_callback([this] { command_ = [this] { return runSummary(input_, asJson_); }; });
  }

  void addTimeline() {
    CLI::App* timeline = program_.add_subcommand("timeline", "Print what happened on a drive, one line an event");
    addRecording(*timeline, timeline_.input);
    timeline->add_flag("--json", timeline_.asJson, "Print JSON, one object a line");
    addRuleOptions(*timeline, timeline_.rules);
    addLogOption(*timeline, kDataLog);
    timeline->footer(kTimelineExamples);
    timeline->final_callback([this] { command_ = [this] { return runTimeline(timeline_); }; });
  }

  void addSeries() {
    CLI::App* series = program_.add_subcommand("series", "Print the course of a drive's levels and powers");
    addRecording(*series, input_);
    series->add_flag("--csv", asCsv_, "Print CSV, with a header");
    addLogOption(*series, kDataLog);
    series->footer(kSeriesExamples);
    series->final_callback([this] { command_ = [this] { return runSeries(input_, asCsv_); }; });
  }

  void addReadings() {
    CLI::App* readings = program_.add_subcommand("readings", "Print what the values on the screens mean");
    addRecording(*readings, input_);
    readings->add_flag("--json", asJson_, "Print one JSON object");
    addLogOption(*readings, kDataLog);
    readings->footer(kReadingsExamples);
    readings->final_callback([this] { command_ = [this] { return runReadings(input_, asJson_); }; });
  }

  void addReport() {
    CLI::App* report = program_.add_subcommand("report", "Write what a drive was as one HTML page");
    addRecording(*report, report_.input);
    report->add_option("-o,--output", report_.output, "The file to write; standard output without it")
        ->type_name("OUT");
    addLogOption(*report, kDataLog);
    report->footer(kReportExamples);
    report->final_callback([this] { command_ = [this] { return runReport(report_); }; });
  }

  void addRedact() {
    CLI::App* redact = program_.add_subcommand("redact", "Print a recording without the subscriber's identities");
    addFile(*redact, input_, "A recording or capture; - or nothing for standard input");
    addLogOption(*redact, kDataLog);
    redact->footer(kRedactExamples);
    redact->final_callback([this] { command_ = [this] { return runRedact(input_); }; });
  }

  void addSimulate() {
    CLI::App* simulate = program_.add_subcommand("simulate", "Print a drive of the simulated handset, as a recording");
    simulate->add_option("--seed", simulate_.seed, "Which drive")
        ->type_name("N")
        ->default_str("1")
        ->check(CLI::NonNegativeNumber.description(""));
    simulate->add_option("--seconds", simulate_.seconds, "How long it is")
        ->type_name("N")
        ->default_str("60")
        ->check(secondsFrom(0));
    addLogOption(*simulate, kDataLog);
    simulate->footer(kSimulateExamples);
    simulate->final_callback([this] { command_ = [this] { return runSimulate(simulate_); }; });
  }

  void addImport() {
    CLI::App* command = program_.add_subcommand("import", "Print a capture of a diagnostic port as a recording");
    import_.input.path = "-";
    addFile(*command, import_.input, "A capture; - or nothing for standard input");
    addRedactOption(*command, import_.input.isRedacted);
    command->add_flag("--count", import_.countsOnly, "Print a table of what the capture holds instead");
    command->add_flag("--layouts", import_.layoutsOnly, "Print a table of what can be read");
    addLogOption(*command, kDataLog);
    command->footer(kImportExamples);
    command->final_callback([this] { command_ = [this] { return runImport(import_); }; });
  }

  /// The help or the version.
  Outcome printAnswer(const CLI::ParseError& asked) {
    std::ostringstream answer;
    program_.exit(asked, answer, answer);
    std::string text = answer.str();
    if (text.ends_with('\n')) text.pop_back();
    DataOutput output;
    output.writeLine(text);
    return output.finish(Outcome::done);
  }

  /// An option of the program that the subcommand would not heed; empty for none.
  [[nodiscard]] std::string optionBeforeCommand() const {
    if (program_.get_subcommands().empty()) return "";
    const auto given = program_.get_options([](const CLI::Option* each) { return each->count() > 0; });
    const auto stray =
        std::find_if(given.begin(), given.end(), [](const CLI::Option* each) { return !each->check_lname("log"); });
    return stray == given.end() ? "" : (*stray)->get_name();
  }

  /// One line: what was wrong, what may have been meant, and where more is told.
  void tellMistake(const CLI::ParseError& error) {
    const auto commands = program_.get_subcommands();
    const CLI::App& command = commands.empty() ? program_ : *commands.front();
    std::string line = "vesk: ";
    const std::vector<std::string> unexpected = program_.remaining(true);
    if (dynamic_cast<const CLI::ExtrasError*>(&error) != nullptr && !unexpected.empty()) {
      line += inWords(unexpected, command);
    } else {
      line += error.what();
    }
    line += commands.empty() ? "; see vesk --help" : "; see vesk " + command.get_name() + " --help";
    tellUser(line);
  }

  std::string inWords(const std::vector<std::string>& unexpected, const CLI::App& command) const {
    const auto option = std::find_if(unexpected.begin(), unexpected.end(),
                                     [](const std::string& word) { return word.starts_with('-') && word != "-"; });
    std::vector<std::string> names;
    if (option != unexpected.end()) {
      for (const CLI::Option* known :
           command.get_options([](const CLI::Option* each) { return each->nonpositional(); }))
        names.push_back("--" + known->get_lnames().front());
      const std::string name = option->substr(0, option->find('='));
      return "no option " + name + suggestionFor(name, names);
    }
    const std::string& word = unexpected.front();
    if (&command != &program_) return "an argument too many: " + word + " (quote a name that holds blanks)";
    for (const CLI::App* known : program_.get_subcommands([](const CLI::App*) { return true; }))
      names.push_back(known->get_name());
    return "no subcommand " + word + suggestionFor(word, names);
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
  ImportOptions import_;
  RecordingInput input_;
  TimelineOptions timeline_;
  ReportOptions report_;
  ServeOptions serve_;
  bool asJson_ = false;
  bool asCsv_ = false;
  std::optional<std::string> logTo_;
  std::function<Outcome()> command_;
};

}  // namespace

Outcome runCommandLine(int argc, const char* const* argv) {
  return CommandLine().run(argc, argv);
}

}  // namespace vesk
