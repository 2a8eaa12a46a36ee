// The first byte says how long a line may be, the second into what pieces a pipe brings the input; the others are a
// recording.

#include "property.h"
#include "recording/recording_reader.h"
#include "recording_outcomes.h"
#include "values/text_form.h"

namespace vesk {
namespace {

const std::string kGoodLine = R"({"at": 1.5, "metric": "0x3C4E04", "payload": "1003"})";
const std::string kGoodEvent = "1.5 3952132 1003";

void checkDuration(std::string_view content, const Outcomes& outcomes) {
  std::string last = "none";
  for (const Outcome& each : outcomes) {
    if (!each.text.starts_with("recording:")) last = each.text.substr(0, each.text.find(' '));
  }
  std::string duration = "none";
  if (const auto seconds = RecordingReader(fileOf(content), "recording", content.size()).duration()) {
    duration.clear();
    appendDecimal(duration, *seconds);
  }
  require(duration == last, "a recording lasts until its last event");
}

void checkRecording(std::string_view content, std::size_t longestLine, std::size_t pieceSize) {
  if (content.starts_with("\x1F\x8B\x08")) {
    // Compressed: what its lines are is known to the reader alone.
    require(readPipe(content, longestLine, pieceSize) == readFile(content, longestLine),
            "the pieces in which a compressed recording comes do not matter");
    return;
  }
  const Outcomes expected = expectedOutcomes(content, longestLine);
  require(readFile(content, longestLine) == expected, "each line has one outcome, whatever stands around it");
  require(readPipe(content, longestLine, pieceSize) == expected, "the pieces in which a recording comes do not matter");

  const std::string surrounded = kGoodLine + '\n' + std::string(content) + '\n' + kGoodLine;
  const Outcomes outcomes = readFile(surrounded, longestLine);
  require(outcomes.size() >= 2 && outcomes.front().text == kGoodEvent && outcomes.back().text == kGoodEvent,
          "events before and behind any bytes are read");
  if (longestLine > content.size()) checkDuration(content, expected);
}

}  // namespace
}  // namespace vesk

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  constexpr std::size_t kLongestLines[] = {80, 300, 4096};
  if (size < 2) return 0;
  const std::string_view content(reinterpret_cast<const char*>(data) + 2, size - 2);
  vesk::checkRecording(content, kLongestLines[data[0] % std::size(kLongestLines)], 1 + data[1]);
  return 0;
}
