#include "app/commands/redact_command.h"

#include "app/commands/event_lines.h"

namespace vesk {

Outcome runRedact(const RecordingInput& input) {
  RecordingInput redacted = input;
  redacted.isRedacted = true;
  return writeEventLines(redacted, [](std::string& out, const RecordedEvent& event) {
    appendRecordedEvent(out, event);
    out.pop_back();
  });
}

}  // namespace vesk
