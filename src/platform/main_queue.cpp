#include "platform/main_queue.h"

#include <utility>

namespace vesk {

MainQueue& MainQueue::shared() {
  static MainQueue theQueue;
  return theQueue;
}

void MainQueue::async(Task task) {
  if (!pending_.add(std::move(task))) return;
  const std::lock_guard lock(wakeUpMutex_);
  if (wakeUp_ != nullptr) wakeUp_->signal();
}

std::size_t MainQueue::runBatch() {
  // A task that serves the queue itself goes on where the queue stands.
  if (next_ == batch_.size()) {
    batch_.clear();
    next_ = 0;
    if (isEmpty()) return 0;
    pending_.take(batch_);
  }
  std::size_t count = 0;
  for (; next_ < batch_.size(); ++count) {
    // What the task holds goes before the next one runs.
    Task task = std::move(batch_[next_++]);
    task();
  }
  return count;
}

void MainQueue::setWakeUp(const WakeUp* wakeUp) {
  const std::lock_guard lock(wakeUpMutex_);
  wakeUp_ = wakeUp;
  if (!isEmpty() && wakeUp_ != nullptr) wakeUp_->signal();
}

}  // namespace vesk
