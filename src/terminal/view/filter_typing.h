#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "terminal/input/input_event.h"

namespace vesk {

/// What a key makes of a filter that is being typed.
struct TypedFilter {
  std::string filter;
  /// Whether more is typed.
  bool goesOn;
};

/// Absent for the keys that mean the same while a filter is typed.
[[nodiscard]] std::optional<TypedFilter> typeInto(std::string filter, const KeyEvent& event);

/// The filter with the first line of a pasted text behind it.
[[nodiscard]] std::string pasteInto(std::string filter, std::string_view text);

}  // namespace vesk
