#pragma once

#include <string>
#include <utility>
#include <vector>

#include "insight/timeline_event.h"

namespace vesk {

/// The fields of the event's JSON object: each key with its value as JSON, texts without their quotes.
[[nodiscard]] std::vector<std::pair<std::string, std::string>> fieldsOf(const insight::TimelineEvent& event);

}  // namespace vesk
