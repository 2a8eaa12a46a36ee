#pragma once

#include <cstddef>
#include <limits>
#include <memory>
#include <mutex>
#include <optional>
#include <stop_token>
#include <variant>

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
  /// Pauses of more than a minute last as long as they did, not five seconds.
  bool keepsPauses = false;
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
  /// As of Playback, or as it was set since.
  std::optional<double> speed;
  /// Seconds: how long the pause was that is being shortened now.
  std::optional<double> shortenedPause;
  bool isHeld = false;
  /// On its way to a position, at full speed.
  bool isSeeking = false;
  /// Of this way through the recording.
  std::size_t events = 0;
  std::size_t badLines = 0;
};

/// The way to another position begins here: what comes next is played without waiting.
struct SeekBegun {
  /// The first event of all comes next, so that what was played before is to be forgotten.
  bool isFromStart;
};

/// Everything up to the position has been played, and nothing behind it.
struct SeekEnded {
  /// How far behind the last of these events the position lies: seconds.
  double sinceLastEvent;
};

/// Takes events from a recording, each when its time has come. One thread at a time plays; any thread may ask how far
/// it is, and steer it.
class Player {
 public:
  /// An event that is to be played, or what stands in its place.
  using Step =
      std::variant<vesk::RecordedEvent, vesk::BadLine, vesk::ReadFailure, vesk::EndOfRecording, SeekBegun, SeekEnded>;

  /// `clock` must outlive the player.
  Player(std::unique_ptr<vesk::TimedEvents> recording, const vesk::Clock& clock, Playback playback);

  /// Starts the time, unless it runs already.
  void start();
  /// Waits for the next event's time and returns it, or what stands in its place. At the end of a recording that
  /// loops its start follows; its bad lines come once. When `stop` was requested meanwhile, what is returned is not to
  /// be played.
  [[nodiscard]] Step next(const std::stop_token& stop);
  /// Behind the end: waits until a position is sought. False where none can be, and when `stop` was requested.
  [[nodiscard]] bool waitForSeek(const std::stop_token& stop);

  /// Ends every wait at once, for a stop that was requested. From any thread.
  void interrupt() { interrupt_.signal(); }

  // What steers it, from any thread.

  /// Holds it between two events, or lets it go on.
  void setHeld(bool isHeld);
  /// As of Playback.
  void setSpeed(std::optional<double> speed);
  /// Goes to a position in seconds: forward by playing what lies between, back by playing anew from the start, both at
  /// full speed and also while held. All events up to the position are then played, and none behind it. False, with
  /// nothing done, where the recording has no way back.
  bool seek(double position);
  /// The same to where the first `count` events have been played.
  bool seekToEvent(std::size_t count);

  [[nodiscard]] PlaybackState state() const;

 private:
  /// The last that is to be played of what is sought.
  struct Target {
    double at = std::numeric_limits<double>::infinity();
    std::size_t events = std::numeric_limits<std::size_t>::max();
  };
  /// What is waited for.
  struct NextEvent {
    double at;
    vesk::Clock::Instant due;
  };
  /// What it is time for.
  enum class Turn { event, arrival, somethingElse };

  /// Blocks until the time of an event has come, or of what comes before it.
  [[nodiscard]] Turn waitForTurn(double at, const std::stop_token& stop);
  [[nodiscard]] bool waitForInput(int descriptor);
  void sleepUntil(vesk::Clock::Instant instant, std::unique_lock<std::mutex>& lock);
  bool seekTo(Target target);
  [[nodiscard]] std::optional<SeekBegun> beginSeek();
  /// At the end of the recording: whether what is sought lies no further.
  [[nodiscard]] bool endsSeek();
  [[nodiscard]] bool startAgain();
  void setPhase(PlaybackState::Phase phase);
  /// False when a bad line was told in an earlier lap.
  [[nodiscard]] bool countBadLine();

  // With stateLock_ held.
  [[nodiscard]] double position() const;
  /// The position that was sought is reached.
  void arrive(double position);
  /// Lets the time go on from a position.
  void restartTime(double position);
  void countEvent(double at);

  std::unique_ptr<vesk::TimedEvents> recording_;
  const vesk::Clock& clock_;
  const bool loops_;
  bool keepsPauses_;
  /// Read, and not played yet.
  std::optional<vesk::RecordedEvent> pending_;
  /// Seconds: "at" of the last event played.
  double lastEventAt_ = 0;
  /// As of SeekEnded.
  double sinceLastEvent_ = 0;
  std::size_t eventsOfLap_ = 0;
  std::size_t badLinesOfLap_ = 0;
  const std::stop_token* stop_ = nullptr;
  vesk::WakeUp interrupt_;

  /// Guards what lies below it.
  mutable std::mutex stateLock_;
  PlaybackState state_;
  /// Absent when nothing is waited for.
  std::optional<NextEvent> next_;
  /// When the playback was at at_: at the last event, or where the time was started anew since. Absent before start().
  std::optional<vesk::Clock::Instant> due_;
  double at_ = 0;
  /// There until it is reached.
  std::optional<Target> target_;
};

}  // namespace corvik
