#pragma once

#include <atomic>
#include <condition_variable>
#include <cstddef>
#include <memory>
#include <mutex>
#include <stop_token>
#include <variant>
#include <vector>

#include "corvik/client.h"
#include "corvik/service.h"
#include "system/backlog.h"
#include "system/task.h"
#include "system/work_queue.h"

namespace corvik::client {

/// The way of a service's events to one client: takes them in on any thread and hands them to the handlers on
/// the client's queue, or in its turn.
class Channel final : public EventStream, public std::enable_shared_from_this<Channel> {
 public:
  explicit Channel(vesk::WorkQueue& queue);

  void setConfigured(bool isConfigured);
  void setEventsOn(bool isOn);
  void setHandler(const vesk::Text& event, EventHandler handler);

  void raise(const vesk::Text& event, vesk::InterProcessDictionary message) override;
  void deliver(const vesk::Text& event, vesk::InterProcessDictionary message) override;
  void afterDelivery(vesk::Task task) override;
  [[nodiscard]] bool waitUntilWanted(const std::stop_token& stop) override;

 private:
  struct Event {
    vesk::Text name;
    vesk::InterProcessDictionary message;
  };
  using Delivery = std::variant<Event, vesk::Task>;
  struct Handlers {
    EventHandler metric;
    EventHandler trigger;
  };

  void add(Delivery delivery);
  void scheduleDeliveries();
  [[nodiscard]] bool isWanted() const { return isConfigured_ && areEventsOn_; }

  void noteSize(const vesk::InterProcessDictionary& message);

  /// These run on the client's queue, or in its turn. False when events are off, and some may be left.
  bool deliverWaiting();
  void handle(const vesk::Text& event, const vesk::InterProcessDictionary& message) const;
  /// Whether there is something to deliver; takes the next batch once one is done.
  [[nodiscard]] bool hasBatch();

  vesk::WorkQueue& queue_;

  std::atomic<bool> isConfigured_ = false;
  std::atomic<bool> areEventsOn_ = false;
  std::mutex mutex_;
  std::condition_variable_any wanted_;
  /// The last of them is in force; those before stay, for they may be running.
  std::vector<std::unique_ptr<const Handlers>> registered_;
  std::atomic<const Handlers*> handlers_;

  /// Whether a large event was raised since a source last waited until few were ahead.
  std::atomic<bool> isLargeAhead_ = false;
  vesk::Backlog<Delivery> backlog_;
  /// What was taken from the backlog, and how much of it is done: left alone while events are off.
  std::vector<Delivery> batch_;
  std::size_t delivered_ = 0;
};

}  // namespace corvik::client
