#pragma once

#include <chrono>
#include <optional>
#include <string_view>

#include "system/wake_up.h"

namespace vesk {

/// How a command ends; the values are its exit statuses.
enum class Outcome : int {
  done = 0,
  failed = 1,
  wrongUsage = 2,
  /// All went well or not: a rule fired.
  ruleFired = 3,
};

/// Writes one line to standard error, control characters made visible. Waits for a slow reader.
void tellUser(std::string_view line);
/// While `interrupt` is signalled, tellUser drops what a reader does not take at once; from `deadline` on, whatever a
/// reader has not taken within a second. The interrupt must outlive the process's last line.
void boundTelling(const WakeUp& interrupt, std::optional<std::chrono::steady_clock::time_point> deadline);

}  // namespace vesk
