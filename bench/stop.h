#pragma once

#include <string_view>

namespace vesk::bench {

/// Ends the program with one line on standard error: what makes the measuring pointless.
[[noreturn]] void stop(std::string_view reason);

}  // namespace vesk::bench
