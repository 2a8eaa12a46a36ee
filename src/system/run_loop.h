#pragma once

#include <atomic>
#include <functional>
#include <memory>
#include <optional>
#include <vector>

#include "system/clock.h"
#include "system/main_queue.h"
#include "system/timer.h"
#include "system/wake_up.h"

namespace vesk {

/// The loop of the main thread: runs the main queue's tasks, timers, and callbacks for readable descriptors,
/// and sleeps while there is nothing to do. Timers and inputs are served between batches of tasks too, so
/// that a fast source of tasks cannot hold them up. All of it for the main thread, but for stop().
class RunLoop {
 public:
  using Callback = std::function<void()>;

  /// The first one alive is main().
  explicit RunLoop(const Clock& clock, MainQueue& queue = MainQueue::shared());
  ~RunLoop();
  RunLoop(const RunLoop&) = delete;
  RunLoop& operator=(const RunLoop&) = delete;

  /// The run loop of the process; there must be one.
  static RunLoop& main();

  /// Serves until stop() is called. The lines of the output are flushed before every sleep.
  void run();
  /// Makes run(), or the next run(), return. From any thread.
  void stop() noexcept;
  /// Serves all that is due, until nothing is, without sleeping.
  void runDue();

  [[nodiscard]] RunLoopMode mode() const { return mode_; }
  /// Timers of other modes are held back from now on.
  void setMode(RunLoopMode mode) { mode_ = mode; }

  /// Calls `onReadable` whenever there is something to read from `descriptor`, its end included, which must
  /// be answered by removing it. Replaces the callback that the descriptor had.
  void addInput(int descriptor, Callback onReadable);
  void removeInput(int descriptor);

  [[nodiscard]] const Clock& clock() const { return clock_; }

 private:
  friend Timer;

  struct Input {
    int descriptor;
    Callback onReadable;
  };
  enum class Sleep { never, untilSomethingIsDue };

  void schedule(std::shared_ptr<Timer::State> timer);
  /// One round; whether anything was done.
  bool serve(Sleep sleep);
  bool fireTimers();
  bool serveInputs(int timeout);
  /// Milliseconds in poll(2)'s manner: -1 without a timer.
  [[nodiscard]] int timeUntilNextTimer() const;
  [[nodiscard]] bool isTicking(const Timer::State& timer) const;

  const Clock& clock_;
  MainQueue& queue_;
  WakeUp wakeUp_;
  std::atomic<bool> isStopped_ = false;
  RunLoopMode mode_ = RunLoopMode::defaultMode;
  std::vector<std::shared_ptr<Timer::State>> timers_;
  std::vector<Input> inputs_;
};

}  // namespace vesk
