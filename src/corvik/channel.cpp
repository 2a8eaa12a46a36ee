#include "corvik/channel.h"

#include <utility>

#include "system/main_queue.h"

namespace corvik::client {

namespace {

/// How many events a source may get ahead, on each of the two queues that an event passes: so far that the threads
/// seldom wait for each other, for waking one costs as much as some ten events.
constexpr std::size_t kMostWaiting = 1024;
/// And after a large one: so little that events of megabytes still fit.
constexpr std::size_t kMostWaitingBehindLarge = 8;
/// Bytes of payload.
constexpr std::size_t kLarge = 512;

bool isLarge(const vesk::InterProcessDictionary& message) {
  const vesk::Data* payload = message.data(kKeyPayload);
  return payload != nullptr && payload->bytes().size() > kLarge;
}

}  // namespace

Channel::Channel(vesk::WorkQueue& queue)
    : queue_(queue), handlers_(registered_.emplace_back(std::make_unique<Handlers>()).get()) {
  deliveries_.suspend();
}

void Channel::setHandler(const vesk::Text& event, EventHandler handler) {
  const std::lock_guard lock(lock_);
  auto handlers = std::make_unique<Handlers>(*handlers_);
  if (event == kEventMetric) {
    handlers->metric = std::move(handler);
  } else if (event == kEventTrigger) {
    handlers->trigger = std::move(handler);
  }
  handlers_ = registered_.emplace_back(std::move(handlers)).get();
}

void Channel::setConfigured(bool isConfigured) {
  const std::lock_guard lock(lock_);
  isConfigured_ = isConfigured;
  wanted_.notify_all();
}

void Channel::setEventsOn(bool isOn) {
  {
    const std::lock_guard lock(lock_);
    if (isOn) {
      deliveries_.resume();
    } else {
      deliveries_.suspend();
    }
    wanted_.notify_all();
  }
  if (isOn) scheduleDeliveries();
}

bool Channel::waitUntilWanted(const std::stop_token& stop) {
  if (!isWanted()) {
    std::unique_lock lock(lock_);
    if (!wanted_.wait(lock, stop, [this] { return isWanted(); })) return false;
  }
  const std::size_t most = isLargeAhead_ && isLargeAhead_.exchange(false) ? kMostWaitingBehindLarge : kMostWaiting;
  return deliveries_.waitUntilFewerThan(most, stop) && vesk::MainQueue::shared().waitUntilFewerThan(most, stop);
}

void Channel::noteSize(const vesk::InterProcessDictionary& message) {
  if (isLarge(message)) isLargeAhead_ = true;
}

void Channel::raise(const vesk::Text& event, vesk::InterProcessDictionary message) {
  noteSize(message);
  post([this, event, message = std::move(message)] { handle(event, message); });
}

void Channel::deliver(const vesk::Text& event, vesk::InterProcessDictionary message) {
  queue_.sync([&] {
    if (deliveries_.runAll()) {
      noteSize(message);
      handle(event, message);
    } else {
      raise(event, std::move(message));
    }
  });
}

void Channel::afterDelivery(vesk::Task task) {
  post([task = std::move(task)]() mutable { vesk::MainQueue::shared().post(std::move(task)); });
}

void Channel::post(vesk::Task task) {
  if (deliveries_.post(std::move(task))) scheduleDeliveries();
}

void Channel::scheduleDeliveries() {
  queue_.post([weak = weak_from_this()] {
    if (const std::shared_ptr<Channel> self = weak.lock()) self->deliveries_.runAll();
  });
}

void Channel::handle(const vesk::Text& event, const vesk::InterProcessDictionary& message) const {
  const Handlers& handlers = *handlers_;
  const EventHandler& handler = event == kEventMetric ? handlers.metric : handlers.trigger;
  if (handler) handler(message, WorkGroup{});
}

}  // namespace corvik::client
