#include "web/report_page.h"

#include "insight/summary_form.h"
#include "values/json_form.h"
#include "web/drive_json.h"
#include "web/page_parts.h"

namespace vesk::web {

namespace {

/// JSON as it may stand in a script element, which it cannot end: "<" occurs in its texts alone.
std::string safeInScript(std::string_view json) {
  std::string safe;
  safe.reserve(json.size());
  for (const char character : json) {
    if (character == '<') {
      safe += "\\u003c";
    } else {
      safe += character;
    }
  }
  return safe;
}

/// Writes the page around its marks: `fill` is called with the name of each, and writes what stands there.
void fillIn(std::string_view page, const std::function<void(std::string_view piece)>& write,
            const std::function<void(std::string_view mark)>& fill) {
  constexpr std::string_view kBegin = "{{";
  constexpr std::string_view kEnd = "}}";
  for (;;) {
    const std::size_t begin = page.find(kBegin);
    write(page.substr(0, begin));
    if (begin == std::string_view::npos) return;
    const std::size_t end = page.find(kEnd, begin);
    fill(page.substr(begin + kBegin.size(), end - begin - kBegin.size()));
    page.remove_prefix(end + kEnd.size());
  }
}

std::string policyOfReport() {
  std::string policy = "<meta http-equiv=\"Content-Security-Policy\" content=\"default-src 'none'; base-uri 'none'; ";
  policy += "form-action 'none'; style-src '" + std::string(kPageStyle.hash) + "'; script-src '";
  policy += std::string(kChartScript.hash) + "' '" + std::string(kPageScript.hash) + "'\">";
  return policy;
}

std::string driveOfReport(const Report& report) {
  std::string json = "{\"title\":";
  appendJson(json, std::string_view(report.title));
  json += ",\"summary\":" + insight::summaryJson(report.insight) + ",\"drive\":";
  appendDriveJson(json, report.record, report.insight);
  json += ",\"screens\":";
  JsonWriter writer(json);
  writeScreensJson(writer, report.layout, report.readings);
  writer.finish();
  json += '}';
  return safeInScript(json);
}

}  // namespace

void writeReport(const Report& report, const std::function<void(std::string_view piece)>& write) {
  const auto inElement = [&](std::string_view begin, std::string_view content, std::string_view end) {
    write(begin);
    write(content);
    write(end);
  };
  fillIn(kPageHtml.content, write, [&](std::string_view mark) {
    if (mark == "policy") write(policyOfReport());
    if (mark == "style") inElement("<style>", kPageStyle.content, "</style>");
    if (mark == "drive")
      inElement("<script type=\"application/json\" id=\"report\">", driveOfReport(report), "</script>");
    if (mark != "script") return;
    inElement("<script>", kChartScript.content, "</script>\n");
    inElement("<script>", kPageScript.content, "</script>");
  });
}

}  // namespace vesk::web
