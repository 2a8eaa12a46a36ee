#pragma once

#include <optional>
#include <string>
#include <vector>

#include "insight/rules.h"

namespace vesk {

/// The rules that a command is to judge.
struct RuleInput {
  /// Those of the command line.
  std::vector<std::string> rules;
  /// A file with one rule a line; blank lines, and what follows a #, are passed over.
  std::optional<std::string> file;
};

/// The rules, those of the command line first. Absent when some are none, or the file cannot be read: the user is told
/// of each, with its place.
[[nodiscard]] std::optional<std::vector<insight::Rule>> readRules(const RuleInput& input);

}  // namespace vesk
