#pragma once

#include <string_view>

/// The parts of the page, which stand in the program.
namespace vesk::web {

struct PagePart {
  std::string_view content;
  /// Of the content, as a Content-Security-Policy names it: "sha256-…".
  std::string_view hash;
};

/// HTML with {{policy}}, {{style}}, {{drive}} and {{script}} where these belong.
extern const PagePart kPageHtml;
extern const PagePart kPageStyle;
extern const PagePart kPageIcon;
/// The charts of dygraphs, then the page's own script.
extern const PagePart kChartScript;
extern const PagePart kPageScript;

}  // namespace vesk::web
