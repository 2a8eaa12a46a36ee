#include "system/main_queue.h"

#include <utility>

namespace vesk {

MainQueue& MainQueue::shared() {
  static MainQueue theQueue;
  return theQueue;
}

void MainQueue::post(Task task) {
  if (!tasks_.post(std::move(task))) return;
  const std::lock_guard lock(wakeUpLock_);
  if (wakeUp_ != nullptr) wakeUp_->signal();
}

void MainQueue::setWakeUp(const WakeUp* wakeUp) {
  const std::lock_guard lock(wakeUpLock_);
  wakeUp_ = wakeUp;
  if (!isEmpty() && wakeUp_ != nullptr) wakeUp_->signal();
}

}  // namespace vesk
