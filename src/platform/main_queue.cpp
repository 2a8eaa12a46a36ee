#include "platform/main_queue.h"

#include <utility>

namespace vesk {

MainQueue& MainQueue::shared() {
  static MainQueue theQueue;
  return theQueue;
}

void MainQueue::async(Task task) {
  const std::lock_guard lock(mutex_);
  pending_.push_back(std::move(task));
  pendingCount_ = pending_.size();
  if (pending_.size() == 1 && wakeUp_ != nullptr) wakeUp_->signal();
}

bool MainQueue::waitUntilFewerThan(std::size_t count, const std::stop_token& stop) {
  if (pendingCount_ < count) return !stop.stop_requested();
  std::unique_lock lock(mutex_);
  ++waitingSources_;
  const bool isRoom = taken_.wait(lock, stop, [&] { return pending_.size() < count; });
  --waitingSources_;
  return isRoom && !stop.stop_requested();
}

std::size_t MainQueue::runBatch() {
  if (isEmpty()) return 0;
  // A task that serves the queue itself finds another vector here.
  std::vector<Task> batch = std::exchange(batch_, {});
  {
    const std::lock_guard lock(mutex_);
    batch.swap(pending_);
    pendingCount_ = 0;
    if (waitingSources_ > 0) taken_.notify_all();
  }
  for (Task& task : batch) {
    task();
    // What the task holds goes before the next one runs.
    task = Task();
  }
  const std::size_t count = batch.size();
  batch.clear();
  batch_ = std::move(batch);
  return count;
}

void MainQueue::setWakeUp(const WakeUp* wakeUp) {
  const std::lock_guard lock(mutex_);
  wakeUp_ = wakeUp;
  if (!pending_.empty() && wakeUp_ != nullptr) wakeUp_->signal();
}

}  // namespace vesk
