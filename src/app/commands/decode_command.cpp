#include "app/commands/decode_command.h"

#include "app/commands/event_lines.h"
#include "messages/registry/metric_classes.h"
#include "values/text_form.h"

namespace vesk {

namespace {

/// For every event: views, whose lengths are known, are appended in half the steps of characters up to a zero.
void appendDecodedEvent(std::string& out, const RecordedEvent& event) {
  using namespace std::string_view_literals;
  const MetricClass* metricClass = findMetricClass(event.metricId);
  out += "{\"at\":"sv;
  appendDecimal(out, event.at);
  out += ",\"metric\":"sv;
  appendMetricId(out, event.metricId);
  if (metricClass == nullptr) {
    out += R"(,"class":null,"status":"ignored","fields":null})";
    return;
  }
  out += ",\"class\":\""sv;
  out += metricClass->name;
  const std::size_t beforeStatus = out.size();
  out += R"(","status":"decoded","fields":)"sv;
  if (metricClass->appendJson(out, event.payload)) {
    out += '}';
  } else {
    out.resize(beforeStatus);
    out += R"(","status":"undecodable","fields":null})";
  }
}

}  // namespace

Outcome runDecode(const RecordingInput& input) {
  return writeEventLines(input, appendDecodedEvent);
}

}  // namespace vesk
