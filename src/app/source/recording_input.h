#pragma once

#include <optional>
#include <string>

namespace vesk {

/// Which recording a command reads, and how.
struct RecordingInput {
  /// "-" is standard input; absent for no events at all.
  std::optional<std::string> path;
  /// Without identities.
  bool isRedacted = false;
};

/// Tells the user, once the end is reached, that the file at `path` ("-" is standard input) is no recording: it had
/// lines, and none was an event.
void tellIsNoRecording(const std::string& path);

}  // namespace vesk
