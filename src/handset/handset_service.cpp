#include "handset/handset_service.h"

#include <algorithm>
#include <string>
#include <utility>

#include "handset/behaviour/triggers.h"

namespace vesk::handset {

using ::corvik::EventStream;

namespace {

const Text& nameOf(const HandsetEvent& event) {
  return event.kind == HandsetEvent::Kind::metric ? ::corvik::kEventMetric : ::corvik::kEventTrigger;
}

InterProcessDictionary messageOf(const HandsetEvent& event) {
  if (event.kind == HandsetEvent::Kind::metric) return ::corvik::makeMetricEvent(event.id, event.payload.bytes());
  InterProcessDictionary message;
  message.setInteger(::corvik::kKeyTriggerID, event.id);
  return message;
}

}  // namespace

HandsetService::HandsetService(std::uint64_t seed, std::uint64_t startMs, const Clock& clock)
    : clock_(clock), handset_(seed, startMs) {}

void HandsetService::start(EventStream& events) {
  thread_ = std::jthread([this, &events](const std::stop_token& stop) { play(stop, events); });
}

void HandsetService::endThread() {
  if (!thread_.joinable()) return;
  thread_.request_stop();
  interrupt_.signal();
  thread_.join();
  interrupt_.clear();
}

::corvik::Result HandsetService::answer(const ::corvik::MetricQuery& query, EventStream& events) {
  if (query.triggerId != kSimFilesTrigger) {
    return {::corvik::kStatusInvalidArgument, "no metric answers trigger " + std::to_string(query.triggerId)};
  }
  const std::lock_guard lock(mutex_);
  const HandsetEvent files = handset_.simFiles();
  events.raise(nameOf(files), messageOf(files));
  return {};
}

void HandsetService::play(const std::stop_token& stop, EventStream& events) {
  while (events.waitUntilWanted(stop)) {
    if (!event_) event_ = takeNext();
    waitUntil(event_->atMs);
    // It may have become unwanted in the meantime.
    if (!events.waitUntilWanted(stop)) return;
    events.deliver(nameOf(*event_), messageOf(*event_));
    event_.reset();
  }
}

HandsetEvent HandsetService::takeNext() {
  const std::lock_guard lock(mutex_);
  return handset_.next();
}

void HandsetService::waitUntil(std::int64_t atMs) {
  constexpr std::chrono::seconds kMostBehind{1};
  const Clock::Instant now = clock_.now();
  const Clock::Instant due = due_.value_or(now) + std::chrono::milliseconds(atMs - atMs_);
  // After a pause the handset goes on from where it stood, and does not catch up.
  due_ = due < now - kMostBehind ? now : due;
  atMs_ = atMs;
  clock_.sleepUntil(*due_, interrupt_);
}

}  // namespace vesk::handset
