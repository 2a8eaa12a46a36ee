#pragma once

#include <string_view>

namespace vesk {

/// How a command ends; the values are its exit statuses.
enum class Outcome : int { done = 0, failed = 1, wrongUsage = 2 };

/// Writes one line to standard error, control characters made visible.
void tellUser(std::string_view line);

}  // namespace vesk
