#pragma once

#include <string>
#include <string_view>

namespace vesk {

/// Appends `text` as valid UTF-8 in which nothing acts on a terminal: control characters become their number,
/// as in \x1B or \x0A, and bytes that are no characters become U+FFFD.
void appendVisible(std::string& out, std::string_view text);

}  // namespace vesk
