#pragma once

#include <cstddef>
#include <mutex>
#include <stop_token>
#include <vector>

#include "system/backlog.h"
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
  void async(Task task);

  /// How a source keeps memory bounded: blocks the calling thread, never the main one, until fewer than
  /// `count` tasks wait. False when a stop was requested.
  [[nodiscard]] bool waitUntilFewerThan(std::size_t count, const std::stop_token& stop) {
    return pending_.waitUntilFewerThan(count, stop);
  }

  /// Runs the tasks that wait now, but none that they schedule; on the main thread. How many there were. A task may
  /// call it too: those behind it run then.
  std::size_t runBatch();
  [[nodiscard]] bool isEmpty() const { return pending_.isEmpty(); }
  /// Signalled whenever a task comes to an empty queue; null for nobody. Must stay alive until replaced.
  void setWakeUp(const WakeUp* wakeUp);

 private:
  static constexpr std::size_t kCacheLine = 64;

  /// Runs those of the batch that have not begun.
  std::size_t runRest();

  /// Written by the sources, and so kept apart from what the main thread writes.
  alignas(kCacheLine) Backlog<Task> pending_;
  /// The tasks under way, empty beside a run, and how many of them have begun.
  alignas(kCacheLine) std::vector<Task> batch_;
  std::size_t next_ = 0;
  std::mutex wakeUpMutex_;
  const WakeUp* wakeUp_ = nullptr;
};

}  // namespace vesk
