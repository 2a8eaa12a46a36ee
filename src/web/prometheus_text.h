#pragma once

#include <chrono>
#include <cstddef>
#include <optional>
#include <string>

#include "insight/insight.h"

namespace vesk::web {

/// For so long without an event, whatever the drive's own time, what it said last still holds.
inline constexpr std::chrono::seconds kLongestQuiet{30};

/// The drive so far in the text format of Prometheus: every KPI that is known, with its serving cell, and counters of
/// all that happened. `quiet` is how long ago the last event came; absent before the first.
[[nodiscard]] std::string prometheusText(const insight::Insight& insight,
                                         const std::optional<std::chrono::milliseconds>& quiet, std::size_t visitors);

}  // namespace vesk::web
