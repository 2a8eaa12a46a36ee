#pragma once

#include <condition_variable>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include "platform/task.h"

namespace vesk {

/// A serial queue: runs its tasks one after another, in the order they came, on a thread of its own.
class WorkQueue {
 public:
  explicit WorkQueue(std::string label);
  /// Runs what is still queued, then ends. Not from one of its own tasks.
  ~WorkQueue();
  WorkQueue(const WorkQueue&) = delete;
  WorkQueue& operator=(const WorkQueue&) = delete;

  /// Schedules `task`; from any thread, its own tasks included.
  void async(Task task);
  /// A name for people, in reverse-domain form.
  [[nodiscard]] const std::string& label() const { return label_; }

 private:
  void serve();

  std::string label_;
  std::mutex mutex_;
  std::condition_variable changed_;
  std::vector<Task> pending_;
  bool isEnding_ = false;
  std::thread thread_;
};

}  // namespace vesk
