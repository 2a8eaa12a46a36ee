#include "system/work_queue.h"

#include <utility>

namespace vesk {

WorkQueue::WorkQueue(std::string label)
    : label_(std::move(label)), thread_([this](const std::stop_token& stop) {
        while (tasks_.waitForTask(stop)) {
          const std::lock_guard turn(turn_);
          tasks_.runBatch();
        }
      }) {}

void WorkQueue::post(Task task) {
  // Its own thread waits for it, or looks for it before it waits again.
  [[maybe_unused]] const bool isFirst = tasks_.post(std::move(task));
}

}  // namespace vesk
