#pragma once

#include <atomic>
#include <condition_variable>
#include <cstddef>
#include <memory>
#include <mutex>
#include <stop_token>
#include <vector>

#include "corvik/client.h"
#include "corvik/service.h"
#include "system/serial_queue.h"
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
  struct Handlers {
    EventHandler metric;
    EventHandler trigger;
  };

  void post(vesk::Task task);
  void scheduleDeliveries();
  [[nodiscard]] bool isWanted() const { return isConfigured_ && !deliveries_.isSuspended(); }
  void noteSize(const vesk::InterProcessDictionary& message);
  /// On the client's queue, or in its turn.
  void handle(const vesk::Text& event, const vesk::InterProcessDictionary& message) const;

  vesk::WorkQueue& queue_;

  /// Guards the handlers, and whoever waits until metrics are wanted.
  std::mutex lock_;
  std::condition_variable_any wanted_;
  std::atomic<bool> isConfigured_ = false;
  /// The last of them is in force; those before stay, for they may be running.
  std::vector<std::unique_ptr<const Handlers>> registered_;
  std::atomic<const Handlers*> handlers_;

  /// Whether a large event was raised since a source last waited until few were ahead.
  std::atomic<bool> isLargeAhead_ = false;
  /// Runs on the client's queue, or in its turn. Suspended while events are off.
  vesk::SerialQueue deliveries_;
};

}  // namespace corvik::client
