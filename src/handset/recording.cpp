#include "handset/recording.h"

#include <string>

#include "recording/recorded_event.h"

namespace vesk::handset {

namespace {

/// From the start to the client's query.
constexpr std::int64_t kSimQueryMs = 500;

}  // namespace

void recordDrive(Handset& handset, double seconds, const std::function<bool(std::string_view line)>& write) {
  std::string line;
  const auto record = [&](const HandsetEvent& event) {
    line.clear();
    appendRecordedEvent(line, {static_cast<double>(event.atMs) / 1000, event.id, event.payload.bytes()});
    return write(line);
  };

  bool hasAskedSim = false;
  for (HandsetEvent event = handset.next(); static_cast<double>(event.atMs) <= 1000 * seconds; event = handset.next()) {
    if (event.kind == HandsetEvent::Kind::trigger) continue;
    if (!record(event)) return;
    if (!hasAskedSim && event.atMs >= kSimQueryMs) {
      hasAskedSim = true;
      if (!record(handset.simFiles())) return;
    }
  }
}

}  // namespace vesk::handset
