#include "app/commands/redact_command.h"

#include "app/commands/event_lines.h"

namespace vesk {

Outcome runRedact(const RecordingInput& input) {
  return writeEventLines({input.path, true}, [](std::string& out, const RecordedEvent& event) {
    appendRecordedEvent(out, event);
    out.pop_back();
  });
}

}  // namespace vesk
