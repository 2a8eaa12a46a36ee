#pragma once

#include <mutex>
#include <string>
#include <thread>

#include "system/serial_queue.h"
#include "system/task.h"

namespace vesk {

/// A serial queue: runs its tasks one after another, in the order they came, on a thread of its own or on one that
/// waits for them.
class WorkQueue {
 public:
  explicit WorkQueue(std::string label);
  /// Runs what is still queued, then ends. Not from one of its own tasks.
  ~WorkQueue() = default;
  WorkQueue(const WorkQueue&) = delete;
  WorkQueue& operator=(const WorkQueue&) = delete;

  /// Schedules `task`; from any thread, its own tasks included.
  void post(Task task);
  /// Runs `work` on the calling thread when its turn has come: behind the tasks that are there, beside none. Not from a
  /// task of the queue.
  template <class Work>
  void sync(Work work) {
    const std::lock_guard turn(turn_);
    tasks_.runBatch();
    work();
  }
  /// A name for people, in reverse-domain form.
  [[nodiscard]] const std::string& label() const { return label_; }

 private:
  std::string label_;
  SerialQueue tasks_;
  /// Held by the thread that runs tasks.
  std::mutex turn_;
  std::jthread thread_;
};

}  // namespace vesk
