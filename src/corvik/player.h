#pragma once

#include <cstddef>
#include <memory>
#include <mutex>
#include <optional>
#include <stop_token>

#include "recording/timed_events.h"
#include "system/clock.h"
#include "system/wake_up.h"

namespace corvik {

/// How a recording is to be played.
struct Playback {
  /// How many seconds of the recording pass in one, positive; absent for no waiting at all.
  std::optional<double> speed = 1.0;
  /// From the start again at the end, where the recording has a way back.
  bool loops = false;
};

/// How far the playback has come: what a status bar shows.
struct PlaybackState {
  enum class Phase {
    /// Until the client wants metrics.
    notStarted,
    playing,
    /// For more of a pipe.
    waitingForInput,
    ended,
  };

  Phase phase = Phase::notStarted;
  /// Seconds: how far into the recording it is, between the last event played and the next.
  double position = 0;
  /// Seconds: "at" of the last event of all, where it can be known; never before the position.
  std::optional<double> duration;
  std::optional<double> speed;
  std::size_t events = 0;
  std::size_t badLines = 0;
};

/// Takes events from a recording, each when its time has come. One thread at a time plays; any thread may ask how far
/// it is.
class Player {
 public:
  /// `clock` must outlive the player.
  Player(std::unique_ptr<vesk::TimedEvents> recording, const vesk::Clock& clock, Playback playback);

  /// Starts the time, unless it runs already.
  void start();
  /// Waits for the next event's time and returns it, or what stands in its place. At the end of a recording that
  /// loops its start follows; its bad lines come once. When `stop` was requested meanwhile, what is returned is not to
  /// be played.
  [[nodiscard]] vesk::TimedEvents::Step next(const std::stop_token& stop);

  /// Ends every wait of next() at once, until it is undone. From any thread.
  void interrupt() { interrupt_.signal(); }
  void undoInterrupt() { interrupt_.clear(); }

  [[nodiscard]] PlaybackState state() const;

 private:
  void setPhase(PlaybackState::Phase phase);
  [[nodiscard]] bool waitForInput(int descriptor);
  /// Blocks until `at` has come.
  void waitUntil(double at);
  void countEvent(double at);
  /// False when a bad line was told in an earlier lap.
  [[nodiscard]] bool countBadLine();
  [[nodiscard]] bool startAgain();

  std::unique_ptr<vesk::TimedEvents> recording_;
  const vesk::Clock& clock_;
  Playback playback_;

  /// When the last event was due, and its "at"; the start of the playback before the first.
  std::optional<vesk::Clock::Instant> due_;
  double at_ = 0;
  std::size_t lap_ = 0;
  std::size_t eventsOfLap_ = 0;
  vesk::WakeUp interrupt_;

  /// What is waited for.
  struct NextEvent {
    double at;
    vesk::Clock::Instant due;
  };

  /// Guards what lies below it.
  mutable std::mutex stateLock_;
  PlaybackState state_;
  /// Absent when nothing is waited for.
  std::optional<NextEvent> next_;
};

}  // namespace corvik
