#include "platform/work_queue.h"

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
  {
    const std::lock_guard lock(mutex_);
    pending_.push_back(std::move(task));
    if (pending_.size() > 1) return;
  }
  changed_.notify_one();
}

void WorkQueue::serve() {
  for (;;) {
    {
      std::unique_lock lock(mutex_);
      changed_.wait(lock, [this] { return isEnding_ || !pending_.empty(); });
      if (pending_.empty()) return;
    }
    const std::lock_guard turn(turn_);
    runPending();
  }
}

void WorkQueue::runPending() {
  {
    const std::lock_guard lock(mutex_);
    batch_.swap(pending_);
  }
  for (Task& task : batch_) {
    task();
    // What the task holds goes before the next one runs.
    task = Task();
  }
  batch_.clear();
}

}  // namespace vesk
