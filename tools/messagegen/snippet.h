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

/// The same for a snippet of one line, without its line feed.
[[nodiscard]] std::string expandLine(std::string_view snippet, const Variables& variables);

/// `if (condition) statement`, on one line where it fits.
[[nodiscard]] std::string conditional(std::string_view condition, std::string_view statement);

/// `head { statement }`, on one line where it fits below a class.
[[nodiscard]] std::string inlineFunction(std::string_view head, std::string_view statement);

}  // namespace messagegen
