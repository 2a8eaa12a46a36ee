#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <stop_token>
#include <string>
#include <thread>
#include <variant>

#include "corvik/player.h"
#include "corvik/service.h"
#include "recording/timed_events.h"
#include "system/clock.h"

namespace corvik {

/// A service whose metrics come from a recording. It plays as soon as the client wants metrics, and no faster than the
/// client takes them. It refuses queries: what was asked for on the drive comes when it came then. A client that
/// disconnects ends the playback at once, whatever it waits for. Its player may be steered all the while; on the main
/// thread not once it has ended.
class RecordedService final : public Service {
 public:
  /// Which thread plays.
  enum class Runs {
    onThreadOfItsOwn,
    /// On the main thread, between its other tasks. It saves a third of an event's processor time, for nothing goes
    /// from one processor to another. The main thread then waits for a pipe's input, and for a client that does not
    /// want metrics yet: for commands that do nothing else.
    onMainThread,
  };

  /// All handlers are called on the main queue.
  using BadLineHandler = std::function<void(const std::string& message)>;
  /// `failure` says why the recording could not be read to its end.
  using EndHandler = std::function<void(const std::optional<std::string>& failure)>;
  /// Behind everything that was played before, and in front of what is played after.
  using SeekBegunHandler = std::function<void(bool isFromStart)>;
  using SeekEndedHandler = std::function<void(double sinceLastEvent)>;

  /// `clock` must outlive the service.
  RecordedService(std::unique_ptr<vesk::TimedEvents> recording, const vesk::Clock& clock, Playback playback,
                  Runs runs = Runs::onThreadOfItsOwn);
  ~RecordedService() override { endThread(); }
  RecordedService(const RecordedService&) = delete;
  RecordedService& operator=(const RecordedService&) = delete;

  /// Set the handlers before the service is connected. A bad line of a looping recording is told once.
  void setBadLineHandler(BadLineHandler handler) { onBadLine_ = std::move(handler); }
  /// Called once everything has been delivered, behind the last event and the last bad line.
  void setEndHandler(EndHandler handler) { onEnd_ = std::move(handler); }
  /// Each seek that begins ends, unless another begins before.
  void setSeekHandlers(SeekBegunHandler begun, SeekEndedHandler ended) {
    onSeekBegun_ = std::move(begun);
    onSeekEnded_ = std::move(ended);
  }

  /// From any thread.
  [[nodiscard]] PlaybackState state() const { return player_.state(); }
  [[nodiscard]] Player& player() { return player_; }

 private:
  void start(EventStream& events) override;
  void stop() override;
  [[nodiscard]] Result answer(const MetricQuery& query, EventStream& events) override;

  void endThread();
  void playOn(const std::stop_token& stop, EventStream& events);

  /// Waits until the client wants metrics. False when there is nothing to play for it.
  [[nodiscard]] bool begin(const std::stop_token& stop, EventStream& events);
  /// Plays what comes next. False when there is nothing more.
  [[nodiscard]] bool playNext(const std::stop_token& stop, EventStream& events);
  /// The main thread's way: takes `step`, and goes on with playBatch() while there is more.
  using Step = bool (RecordedService::*)(const std::stop_token& stop, EventStream& events);
  void schedule(Step step, EventStream& events);
  [[nodiscard]] bool playBatch(const std::stop_token& stop, EventStream& events);

  Player player_;
  Runs runs_;
  BadLineHandler onBadLine_;
  EndHandler onEnd_;
  SeekBegunHandler onSeekBegun_;
  SeekEndedHandler onSeekEnded_;
  /// Bytes of payload in the main thread's batch.
  std::size_t batchBytes_ = 0;
  std::jthread thread_;
  /// There while the main thread is to play.
  std::shared_ptr<std::monostate> turn_;
};

}  // namespace corvik
