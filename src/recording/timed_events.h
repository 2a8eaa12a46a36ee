#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <span>
#include <string>
#include <variant>

namespace vesk {

/// One metric event of a recording.
struct RecordedEvent {
  /// Seconds since the recording began: finite, not negative.
  double at;
  std::int64_t metricId;
  std::span<const std::uint8_t> payload;
};

/// A line that holds no event, as FILE:LINE: reason.
struct BadLine {
  std::string message;
};

/// The recording cannot be read (on), as FILE: reason.
struct ReadFailure {
  std::string message;
};

struct EndOfRecording {};

/// Events with their times, read one after another: whatever can be played. One thread at a time.
class TimedEvents {
 public:
  using Step = std::variant<RecordedEvent, BadLine, ReadFailure, EndOfRecording>;
  /// Called before every read(2), which may block: the place to write out what is buffered, or to wait with a way out.
  /// False ends the reading as if the input had ended.
  using BeforeRead = std::function<bool(int descriptor)>;

  virtual ~TimedEvents() = default;

  virtual void setBeforeRead(BeforeRead beforeRead) = 0;
  /// The next event, whose payload is valid until the next call, or what stands in its place. Nothing follows a
  /// failure; after the end of a file, what was appended to it since follows.
  [[nodiscard]] virtual Step next() = 0;
  /// Back to the first event; false when there is no way back, as in a pipe.
  [[nodiscard]] virtual bool rewind() = 0;
  /// "at" of the last event, where the end can be looked at beforehand: not in a pipe.
  [[nodiscard]] virtual std::optional<double> duration() const = 0;

 protected:
  TimedEvents() = default;
  TimedEvents(TimedEvents&&) = default;
  TimedEvents& operator=(TimedEvents&&) = default;
};

}  // namespace vesk
