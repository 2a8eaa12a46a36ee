#pragma once

#include <atomic>
#include <cstddef>
#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <stop_token>
#include <string>
#include <thread>
#include <variant>

#include "corvik/service.h"
#include "recording/recording_reader.h"
#include "system/clock.h"

namespace corvik {

struct Playback {
  /// How many seconds of the recording pass in one, positive; absent for no waiting at all.
  std::optional<double> speed = 1.0;
  /// From the start again at the end, where the recording has a way back.
  bool loops = false;
  /// Between the main thread's other tasks instead of on a thread of its own: what one processor makes and takes costs
  /// a third less than what goes from one to another. The main thread then waits for a pipe's input, and for a client
  /// that does not want metrics yet.
  bool isOnMainThread = false;
};

/// What a status bar shows of a recorded service.
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

/// Plays a recording: raises each event when its time has come, usually on a thread of its own, as soon as the client
/// wants metrics and no faster than it takes them. Queries are accepted; what answers them is in the
/// recording. A disconnection interrupts it at once, whatever it waits for.
class RecordedService final : public Service {
 public:
  /// Both are called on the main queue.
  using BadLineHandler = std::function<void(const std::string& message)>;
  /// `failure` tells why the recording could not be read to its end.
  using EndHandler = std::function<void(const std::optional<std::string>& failure)>;

  /// `clock` must outlive the service.
  RecordedService(vesk::RecordingReader recording, const vesk::Clock& clock, Playback playback);
  ~RecordedService() override { endThread(); }
  RecordedService(const RecordedService&) = delete;
  RecordedService& operator=(const RecordedService&) = delete;

  /// To be set before the service is connected. A looping recording's bad lines are told once.
  void setBadLineHandler(BadLineHandler handler) { onBadLine_ = std::move(handler); }
  /// Called once everything has been delivered, behind the last event and the last bad line.
  void setEndHandler(EndHandler handler) { onEnd_ = std::move(handler); }

  /// From any thread.
  [[nodiscard]] PlaybackState state() const;

 private:
  void start(EventStream& events) override;
  void stop() override;
  [[nodiscard]] Result answer(const MetricQuery& query, EventStream& events) override;

  void endThread();
  void setPhase(PlaybackState::Phase phase);
  using Step = bool (RecordedService::*)(const std::stop_token& stop, EventStream& events);
  /// Has the main thread take `step`, and then play some events after others.
  void schedule(Step step, EventStream& events);

  /// These run on the service's thread, or on the main one in its place; false when there is nothing more to play.
  void play(const std::stop_token& stop, EventStream& events);
  [[nodiscard]] bool playSome(const std::stop_token& stop, EventStream& events);
  [[nodiscard]] bool begin(const std::stop_token& stop, EventStream& events);
  [[nodiscard]] bool playNext(const std::stop_token& stop, EventStream& events);
  [[nodiscard]] bool waitForInput(int descriptor);
  /// Blocks until `at` has come; false when a stop was requested.
  [[nodiscard]] bool waitUntil(double at, const std::stop_token& stop);
  void playEvent(const vesk::RecordedEvent& event, EventStream& events);
  void tellBadLine(std::string message, EventStream& events);
  [[nodiscard]] bool startAgain();
  void end(EventStream& events);

  vesk::RecordingReader recording_;
  const vesk::Clock& clock_;
  Playback playback_;
  BadLineHandler onBadLine_;
  EndHandler onEnd_;

  /// When the last event was due, and its "at"; the start of the playback before the first.
  std::optional<vesk::Clock::Instant> due_;
  double at_ = 0;
  std::size_t lap_ = 0;
  std::size_t eventsOfLap_ = 0;
  /// Of payload, since the main thread's turn began.
  std::size_t bytesPlayed_ = 0;

  struct NextEvent {
    double at;
    vesk::Clock::Instant due;
  };

  mutable std::mutex mutex_;
  PlaybackState state_;
  /// What is waited for; absent when nothing is.
  std::optional<NextEvent> next_;
  vesk::WakeUp interrupt_;
  std::jthread thread_;
  /// There while the main thread is to play.
  std::shared_ptr<std::monostate> turn_;
};

}  // namespace corvik
