#pragma once

#include <optional>
#include <string_view>

#include "terminal/input/input_event.h"

namespace vesk {

/// The event of a whole CSI sequence, given without its ESC [: "A", "1;5C", "5~", "<0;3;7M". Absent for those
/// that mean nothing here.
[[nodiscard]] std::optional<InputEvent> eventOfCsi(std::string_view sequence);

/// The event of a whole SS3 sequence, given without its ESC O: "A", "5A", "M".
[[nodiscard]] std::optional<InputEvent> eventOfSs3(std::string_view sequence);

}  // namespace vesk
