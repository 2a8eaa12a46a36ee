#pragma once

#include <atomic>
#include <condition_variable>
#include <cstddef>
#include <mutex>
#include <stop_token>
#include <vector>

#include "system/task.h"

namespace vesk {

/// What every serial queue is made of: tasks that any thread posts and one thread at a time runs, in the order they
/// came. Which thread that is, and how it learns that there is something to do, is the owner's affair.
///
/// The queue has no bound of its own. A source that may be faster than the runner waits for room before it posts.
class SerialQueue {
 public:
  /// Puts `task` behind the others. True when it is the first that waits, so that the runner has to be woken.
  [[nodiscard]] bool post(Task task);

  /// These run tasks, on one thread at a time and not from within a task.
  /// Runs those that wait now, but none that they post. How many there were.
  std::size_t runBatch();
  /// Runs until none waits. False when the queue is suspended, and some may be left.
  bool runAll();

  /// While it is suspended the task under way is the last that runs; those behind it stay. From any thread.
  void suspend() { isSuspended_ = true; }
  /// Tasks may have waited meanwhile: the runner has to be woken.
  void resume() { isSuspended_ = false; }
  [[nodiscard]] bool isSuspended() const { return isSuspended_; }

  /// Whether no task waits for the runner.
  [[nodiscard]] bool isEmpty() const { return count_ == 0; }
  /// Blocks the runner's thread until a task waits. False when a stop was requested and none is left.
  [[nodiscard]] bool waitForTask(const std::stop_token& stop);
  /// Backpressure: blocks a source until fewer than `count` tasks wait. False when a stop was requested.
  [[nodiscard]] bool waitUntilFewerThan(std::size_t count, const std::stop_token& stop);

 private:
  /// Takes what waits when the last batch is done. Whether there is a task to run.
  [[nodiscard]] bool hasNext();

  /// Guards what lies below it, up to the batch.
  std::mutex waitingLock_;
  std::vector<Task> waiting_;
  std::condition_variable_any posted_;
  std::condition_variable_any taken_;
  bool isRunnerAsleep_ = false;
  std::size_t sleepingSources_ = 0;
  /// How many wait, to be read without the lock.
  std::atomic<std::size_t> count_ = 0;
  std::atomic<bool> isSuspended_ = false;

  /// The runner's own: the tasks under way, and how many of them have begun.
  std::vector<Task> batch_;
  std::size_t next_ = 0;
};

}  // namespace vesk
