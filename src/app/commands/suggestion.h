#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace vesk {

/// "; did you mean X" with the candidate that `typed` most likely stands for, small and capital letters alike, between
/// `quotes`: the nearest one, or the first that holds what was typed. Empty when there is none.
[[nodiscard]] std::string suggestionFor(std::string_view typed, const std::vector<std::string>& candidates,
                                        std::string_view quotes = {});

}  // namespace vesk
