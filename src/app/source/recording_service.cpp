#include "app/source/recording_service.h"

#include <algorithm>
#include <cmath>
#include <utility>

#include "recording/recorded_event.h"

namespace vesk {

RecordingService::RecordingService(std::shared_ptr<corvik::Service> service, std::unique_ptr<RecordFile> file,
                                   std::function<double()> seconds, FailureHandler onFailure)
    : service_(std::move(service)),
      file_(std::move(file)),
      seconds_(std::move(seconds)),
      onFailure_(std::move(onFailure)) {}

corvik::Result RecordingService::perform(const Text& command, const InterProcessDictionary& message) {
  return service_->perform(command, message);
}

corvik::Result RecordingService::answer(const corvik::MetricQuery&, corvik::EventStream&) {
  return {};
}

void RecordingService::start(corvik::EventStream& events) {
  client_ = &events;
  service_->connect(*this);
}

void RecordingService::stop() {
  service_->disconnect(*this);
}

void RecordingService::raise(const Text& event, InterProcessDictionary message) {
  record(event, message);
  client_->raise(event, std::move(message));
}

void RecordingService::deliver(const Text& event, InterProcessDictionary message) {
  record(event, message);
  client_->deliver(event, std::move(message));
}

void RecordingService::afterDelivery(Task task) {
  client_->afterDelivery(std::move(task));
}

bool RecordingService::waitUntilWanted(const std::stop_token& stop) {
  return client_->waitUntilWanted(stop);
}

void RecordingService::record(const Text& event, const InterProcessDictionary& message) {
  const std::optional<std::int64_t> metricId = message.integer(corvik::kKeyMetricID);
  const Data* payload = message.data(corvik::kKeyPayload);
  if (event != corvik::kEventMetric || !metricId || payload == nullptr) return;

  const std::lock_guard lock(mutex_);
  if (file_->failure()) return;
  // A recording that is played in a loop goes back; what is recorded of it does not.
  const double now = std::round(seconds_() * 1000) / 1000;
  at_ += std::max(0.0, now - last_.value_or(now));
  last_ = now;
  line_.clear();
  appendRecordedEvent(line_, {std::round(at_ * 1000) / 1000, *metricId, payload->bytes()});
  if (!file_->append(line_) && onFailure_)
    client_->afterDelivery([tell = onFailure_, reason = *file_->failure()] { tell(reason); });
}

}  // namespace vesk
