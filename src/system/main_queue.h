#pragma once

#include <cstddef>
#include <mutex>
#include <stop_token>

#include "system/serial_queue.h"
#include "system/task.h"
#include "system/wake_up.h"

namespace vesk {

/// The serial queue of the main thread, where everything above the link runs. The run loop serves it.
class MainQueue {
 public:
  /// The one of the process.
  static MainQueue& shared();

  MainQueue() = default;
  MainQueue(const MainQueue&) = delete;
  MainQueue& operator=(const MainQueue&) = delete;

  /// Schedules `task` behind those already there; from any thread.
  void post(Task task);

  /// How a source keeps memory bounded: blocks the calling thread, never the main one, until fewer than
  /// `count` tasks wait. False when a stop was requested.
  [[nodiscard]] bool waitUntilFewerThan(std::size_t count, const std::stop_token& stop) {
    return tasks_.waitUntilFewerThan(count, stop);
  }

  /// Runs the tasks that wait now, but none that they post; on the main thread, not from a task. How many there were.
  std::size_t runBatch() { return tasks_.runBatch(); }
  [[nodiscard]] bool isEmpty() const { return tasks_.isEmpty(); }
  /// Signalled whenever a task comes to an empty queue; null for nobody. Must stay alive until replaced.
  void setWakeUp(const WakeUp* wakeUp);

 private:
  SerialQueue tasks_;
  std::mutex wakeUpLock_;
  const WakeUp* wakeUp_ = nullptr;
};

}  // namespace vesk
