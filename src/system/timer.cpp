#include "system/timer.h"

#include <utility>

#include "system/run_loop.h"

namespace vesk {

Timer::Timer(RunLoop& loop, Clock::Duration interval, RunLoopMode mode, Action action)
    : state_(std::make_shared<State>(State{interval, mode, std::move(action), loop.clock().now() + interval, true})) {
  loop.schedule(state_);
}

Timer& Timer::operator=(Timer&& other) noexcept {
  std::swap(state_, other.state_);
  return *this;
}

void Timer::stop() {
  if (state_ != nullptr) state_->isRunning = false;
}

}  // namespace vesk
