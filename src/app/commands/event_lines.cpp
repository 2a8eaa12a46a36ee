#include "app/commands/event_lines.h"

#include <optional>
#include <utility>
#include <variant>

#include "app/output/data_output.h"
#include "app/output/progress.h"
#include "app/source/events_input.h"
#include "app/source/recording_input.h"
#include "app/source/redaction.h"
#include "recording/recording_reader.h"

namespace vesk {

namespace {

/// Goes through a recording step by step; each step answers whether to go on.
class EventLines {
 public:
  using Append = std::function<void(std::string& out, const RecordedEvent& event)>;

  EventLines(const RecordingInput& input, Append append)
      : path_(input.path.value_or("-")),
        append_(std::move(append)),
        isRedacted_(input.isRedacted),
        input_(path_, input.sim) {
    input_.setBeforeRead([this](int) {
      output_.flush();
      return !output_.hasFailed();
    });
  }

  Outcome run() {
    if (const std::optional<std::string> failure = input_.open()) {
      fail("vesk: " + *failure);
      return output_.finish(outcome_);
    }
    if (progress_.isPossible()) duration_ = input_.duration();
    // A reader that is known is called directly.
    if (RecordingReader* recording = input_.recording()) {
      readAll(*recording);
    } else {
      readAll(input_);
    }
    progress_.hide();
    if (events_ == 0 && hasBadLines_) tellUser("vesk: " + remarkOnNoRecording(path_));
    for (const std::string& remark : input_.remarks())
      tellUser(remark);
    redaction_.tellLeftOut();
    return output_.finish(outcome_);
  }

  bool operator()(const RecordedEvent& event) {
    if (isRedacted_) {
      if (const std::optional<Data> payload = redaction_.redacted(event.metricId, event.payload))
        write({event.at, event.metricId, payload->bytes()});
    } else {
      write(event);
    }
    // So rarely that asking the clock costs nothing.
    if (++events_ % kEventsToProgress == 0) progress_.show(events_, event.at, duration_);
    return true;
  }

  bool operator()(const BadLine& bad) {
    hasBadLines_ = true;
    fail(bad.message);
    return true;
  }

  bool operator()(const ReadFailure& failure) {
    fail("vesk: " + failure.message);
    return false;
  }

  bool operator()(EndOfRecording /*end*/) { return false; }

 private:
  static constexpr std::uint64_t kEventsToProgress = 4096;

  template <class Events>
  void readAll(Events& events) {
    while (!output_.hasFailed() && std::visit(*this, events.next())) {
    }
  }

  void write(const RecordedEvent& event) {
    line_.clear();
    append_(line_, event);
    output_.writeLine(line_);
  }

  void fail(const std::string& reason) {
    progress_.hide();
    tellUser(reason);
    outcome_ = Outcome::failed;
  }

  const std::string path_;
  const Append append_;
  const bool isRedacted_;
  Redaction redaction_;
  EventsInput input_;
  DataOutput output_;
  Progress progress_{Progress::Output::meanwhile};
  std::optional<double> duration_;
  std::uint64_t events_ = 0;
  bool hasBadLines_ = false;
  std::string line_;
  Outcome outcome_ = Outcome::done;
};

}  // namespace

Outcome writeEventLines(const RecordingInput& input,
                        std::function<void(std::string& out, const RecordedEvent& event)> append) {
  return EventLines(input, std::move(append)).run();
}

}  // namespace vesk
