#include "intake/metric_validator.h"

#include <string>

#include "corvik/constants.h"
#include "intake/metric_table.h"
#include "intake/value_conversions.h"
#include "system/output_lines.h"
#include "values/text_form.h"

namespace vesk {

namespace {

const Text& metricIDKey = corvik::kKeyMetricID;
const Text& payloadKey = corvik::kKeyPayload;

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

/// The record's timestamp while it is a number; absent when it is none that fits.
OptionalNumber<std::int64_t> millisecondsOf(const Record& record) {
  const Value* timestamp = record.find("timestamp"_text);
  return timestamp == nullptr ? std::nullopt : timestamp->integer();
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

void MetricValidator::startAnew() {
  metricID.reset();
  stores = {};
}

bool MetricValidator::validateMetric(const Dictionary& event) {
  const TakenEvent taken = take(event);
  if (eventObserver_) eventObserver_(taken);
  if (taken.fate == EventFate::stored) return true;
  OutputLines::print({"I dont care for this Metric"});
  return false;
}

TakenEvent MetricValidator::take(const Dictionary& event) {
  const Value* id = event.find(metricIDKey);
  // In its parts: to copy an optional just after its two parts were written stalls the processor.
  metricID.reset();
  if (id != nullptr)
    if (const auto number = id->integer()) metricID = *number;
  if (metricID && OutputLines::isOpen()) OutputLines::print({"Metric ID in Hex = ", hexadecimal(*metricID)});

  const HandledMetric* metric = metricID ? findHandledMetric(*metricID) : nullptr;
  if (metric == nullptr) return {.fate = EventFate::ignored, .metricId = metricID};
  std::optional<Record> record = metric->decode(payloadOf(event));
  if (!record) return {.fate = EventFate::undecodable, .metricId = metricID};
  const auto timestamp = eventObserver_ ? millisecondsOf(*record) : std::nullopt;
  return {EventFate::stored, metricID, timestamp, &store(*metric, std::move(*record))};
}

const Record& MetricValidator::store(const HandledMetric& metric, Record newRecord) {
  Record& record = (stores.*metric.record).emplace(std::move(newRecord));
  const auto runExtraStep = [&] {
    if (metric.extraStep != nullptr) metric.extraStep({record, stores, dates_});
  };
  switch (metric.order) {
    case StepOrder::timestampLogExtra:
      formatTimestamp(record, dates_);
      printRecord(metric.logText, record);
      runExtraStep();
      break;
    case StepOrder::timestampExtraLog:
      formatTimestamp(record, dates_);
      runExtraStep();
      printRecord(metric.logText, record);
      break;
    case StepOrder::logTimestampExtra:
      printRecord(metric.logText, record);
      formatTimestamp(record, dates_);
      runExtraStep();
      break;
    case StepOrder::logExtra:
      printRecord(metric.logText, record);
      runExtraStep();
      break;
  }
  return record;
}

}  // namespace vesk
