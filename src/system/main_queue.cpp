#include "system/main_queue.h"

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
  if (next_ < batch_.size()) return runRest();
  if (isEmpty()) return 0;
  std::vector<Task> underWay;
  if (!batch_.empty()) underWay.swap(batch_);
  next_ = 0;
  pending_.take(batch_);
  const std::size_t count = runRest();
  batch_.clear();
  if (!underWay.empty()) batch_.swap(underWay);
  next_ = batch_.size();
  return count;
}

std::size_t MainQueue::runRest() {
  const std::size_t begun = next_;
  while (next_ < batch_.size())
    batch_[next_++].runOnce();
  return next_ - begun;
}

void MainQueue::setWakeUp(const WakeUp* wakeUp) {
  const std::lock_guard lock(wakeUpMutex_);
  wakeUp_ = wakeUp;
  if (!isEmpty() && wakeUp_ != nullptr) wakeUp_->signal();
}

}  // namespace vesk
