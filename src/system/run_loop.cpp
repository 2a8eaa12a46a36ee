#include "system/run_loop.h"

#include <algorithm>
#include <cassert>
#include <poll.h>
#include <span>
#include <utility>

#include "system/output_lines.h"

namespace vesk {

namespace {

RunLoop* mainLoop = nullptr;

}  // namespace

RunLoop::RunLoop(const Clock& clock, MainQueue& queue) : clock_(clock), queue_(queue) {
  queue_.setWakeUp(&wakeUp_);
  if (mainLoop == nullptr) mainLoop = this;
}

RunLoop::~RunLoop() {
  queue_.setWakeUp(nullptr);
  if (mainLoop == this) mainLoop = nullptr;
}

RunLoop& RunLoop::main() {
  assert(mainLoop != nullptr);
  return *mainLoop;
}

void RunLoop::run() {
  while (!isStopped_)
    serve(Sleep::untilSomethingIsDue);
  isStopped_ = false;
  OutputLines::flush();
}

void RunLoop::stop() noexcept {
  isStopped_ = true;
  wakeUp_.signal();
}

void RunLoop::runDue() {
  while (serve(Sleep::never)) {
  }
}

bool RunLoop::serve(Sleep sleep) {
  const bool ranTasks = queue_.runBatch() > 0;
  const bool firedTimers = fireTimers();
  int timeout = 0;
  if (sleep == Sleep::untilSomethingIsDue && queue_.isEmpty() && !isStopped_) {
    timeout = timeUntilNextTimer();
    if (timeout != 0) OutputLines::flush();
  }
  return serveInputs(timeout) || ranTasks || firedTimers;
}

void RunLoop::schedule(std::shared_ptr<Timer::State> timer) {
  timers_.push_back(std::move(timer));
}

bool RunLoop::isTicking(const Timer::State& timer) const {
  return timer.isRunning && (timer.mode == mode_ || timer.mode == RunLoopMode::common);
}

bool RunLoop::fireTimers() {
  std::erase_if(timers_, [](const auto& timer) { return !timer->isRunning; });
  if (timers_.empty()) return false;
  const Clock::Instant now = clock_.now();
  std::vector<std::shared_ptr<Timer::State>> due;
  std::copy_if(timers_.begin(), timers_.end(), std::back_inserter(due),
               [&](const auto& timer) { return isTicking(*timer) && timer->due <= now; });
  std::stable_sort(due.begin(), due.end(), [](const auto& a, const auto& b) { return a->due < b->due; });
  for (const auto& timer : due) {
    // An earlier one's action may have stopped it, or changed the mode.
    if (!isTicking(*timer)) continue;
    timer->due += timer->interval * ((now - timer->due) / timer->interval + 1);
    timer->action();
  }
  return !due.empty();
}

int RunLoop::timeUntilNextTimer() const {
  std::optional<Clock::Instant> next;
  for (const auto& timer : timers_) {
    if (isTicking(*timer)) next = std::min(next.value_or(timer->due), timer->due);
  }
  if (!next) return -1;
  return pollTimeout(*next - clock_.now());
}

bool RunLoop::serveInputs(int timeout) {
  std::vector<pollfd> polled{{wakeUp_.descriptor(), POLLIN, 0}};
  for (const Input& input : inputs_)
    polled.push_back({input.descriptor, POLLIN, 0});
  // A signal's EINTR is a round with nothing to read.
  if (poll(polled.data(), polled.size(), timeout) <= 0) return false;

  if (polled[0].revents != 0) wakeUp_.clear();
  bool isAnyReadable = false;
  for (const pollfd& ready : std::span(polled).subspan(1)) {
    if (ready.revents == 0) continue;
    const auto input =
        std::find_if(inputs_.begin(), inputs_.end(), [&](const Input& each) { return each.descriptor == ready.fd; });
    if (input == inputs_.end()) continue;
    isAnyReadable = true;
    // A copy, for the callback may remove itself.
    const Callback onReadable = input->onReadable;
    onReadable();
  }
  return isAnyReadable;
}

void RunLoop::addInput(int descriptor, Callback onReadable) {
  removeInput(descriptor);
  inputs_.push_back({descriptor, std::move(onReadable)});
}

void RunLoop::removeInput(int descriptor) {
  std::erase_if(inputs_, [=](const Input& input) { return input.descriptor == descriptor; });
}

}  // namespace vesk
