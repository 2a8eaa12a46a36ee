#include "app/commands/decode_command.h"

#include "app/commands/event_lines.h"
#include "messages/registry/metric_classes.h"
#include "values/text_form.h"

namespace vesk {

namespace {

void appendDecodedEvent(std::string& out, const RecordedEvent& event) {
  const MetricClass* metricClass = findMetricClass(event.metricId);
  out += "{\"at\":";
  appendDecimal(out, event.at);
  out += ",\"metric\":";
  appendMetricId(out, event.metricId);
  if (metricClass == nullptr) {
    out += R"(,"class":null,"status":"ignored","fields":null})";
    return;
  }
  out += ",\"class\":\"";
  out += metricClass->name;
  const std::size_t beforeStatus = out.size();
  out += R"(","status":"decoded","fields":)";
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
