#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "system/file_descriptor.h"

namespace vesk {

/// What came of a line: its event or what was wrong with it.
struct Outcome {
  std::size_t line;
  std::string text;

  friend bool operator==(const Outcome&, const Outcome&) = default;
};
using Outcomes = std::vector<Outcome>;

/// A file without a name, read from its start.
[[nodiscard]] FileDescriptor fileOf(std::string_view content);

/// Those of a recording named "recording", twice over from its start.
[[nodiscard]] Outcomes readFile(std::string_view content, std::size_t longestLine);

/// Those of a pipe that brings so many bytes at a time.
[[nodiscard]] Outcomes readPipe(std::string_view content, std::size_t longestLine, std::size_t pieceSize);

/// What must come out: each line read alone.
[[nodiscard]] Outcomes expectedOutcomes(std::string_view content, std::size_t longestLine);

}  // namespace vesk
