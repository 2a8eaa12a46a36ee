#pragma once

#include <functional>
#include <memory>

#include "system/clock.h"

namespace vesk {

class RunLoop;

/// What the main thread is busy with: a timer ticks in one of these modes.
enum class RunLoopMode {
  defaultMode,
  /// The user is dragging something.
  tracking,
  /// Of a timer only: it ticks whatever the main thread is busy with.
  common,
};

/// A repeating timer on a run loop, for the main thread. The first tick comes one interval after it was made.
/// Ticks that fall due while the loop cannot deliver them come once, late; the rhythm stays.
class Timer {
 public:
  using Action = std::function<void()>;

  /// `interval` must be positive.
  Timer(RunLoop& loop, Clock::Duration interval, RunLoopMode mode, Action action);
  Timer(Timer&&) noexcept = default;
  Timer& operator=(Timer&& other) noexcept;
  ~Timer() { stop(); }

  /// No tick after this. From anywhere on the main thread, the timer's own action included.
  void stop();

 private:
  friend RunLoop;

  struct State {
    Clock::Duration interval;
    RunLoopMode mode;
    Action action;
    Clock::Instant due;
    bool isRunning = true;
  };

  std::shared_ptr<State> state_;
};

}  // namespace vesk
