#pragma once

#include <optional>
#include <string>

#include "app/output/outcome.h"
#include "app/source/recording_input.h"

namespace vesk {

struct ReportOptions {
  RecordingInput input;
  /// Absent for standard output.
  std::optional<std::string> output;
};

/// Plays the recording and writes what the drive was as one HTML page, which holds all it shows.
[[nodiscard]] Outcome runReport(const ReportOptions& options);

}  // namespace vesk
