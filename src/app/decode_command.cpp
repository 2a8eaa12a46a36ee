#include "app/decode_command.h"

#include <optional>
#include <unistd.h>
#include <variant>

#include "app/data_output.h"
#include "app/json_form.h"
#include "corvik/recording_reader.h"
#include "messages/registry/metric_classes.h"
#include "platform/text_form.h"

namespace vesk {

namespace {

void appendDecodedEvent(std::string& out, const corvik::RecordedEvent& event) {
  const MetricClass* metricClass = findMetricClass(event.metricId);
  std::optional<Dictionary> fields;
  if (metricClass != nullptr) fields = metricClass->decode(event.payload);

  out += "{\"at\":";
  appendDecimal(out, event.at);
  out += ",\"metric\":";
  corvik::appendMetricId(out, event.metricId);
  out += ",\"class\":";
  if (metricClass == nullptr) {
    out += "null";
  } else {
    appendJson(out, metricClass->name);
  }
  out += ",\"status\":\"";
  out += fields ? "decoded" : metricClass == nullptr ? "ignored" : "undecodable";
  out += "\",\"fields\":";
  if (fields) {
    appendJson(out, *fields);
  } else {
    out += "null";
  }
  out += '}';
}

/// Decodes a recording step by step; each step answers whether to go on.
class Decoding {
 public:
  explicit Decoding(const std::string& path) : reader_(path) {
    reader_.setBeforeRead([this](int) {
      output_.flush();
      return !output_.hasFailed();
    });
  }

  Outcome run() {
    while (!output_.hasFailed() && std::visit(*this, reader_.next())) {
    }
    return output_.finish(outcome_);
  }

  bool operator()(const corvik::RecordedEvent& event) {
    line_.clear();
    appendDecodedEvent(line_, event);
    output_.writeLine(line_);
    return true;
  }

  bool operator()(const corvik::BadLine& bad) {
    fail(bad.message);
    return true;
  }

  bool operator()(const corvik::ReadFailure& failure) {
    fail("vesk: " + failure.message);
    return false;
  }

  bool operator()(corvik::EndOfRecording /*end*/) { return false; }

 private:
  void fail(const std::string& reason) {
    tellUser(reason);
    outcome_ = Outcome::failed;
  }

  corvik::RecordingReader reader_;
  DataOutput output_;
  std::string line_;
  Outcome outcome_ = Outcome::done;
};

}  // namespace

Outcome runDecode(const std::string& path) {
  return Decoding(path).run();
}

}  // namespace vesk
