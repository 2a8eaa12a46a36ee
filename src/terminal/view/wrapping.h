#pragma once

#include <string_view>
#include <vector>

namespace vesk {

/// Cuts `text` into lines of at most `width` columns (at least 2): at its line feeds, else after a blank
/// where there is one, else anywhere between glyphs. The views have neither the line feeds nor the blanks of
/// a cut. Empty text is one empty line.
[[nodiscard]] std::vector<std::string_view> wrapText(std::string_view text, int width);

}  // namespace vesk
