#pragma once

#include <cstdint>

namespace vesk {

/// How many steps, stretches of code without a branch, the program has taken since its start. Only code that is
/// compiled with -fsanitize-coverage=trace-pc counts, and steps.cpp itself must not be.
[[nodiscard]] std::uint64_t stepsTaken();

}  // namespace vesk
