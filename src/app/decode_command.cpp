#include "app/decode_command.h"

#include <optional>
#include <string>
#include <variant>

#include "app/data_output.h"
#include "app/events_input.h"
#include "app/progress.h"
#include "app/recording_hint.h"
#include "messages/registry/metric_classes.h"
#include "recording/recording_reader.h"
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

/// Decodes a recording step by step; each step answers whether to go on.
class Decoding {
 public:
  explicit Decoding(const std::string& path) : path_(path), input_(path, std::nullopt) {
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
      decode(*recording);
    } else {
      decode(input_);
    }
    progress_.hide();
    if (events_ == 0 && hasBadLines_) tellIsNoRecording(path_);
    for (const std::string& remark : input_.remarks())
      tellUser(remark);
    return output_.finish(outcome_);
  }

  bool operator()(const RecordedEvent& event) {
    line_.clear();
    appendDecodedEvent(line_, event);
    output_.writeLine(line_);
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
  void decode(Events& events) {
    while (!output_.hasFailed() && std::visit(*this, events.next())) {
    }
  }

  void fail(const std::string& reason) {
    progress_.hide();
    tellUser(reason);
    outcome_ = Outcome::failed;
  }

  const std::string& path_;
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

Outcome runDecode(const std::string& path) {
  return Decoding(path).run();
}

}  // namespace vesk
