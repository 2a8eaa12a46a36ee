#include "app/commands/simulate_command.h"

#include <string_view>

#include "app/output/data_output.h"
#include "handset/handset.h"
#include "handset/recording.h"

namespace vesk {

namespace {

/// 2026-01-01 00:00:00 UTC.
constexpr std::uint64_t kStartMs = 1767225600000;

}  // namespace

Outcome runSimulate(const SimulateOptions& options) {
  DataOutput output;
  handset::Handset simulated(options.seed, kStartMs);
  handset::recordDrive(simulated, options.seconds, [&output](std::string_view line) {
    line.remove_suffix(1);
    output.writeLine(line);
    return !output.hasFailed();
  });
  return output.finish(Outcome::done);
}

}  // namespace vesk
