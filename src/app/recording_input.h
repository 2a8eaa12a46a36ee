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

}  // namespace vesk
