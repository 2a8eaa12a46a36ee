#include "system/work_queue.h"

namespace vesk {

WorkQueue::WorkQueue(std::string label) : label_(std::move(label)), thread_([this] { serve(); }) {}

WorkQueue::~WorkQueue() {
  {
    const std::lock_guard lock(mutex_);
    isEnding_ = true;
  }
  changed_.notify_one();
  thread_.join();
}

void WorkQueue::async(Task task) {
  if (!pending_.add(std::move(task))) return;
  // Whoever looks whether there is something has either seen it or is waiting by now.
  { const std::lock_guard lock(mutex_); }
  changed_.notify_one();
}

void WorkQueue::serve() {
  for (;;) {
    {
      std::unique_lock lock(mutex_);
      changed_.wait(lock, [this] { return isEnding_ || !pending_.isEmpty(); });
      if (pending_.isEmpty()) return;
    }
    const std::lock_guard turn(turn_);
    runPending();
  }
}

void WorkQueue::runPending() {
  if (pending_.isEmpty()) return;
  pending_.take(batch_);
  for (Task& task : batch_)
    task.runOnce();
  batch_.clear();
}

}  // namespace vesk
