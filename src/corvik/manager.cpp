#include "corvik/manager.h"

#include <utility>

#include "platform/main_queue.h"

namespace corvik::client {

namespace {

/// How far a source may get ahead, on each of the two queues that an event passes.
constexpr std::size_t kMostWaiting = 1024;

}  // namespace

Manager::Manager(std::string name, vesk::WorkQueue& queue, std::shared_ptr<Service> service)
    : name_(std::move(name)), queue_(queue), service_(std::move(service)) {}

Manager::~Manager() {
  if (service_ != nullptr) service_->disconnect(*this);
}

void Manager::connect() {
  if (service_ != nullptr) service_->connect(*this);
}

Result Manager::perform(const vesk::Text& command, const vesk::InterProcessDictionary& message) {
  if (service_ == nullptr) return {kStatusNoService, "no service for the client " + name_};
  Result result = service_->perform(command, message);
  if (result.code != 0) return result;
  const std::lock_guard lock(mutex_);
  if (command == kCommandAddConfiguration) isConfigured_ = true;
  if (command == kCommandClearConfiguration) isConfigured_ = false;
  wanted_.notify_all();
  return result;
}

void Manager::setHandler(const vesk::Text& event, EventHandler handler) {
  const std::lock_guard lock(mutex_);
  Handlers handlers = *handlers_;
  if (event == kEventMetric) handlers.metric = std::move(handler);
  if (event == kEventTrigger) handlers.trigger = std::move(handler);
  handlers_ = std::make_shared<const Handlers>(std::move(handlers));
}

void Manager::setEventsOn(bool isOn) {
  {
    const std::lock_guard lock(mutex_);
    areEventsOn_ = isOn;
    wanted_.notify_all();
  }
  if (isOn) scheduleDeliveries();
}

bool Manager::waitUntilWanted(const std::stop_token& stop) {
  if (!isWanted()) {
    std::unique_lock lock(mutex_);
    if (!wanted_.wait(lock, stop, [this] { return isWanted(); })) return false;
  }
  return backlog_.waitUntilFewerThan(kMostWaiting, stop) &&
         vesk::MainQueue::shared().waitUntilFewerThan(kMostWaiting, stop);
}

void Manager::raise(const vesk::Text& event, vesk::InterProcessDictionary message) {
  add(Event{event, std::move(message)});
}

void Manager::afterDelivery(vesk::Task task) {
  add(std::move(task));
}

void Manager::add(Delivery delivery) {
  if (backlog_.add(std::move(delivery))) scheduleDeliveries();
}

void Manager::scheduleDeliveries() {
  queue_.async([weak = weak_from_this()] {
    if (const std::shared_ptr<Manager> self = weak.lock()) self->deliver();
  });
}

void Manager::deliver() {
  while (areEventsOn_ && hasBatch())
    deliver(batch_[delivered_++], *handlers());
}

bool Manager::hasBatch() {
  if (delivered_ < batch_.size()) return true;
  batch_.clear();
  delivered_ = 0;
  backlog_.take(batch_);
  return !batch_.empty();
}

std::shared_ptr<const Manager::Handlers> Manager::handlers() {
  const std::lock_guard lock(mutex_);
  return handlers_;
}

void Manager::deliver(Delivery& delivery, const Handlers& handlers) {
  if (auto* task = std::get_if<vesk::Task>(&delivery)) {
    vesk::MainQueue::shared().async(std::move(*task));
    return;
  }
  const auto& event = std::get<Event>(delivery);
  const EventHandler& handler = event.name == kEventMetric ? handlers.metric : handlers.trigger;
  if (handler) handler(event.message, WorkGroup{});
}

}  // namespace corvik::client
