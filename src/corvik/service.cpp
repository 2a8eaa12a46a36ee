#include "corvik/service.h"

#include <utility>

namespace corvik {

namespace {

std::shared_ptr<Service>& theService() {
  static std::shared_ptr<Service> service;
  return service;
}

Result checkConfiguration(const vesk::InterProcessDictionary& message) {
  const vesk::Data* payload = message.data(kKeyPayload);
  if (payload == nullptr) return {kStatusInvalidArgument, "configuration without a payload"};
  if (payload->bytes().empty()) return {kStatusInvalidArgument, "empty configuration"};
  return {};
}

}  // namespace

vesk::InterProcessDictionary makeMetricEvent(std::int64_t metricId, std::span<const std::uint8_t> payload) {
  vesk::InterProcessDictionary event;
  event.reserve(2);
  event.appendInteger(kKeyMetricID, metricId);
  event.appendData(kKeyPayload, vesk::Data::copy(payload));
  return event;
}

void Service::connect(EventStream& events) {
  shutDown();
  events_ = &events;
  start(events);
}

void Service::disconnect(EventStream& events) {
  if (events_ == &events) shutDown();
}

void Service::shutDown() {
  if (events_ != nullptr) stop();
  events_ = nullptr;
}

Result Service::perform(const vesk::Text& command, const vesk::InterProcessDictionary& message) {
  if (events_ == nullptr) return {kStatusNoService, "no client is connected"};
  if (refusal_) return *refusal_;
  if (command == kCommandAddConfiguration) return checkConfiguration(message);
  if (command == kCommandClearConfiguration) return {};
  if (command == kCommandQueryMetric) return query(message);
  return {kStatusUnknownCommand, "unknown command " + std::string(command.view())};
}

Result Service::query(const vesk::InterProcessDictionary& message) {
  MetricQuery asked{};
  const std::pair<const vesk::Text*, std::int64_t*> arguments[] = {
      {&kKeyTriggerRef, &asked.triggerRef}, {&kKeyTriggerType, &asked.triggerType}, {&kKeyTriggerID, &asked.triggerId},
      {&kKeyProfileID, &asked.profileId},   {&kKeyMetricID, &asked.metricId},
  };
  for (const auto& [key, argument] : arguments) {
    const std::optional<std::int64_t> value = message.integer(*key);
    if (!value) return {kStatusInvalidArgument, "query without " + std::string(key->view())};
    *argument = *value;
  }
  return answer(asked, *events_);
}

void installService(std::shared_ptr<Service> service) {
  theService() = std::move(service);
}

std::shared_ptr<Service> installedService() {
  return theService();
}

}  // namespace corvik
