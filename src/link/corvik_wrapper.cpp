#include "link/corvik_wrapper.h"

#include <optional>
#include <utility>

#include "system/file.h"
#include "system/main_queue.h"
#include "system/system_log.h"
#include "values/text_form.h"

namespace vesk {

namespace {

namespace client = corvik::client;

constexpr const char* kClientName = "vesk";
constexpr const char* kQueueLabel = "org.vesk.serialQ.queue";
/// What the service knows the application by, whatever a caller calls it.
constexpr std::int64_t kServiceAppId = 2;
constexpr std::int64_t kPayloadType = 0;

constexpr const char* kAddOperation = "-[CorvikWrapper addQuodraConfigForAppId:andProtofFilePath:]";
constexpr const char* kRemoveOperation = "-[CorvikWrapper removeQuodraConfigForAppid:]";
constexpr const char* kQueryOperation =
    "-[CorvikWrapper querySpecificMetric:triggerRef:triggerType:triggerID:profileID:metricID:]";
constexpr const char* kListenOperation = "-[CorvikWrapper listen]";
constexpr const char* kListenHandler = "-[CorvikWrapper listen]_block_invoke";

}  // namespace

std::shared_ptr<CorvikWrapper> CorvikWrapper::sharedInstance() {
  static const std::shared_ptr<CorvikWrapper> theWrapper = make();
  return theWrapper;
}

std::shared_ptr<CorvikWrapper> CorvikWrapper::make() {
  // The queue is needed to the wrapper's end, and so has to be there before it.
  MainQueue& mainQueue = MainQueue::shared();
  return {new CorvikWrapper, [&mainQueue](CorvikWrapper* wrapper) {
            mainQueue.post([ended = std::unique_ptr<CorvikWrapper>(wrapper)] {});
          }};
}

WorkQueue& CorvikWrapper::queue() {
  static WorkQueue theQueue(kQueueLabel);
  return theQueue;
}

CorvikWrapper::CorvikWrapper() : corvikManager_(client::CreateManager(kClientName, queue())) {}

bool CorvikWrapper::addQuodraConfigForAppId(std::string_view appId, const std::string& protofFilePath) {
  if (appId != kClientName) return false;
  InterProcessDictionary message;
  std::optional<Data> payload = readFile(protofFilePath);
  if (!payload) return false;
  message.setInteger(corvik::kKeyAppID, kServiceAppId);
  message.setData(corvik::kKeyPayload, *std::move(payload));
  message.setInteger(corvik::kKeyPayloadType, kPayloadType);
  return perform(kAddOperation, corvik::kCommandAddConfiguration, message);
}

bool CorvikWrapper::removeQuodraConfigForAppid(std::string_view appId) {
  if (appId != kClientName) return false;
  InterProcessDictionary message;
  message.setInteger(corvik::kKeyAppID, kServiceAppId);
  return perform(kRemoveOperation, corvik::kCommandClearConfiguration, message);
}

bool CorvikWrapper::querySpecificMetric(std::string_view appId, std::int32_t triggerRef, std::int32_t triggerType,
                                        std::int32_t triggerId, std::int32_t profileId, std::int32_t metricId) {
  if (appId != kClientName) return false;
  InterProcessDictionary message;
  message.setInteger(corvik::kKeyAppID, kServiceAppId);
  message.setInteger(corvik::kKeyPayloadType, kPayloadType);
  message.setInteger(corvik::kKeyTriggerRef, triggerRef);
  message.setInteger(corvik::kKeyTriggerType, triggerType);
  message.setInteger(corvik::kKeyTriggerID, triggerId);
  message.setInteger(corvik::kKeyProfileID, profileId);
  message.setInteger(corvik::kKeyMetricID, metricId);
  return perform(kQueryOperation, corvik::kCommandQueryMetric, message);
}

bool CorvikWrapper::perform(const char* operation, const Text& command, const InterProcessDictionary& message) {
  InterProcessDictionary reply;
  const corvik::Result result = client::PerformCommand(corvikManager_, command, message, reply);
  SystemLog::write("%s: error=%d msg=%s", operation, result.code, result.message.c_str());
  return result.code == 0;
}

void CorvikWrapper::listen() {
  forward(corvik::kEventTrigger, "EventTrigger", &CorvikWrapperDelegate::eventsDidUpdate);
  forward(corvik::kEventMetric, "MetricsTrigger", &CorvikWrapperDelegate::metricsDidUpdate);
  client::EventsOff(corvikManager_);
  client::EventsOn(corvikManager_);
  SystemLog::write("%s: listening for events", kListenOperation);
}

void CorvikWrapper::forward(const Text& event, const char* label, Deliver deliver) {
  // The manager holds the handlers and the wrapper the manager: a handler must not hold the wrapper.
  client::RegisterEventHandler(
      corvikManager_, event,
      [weak = weak_from_this(), label, deliver](const InterProcessDictionary& raised, const client::WorkGroup&) {
        if (const auto self = weak.lock()) self->forward(raised, label, deliver);
      });
}

void CorvikWrapper::forward(const InterProcessDictionary& event, const char* label, Deliver deliver) {
  std::optional<Dictionary> dictionary = event.ordinary();
  if (!dictionary) {
    SystemLog::write("%s: %s dropped: it has no ordinary form", kListenHandler, label);
    return;
  }
  if (SystemLog::isOpen()) {
    SystemLog::write("%s: %s dict=%s", kListenHandler, label, textOf(*dictionary).c_str());
  }
  if (!isDelegateSet_) return;
  // The wrapper is there until what it has scheduled is done.
  MainQueue::shared().post([this, dictionary = std::move(dictionary), deliver] {
    if (const auto delegate = this->delegate()) ((*delegate).*deliver)(dictionary);
  });
}

void CorvikWrapper::setDelegate(std::weak_ptr<CorvikWrapperDelegate> delegate) {
  delegate_ = std::move(delegate);
  isDelegateSet_ = !delegate_.expired();
}

}  // namespace vesk
