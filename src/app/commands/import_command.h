#pragma once

#include "app/output/outcome.h"
#include "app/source/recording_input.h"

namespace vesk {

struct ImportOptions {
  /// The capture.
  RecordingInput input;
  /// A table of what the capture holds, instead of its events.
  bool countsOnly = false;
  /// A table of what can be read, and nothing is imported.
  bool layoutsOnly = false;
};

/// Writes the events of a capture of a modem's diagnostic port to standard output, as a recording. What cannot be read
/// is passed over, whatever it is; the user is told what was damaged.
[[nodiscard]] Outcome runImport(const ImportOptions& options);

}  // namespace vesk
