#pragma once

#include <map>
#include <string>
#include <string_view>

namespace messagegen {

using Variables = std::map<std::string, std::string, std::less<>>;

/// The widest line of emitted code.
inline constexpr std::size_t kLineWidth = 120;

/// Fills in a snippet of code. `$name$` stands for a variable, `$$` for a dollar sign. The snippet's own
/// indentation (that of its first line) and the line feed after its opening quote are taken off. A variable
/// that stands alone on its line may have many lines: each is indented like the placeholder; an empty one
/// takes its line away. Throws std::logic_error that quotes the snippet when it names an unknown variable.
[[nodiscard]] std::string expand(std::string_view snippet, const Variables& variables);

/// The same for a part of a line.
[[nodiscard]] std::string expandInline(std::string_view snippet, const Variables& variables);

/// The same for statements `if (condition) action` and functions `head { action }` that will stand indented by one
/// level: where one is too long for its line, the action gets a line of its own, between braces.
[[nodiscard]] std::string expandToFit(std::string_view snippet, const Variables& variables);

}  // namespace messagegen
