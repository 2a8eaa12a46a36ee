#pragma once

#include <atomic>
#include <condition_variable>
#include <cstddef>
#include <mutex>
#include <stop_token>
#include <vector>

#include "platform/task.h"
#include "platform/wake_up.h"

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
  void async(Task task);

  /// How a source keeps memory bounded: blocks the calling thread, never the main one, until fewer than
  /// `count` tasks wait. False when a stop was requested meanwhile.
  [[nodiscard]] bool waitUntilFewerThan(std::size_t count, const std::stop_token& stop);

  /// Runs the tasks that wait now, but none that they schedule; on the main thread. How many there were.
  std::size_t runBatch();
  [[nodiscard]] bool isEmpty() const { return pendingCount_ == 0; }
  /// Signalled whenever a task comes to an empty queue; null for nobody. Must stay alive until replaced.
  void setWakeUp(const WakeUp* wakeUp);

 private:
  mutable std::mutex mutex_;
  std::condition_variable_any taken_;
  std::size_t waitingSources_ = 0;
  const WakeUp* wakeUp_ = nullptr;
  std::vector<Task> pending_;
  /// Its size, to be read without the lock.
  std::atomic<std::size_t> pendingCount_ = 0;
  /// The tasks under way, kept for its storage.
  std::vector<Task> batch_;
};

}  // namespace vesk
