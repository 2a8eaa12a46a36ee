#pragma once

#include <string>
#include <vector>

namespace vesk::bench {

/// What one run of a program took.
struct Usage {
  /// Of all its threads, in user and kernel mode.
  double processorSeconds;
  /// From before its start until its end was noticed.
  double wallSeconds;
  /// The most memory it held at a time.
  long peakKib;
};

/// Runs a program to its end, its output thrown away; `command` is its path and its arguments. Ends this program with
/// one line when it cannot be started or fails. What it holds counts in `peakKib` too, as the system counts the memory
/// of the one that starts a program: so this one must be small.
[[nodiscard]] Usage runToEnd(const std::vector<std::string>& command);

}  // namespace vesk::bench
