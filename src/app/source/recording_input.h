#pragma once

#include <cstdint>
#include <optional>
#include <string>

namespace vesk {

/// Which recording or capture a command reads, and how.
struct RecordingInput {
  /// "-" is standard input; absent for no events at all.
  std::optional<std::string> path;
  /// Whose packets are taken of a capture; absent for those of all SIMs. A recording is not read with it.
  std::optional<std::uint32_t> sim;
  /// Without identities.
  bool isRedacted = false;
};

/// What to tell the user, once the end is reached, of a file at `path` ("-" is standard input) that had lines, of which
/// none was an event.
[[nodiscard]] std::string remarkOnNoRecording(const std::string& path);

}  // namespace vesk
