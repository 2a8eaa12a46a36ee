#pragma once

#include <cstddef>
#include <optional>
#include <string_view>

#include "insight/reading.h"

namespace vesk {

/// What the value in a row of a category's screen means, by what the stores hold now; absent where nothing is to be
/// said.
[[nodiscard]] std::optional<insight::Reading> readingOfRow(std::string_view area, std::string_view category,
                                                           std::size_t section, std::size_t row);

}  // namespace vesk
