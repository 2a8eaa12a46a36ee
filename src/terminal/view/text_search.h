#pragma once

#include <string_view>

namespace vesk {

/// Whether `part` stands in `whole`; ASCII letters match in either case.
[[nodiscard]] bool containsIgnoringCase(std::string_view whole, std::string_view part);

}  // namespace vesk
