#include "app/command_line.h"

#include <CLI/CLI.hpp>
#include <cerrno>
#include <cstring>
#include <functional>
#include <string>

#include "app/decode_command.h"
#include "platform/system_log.h"

namespace vesk {

namespace {

constexpr const char* kDecodeExamples =
    "One JSON line an event:\n"
    "  {\"at\":12.5,\"metric\":\"0x3C4E04\",\"class\":\"KCellularLteRrcState\",\"status\":\"decoded\",\"fields\":{…}}\n"
    "status is decoded, undecodable (the payload is damaged) or ignored (no class knows the metric).\n"
    "\n"
    "Examples:\n"
    "  vesk decode drive.jsonl | jq -r '.fields.state // empty'\n"
    "  tail -f drive.jsonl | vesk decode -";

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

class CommandLine {
 public:
  CommandLine() {
    program_.name("vesk");
    program_.set_version_flag("--version", "vesk " VESK_VERSION, "Print the version");
    program_.set_help_flag("-h,--help", "Print this help");
    program_.require_subcommand(1);
    addDecode();
  }

  Outcome run(int argc, const char* const* argv) {
    try {
      program_.parse(argc, argv);
    } catch (const CLI::ParseError& error) {
      return program_.exit(error) == 0 ? Outcome::done : Outcome::wrongUsage;
    }
    if (!openLog(logTo_)) return Outcome::failed;
    return command_();
  }

 private:
  void addDecode() {
    CLI::App* decode = program_.add_subcommand("decode", "Print the events of a recording, one JSON line each");
    decode->add_option("FILE", path_, "The recording; - or nothing for standard input");
    addLogOption(*decode, "none");
    decode->footer(kDecodeExamples);
    decode->callback([this] { command_ = [this] { return runDecode(path_); }; });
  }

  void addLogOption(CLI::App& command, const std::string& usual) {
    command.add_option("--log", logTo_, "Where the system log goes: syslog, stderr, none or a file")
        ->type_name("TO")
        ->default_str(usual);
    logTo_ = usual;
  }

  CLI::App program_{"Radio metrics of a cellular handset, decoded and shown"};
  std::string path_ = "-";
  std::string logTo_;
  std::function<Outcome()> command_;
};

}  // namespace

Outcome runCommandLine(int argc, const char* const* argv) {
  return CommandLine().run(argc, argv);
}

}  // namespace vesk
