#include "intake/metric_validator.h"

#include <string>

#include "intake/metric_table.h"
#include "system/output_lines.h"
#include "values/text_form.h"

namespace vesk {

namespace {

const Text metricIDKey = "kKeyMetricID"_text;
const Text payloadKey = "kKeyPayload"_text;

/// Of at least two characters, as of an unsigned number.
std::string hexadecimal(std::int64_t number) {
  std::string text;
  appendUpperHex(text, static_cast<std::uint64_t>(number));
  return text.size() < 2 ? " " + text : text;
}

std::span<const std::uint8_t> payloadOf(const Dictionary& event) {
  const Value* payload = event.find(payloadKey);
  const Data* data = payload == nullptr ? nullptr : payload->data();
  return data == nullptr ? std::span<const std::uint8_t>{} : data->bytes();
}

void printRecord(std::string_view logText, const Dictionary& record) {
  if (OutputLines::isOpen()) OutputLines::print({logText, textOf(record)});
}

void printNotHandled() {
  OutputLines::print({"I dont care for this Metric"});
}

}  // namespace

const std::shared_ptr<MetricValidator>& MetricValidator::shared() {
  static const std::shared_ptr<MetricValidator> theIntake = listeningTo(CorvikWrapper::sharedInstance());
  return theIntake;
}

std::shared_ptr<MetricValidator> MetricValidator::listeningTo(std::shared_ptr<CorvikWrapper> wrapper) {
  std::shared_ptr<MetricValidator> intake(new MetricValidator);
  intake->mySharedCorvikInstance = std::move(wrapper);
  if (intake->mySharedCorvikInstance != nullptr) {
    intake->mySharedCorvikInstance->listen();
    intake->mySharedCorvikInstance->setDelegate(intake);
  }
  return intake;
}

void MetricValidator::metricsDidUpdate(const std::optional<Dictionary>& event) {
  static const Dictionary kNothing;
  if (!validateMetric(event ? *event : kNothing)) return;
  OutputLines::print({"Received Valid Metric"});
  if (arrivalObserver_) arrivalObserver_(*metricID);
}

void MetricValidator::eventsDidUpdate(const std::optional<Dictionary>& /*event*/) {
  OutputLines::print({"I dont care for events"});
}

bool MetricValidator::validateMetric(const Dictionary& event) {
  const Value* id = event.find(metricIDKey);
  metricID = id == nullptr ? std::nullopt : id->integer();
  if (metricID && OutputLines::isOpen()) OutputLines::print({"Metric ID in Hex = ", hexadecimal(*metricID)});

  const HandledMetric* metric = metricID ? findHandledMetric(*metricID) : nullptr;
  LatestRecord fields;
  if (metric != nullptr) fields = metric->decode(payloadOf(event));
  if (!fields) {
    printNotHandled();
    return false;
  }

  LatestRecord& record = this->*metric->record;
  record = std::move(fields);
  const auto runExtraStep = [&] {
    if (metric->extraStep != nullptr) metric->extraStep(*this);
  };
  switch (metric->order) {
    case StepOrder::timestampLogExtra:
      formatTimestampOf(*record);
      printRecord(metric->logText, *record);
      runExtraStep();
      break;
    case StepOrder::timestampExtraLog:
      formatTimestampOf(*record);
      runExtraStep();
      printRecord(metric->logText, *record);
      break;
    case StepOrder::logTimestampExtra:
      printRecord(metric->logText, *record);
      formatTimestampOf(*record);
      runExtraStep();
      break;
    case StepOrder::logExtra:
      printRecord(metric->logText, *record);
      runExtraStep();
      break;
  }
  return true;
}

void MetricValidator::formatTimestampOf(Record& record) {
  Value* timestamp = record.findForChange("timestamp"_text);
  const std::optional<double> milliseconds = timestamp == nullptr ? std::nullopt : timestamp->number();
  if (!milliseconds) return;
  date_.clear();
  dateFormat_.append(date_, *milliseconds);
  *timestamp = Text::copy(date_);
}

}  // namespace vesk
