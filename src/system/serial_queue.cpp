#include "system/serial_queue.h"

#include <utility>

namespace vesk {

bool SerialQueue::post(Task task) {
  const std::lock_guard lock(waitingLock_);
  waiting_.push_back(std::move(task));
  count_.store(waiting_.size(), std::memory_order_release);
  if (isRunnerAsleep_) posted_.notify_one();
  return waiting_.size() == 1;
}

std::size_t SerialQueue::runBatch() {
  if (!hasNext()) return 0;
  const std::size_t first = next_;
  while (next_ < batch_.size() && !isSuspended_)
    batch_[next_++].runOnce();
  return next_ - first;
}

bool SerialQueue::runAll() {
  while (!isSuspended_) {
    if (!hasNext()) return true;
    batch_[next_++].runOnce();
  }
  return false;
}

bool SerialQueue::hasNext() {
  if (next_ < batch_.size()) return true;
  batch_.clear();
  next_ = 0;
  if (isEmpty()) return false;
  const std::lock_guard lock(waitingLock_);
  batch_.swap(waiting_);
  count_.store(0, std::memory_order_release);
  if (sleepingSources_ > 0) taken_.notify_all();
  return true;
}

bool SerialQueue::waitForTask(const std::stop_token& stop) {
  std::unique_lock lock(waitingLock_);
  isRunnerAsleep_ = true;
  const bool hasTask = posted_.wait(lock, stop, [this] { return !waiting_.empty(); });
  isRunnerAsleep_ = false;
  return hasTask;
}

bool SerialQueue::waitUntilFewerThan(std::size_t count, const std::stop_token& stop) {
  if (count_ >= count) {
    std::unique_lock lock(waitingLock_);
    ++sleepingSources_;
    taken_.wait(lock, stop, [&] { return waiting_.size() < count; });
    --sleepingSources_;
  }
  return !stop.stop_requested();
}

}  // namespace vesk
