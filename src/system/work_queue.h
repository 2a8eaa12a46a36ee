#pragma once

#include <condition_variable>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include "system/backlog.h"
#include "system/task.h"

namespace vesk {

/// A serial queue: runs its tasks one after another, in the order they came, on a thread of its own or on one that
/// waits for them.
class WorkQueue {
 public:
  explicit WorkQueue(std::string label);
  /// Runs what is still queued, then ends. Not from one of its own tasks.
  ~WorkQueue();
  WorkQueue(const WorkQueue&) = delete;
  WorkQueue& operator=(const WorkQueue&) = delete;

  /// Schedules `task`; from any thread, its own tasks included.
  void async(Task task);
  /// Runs `work` on the calling thread when its turn has come: behind the tasks that are there, beside none. Not from a
  /// task of the queue.
  template <class Work>
  void sync(Work work) {
    const std::lock_guard turn(turn_);
    runPending();
    work();
  }
  /// A name for people, in reverse-domain form.
  [[nodiscard]] const std::string& label() const { return label_; }

 private:
  void serve();
  void runPending();

  std::string label_;
  /// Held by the thread that runs tasks.
  std::mutex turn_;
  /// The tasks under way, kept for its storage.
  std::vector<Task> batch_;
  Backlog<Task> pending_;
  std::mutex mutex_;
  std::condition_variable changed_;
  bool isEnding_ = false;
  std::thread thread_;
};

}  // namespace vesk
