#include "app/commands/import_command.h"

#include <cstdint>
#include <string>
#include <utility>
#include <variant>

#include "app/commands/packet_table.h"
#include "app/output/data_output.h"
#include "app/output/progress.h"
#include "app/source/redaction.h"
#include "diag/capture/capture_reader.h"
#include "diag/capture/capture_remarks.h"
#include "diag/capture/content.h"
#include "recording/byte_input.h"
#include "recording/recorded_event.h"

namespace vesk {

namespace {

using diag::Content;

/// What a file is that holds no capture, and what to do; null for a capture.
const char* whyNotImported(Content content) {
  switch (content) {
    case Content::frames:
    case Content::packetList:
      return nullptr;
    case Content::nothing:
      return "is empty";
    case Content::recording:
      return "is a recording already";
    case Content::text:
      return "is text, and no capture of a diagnostic port";
    case Content::unknown:
      return "is no capture: it begins with neither frames nor log packets";
    case Content::networkCapture:
    case Content::archive:
      return diag::whyUnreadable(content);
  }
  return nullptr;
}

/// Imports a capture step by step.
class Importing {
 public:
  explicit Importing(const ImportOptions& options) : options_(options) {}

  Outcome run() {
    if (options_.layoutsOnly) {
      writeLayoutTable(output_);
      return output_.finish(Outcome::done);
    }
    ByteInput input(options_.input.path.value_or("-"));
    const Content content = diag::tellContent(input);
    if (input.failure()) return fail(*input.failure());
    if (const char* reason = whyNotImported(content)) return fail(input.name() + ' ' + reason);

    diag::CaptureReader capture(std::move(input), diag::captureFormOf(content).value(), options_.input.sim);
    capture.setBeforeRead([this](int) {
      output_.flush();
      return !output_.hasFailed();
    });
    const std::optional<std::string> failure = writeEvents(capture);
    const diag::PacketCounts& counts = capture.counts();
    if (options_.countsOnly) writePacketTable(output_, counts);
    for (const std::string& remark : remarksOn(capture))
      tellUser(remark);
    redaction_.tellLeftOut();
    if (failure) return fail(*failure);
    return output_.finish(Outcome::done);
  }

 private:
  static constexpr std::uint64_t kEventsToProgress = 4096;

  /// Why the capture could not be read to its end.
  std::optional<std::string> writeEvents(diag::CaptureReader& capture) {
    std::uint64_t events = 0;
    TimedEvents::Step step = capture.next();
    while (const auto* event = std::get_if<RecordedEvent>(&step)) {
      if (output_.hasFailed()) break;
      // So rarely that asking the clock costs nothing.
      if (++events % kEventsToProgress == 0) progress_.show(events, 0, std::nullopt);
      if (!options_.countsOnly) {
        write(*event);
      }
      step = capture.next();
    }
    progress_.hide();
    const auto* failure = std::get_if<ReadFailure>(&step);
    return failure == nullptr ? std::nullopt : std::optional(failure->message);
  }

  void write(const RecordedEvent& event) {
    std::optional<Data> redacted;
    if (options_.input.isRedacted) {
      redacted = redaction_.redacted(event.metricId, event.payload);
      if (!redacted) return;
    }
    line_.clear();
    appendRecordedEvent(line_, {event.at, event.metricId, redacted ? redacted->bytes() : event.payload});
    line_.pop_back();
    output_.writeLine(line_);
  }

  Outcome fail(const std::string& reason) {
    tellUser("vesk: " + reason);
    return output_.finish(Outcome::failed);
  }

  const ImportOptions& options_;
  Redaction redaction_;
  std::string line_;
  DataOutput output_;
  Progress progress_{Progress::Output::meanwhile};
};

}  // namespace

Outcome runImport(const ImportOptions& options) {
  return Importing(options).run();
}

}  // namespace vesk
