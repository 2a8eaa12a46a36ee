#include "app/source/redaction.h"

#include <string>
#include <utility>

#include "app/output/outcome.h"
#include "insight/redaction.h"

namespace vesk {

namespace {

/// Stands between a service and its client.
class RedactedService final : public corvik::Service, private corvik::EventStream {
 public:
  RedactedService(std::shared_ptr<corvik::Service> service, Redaction& redaction)
      : service_(std::move(service)), redaction_(redaction) {}

  [[nodiscard]] corvik::Result perform(const Text& command, const InterProcessDictionary& message) override {
    return service_->perform(command, message);
  }

 private:
  void start(corvik::EventStream& events) override {
    events_ = &events;
    service_->connect(*this);
  }
  void stop() override { service_->shutDown(); }
  /// The service behind answers all commands itself.
  [[nodiscard]] corvik::Result answer(const corvik::MetricQuery& /*query*/, corvik::EventStream& /*events*/) override {
    return {};
  }

  void raise(const Text& event, InterProcessDictionary message) override {
    if (auto redacted = redactedMessage(event, message)) events_->raise(event, *std::move(redacted));
  }
  void deliver(const Text& event, InterProcessDictionary message) override {
    if (auto redacted = redactedMessage(event, message)) events_->deliver(event, *std::move(redacted));
  }
  void afterDelivery(Task task) override { events_->afterDelivery(std::move(task)); }
  [[nodiscard]] bool waitUntilWanted(const std::stop_token& stop) override { return events_->waitUntilWanted(stop); }

  [[nodiscard]] std::optional<InterProcessDictionary> redactedMessage(const Text& event,
                                                                      const InterProcessDictionary& message) {
    const std::optional<std::int64_t> metricId = message.integer(corvik::kKeyMetricID);
    if (event != corvik::kEventMetric || !metricId) {
      redaction_.leaveOut();
      return std::nullopt;
    }
    const Data* payload = message.data(corvik::kKeyPayload);
    const std::optional<Data> redacted =
        redaction_.redacted(*metricId, payload == nullptr ? std::span<const std::uint8_t>{} : payload->bytes());
    if (!redacted) return std::nullopt;
    return corvik::makeMetricEvent(*metricId, redacted->bytes());
  }

  std::shared_ptr<corvik::Service> service_;
  Redaction& redaction_;
  corvik::EventStream* events_ = nullptr;
};

}  // namespace

std::optional<Data> Redaction::redacted(std::int64_t metricId, std::span<const std::uint8_t> payload) {
  std::optional<Data> redacted = insight::redactedPayload(metricId, payload);
  if (!redacted) leaveOut();
  return redacted;
}

void Redaction::tellLeftOut() const {
  const std::uint64_t count = leftOut_;
  if (count == 0) return;
  tellUser("vesk: " + std::to_string(count) +
           (count == 1 ? " event was left out: it could" : " events were left out: they could") +
           " not be decoded, and might hold an identity");
}

std::shared_ptr<corvik::Service> makeRedactedService(std::shared_ptr<corvik::Service> service, Redaction& redaction) {
  return std::make_shared<RedactedService>(std::move(service), redaction);
}

}  // namespace vesk
