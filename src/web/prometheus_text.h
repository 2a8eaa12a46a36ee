#pragma once

#include <cstddef>
#include <string>

#include "insight/insight.h"

namespace vesk::web {

/// The drive so far in the text format of Prometheus: every KPI that is known, with its serving cell, and counters of
/// all that happened.
[[nodiscard]] std::string prometheusText(const insight::Insight& insight, std::size_t visitors);

}  // namespace vesk::web
