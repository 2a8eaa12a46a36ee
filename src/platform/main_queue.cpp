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
  if (isEmpty()) return 0;
  // A task that serves the queue itself finds another vector here.
  std::vector<Task> batch = std::exchange(batch_, {});
  pending_.take(batch);
  const std::size_t count = batch.size();
  runAll(batch);
  batch_ = std::move(batch);
  return count;
}

void MainQueue::setWakeUp(const WakeUp* wakeUp) {
  const std::lock_guard lock(wakeUpMutex_);
  wakeUp_ = wakeUp;
  if (!isEmpty() && wakeUp_ != nullptr) wakeUp_->signal();
}

}  // namespace vesk
