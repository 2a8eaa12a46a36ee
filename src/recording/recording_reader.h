#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <variant>

#include "recording/line_reader.h"
#include "recording/recorded_event.h"

namespace vesk {

/// A line that holds no event, as FILE:LINE: reason.
struct BadLine {
  std::string message;
};

/// The recording cannot be read (on), as FILE: reason.
struct ReadFailure {
  std::string message;
};

struct EndOfRecording {};

/// Reads a recording event by event: a file, or a pipe while it is being written. An event is handed on as
/// soon as its line is complete, and memory does not grow with the recording. One thread at a time.
class RecordingReader {
 public:
  using Step = std::variant<RecordedEvent, BadLine, ReadFailure, EndOfRecording>;

  /// Over the file at `path`; "-" is standard input. One that cannot be opened shows in failure().
  explicit RecordingReader(const std::string& path);
  /// Over an open descriptor, called `name` in messages.
  RecordingReader(FileDescriptor descriptor, std::string name, std::size_t longestLine = LineReader::kLongestLine);
  /// Reads on in `input`.
  explicit RecordingReader(ByteInput input, std::size_t longestLine = LineReader::kLongestLine);

  /// See ByteInput::BeforeRead: the place to write out what is buffered, or to wait with a way out.
  void setBeforeRead(ByteInput::BeforeRead beforeRead) { lines_.input().setBeforeRead(std::move(beforeRead)); }

  /// The next event, whose payload is valid until the next call, or what stands in its place. Blank lines are
  /// passed over. Nothing follows a failure; after the end of a file, what was appended to it since follows.
  [[nodiscard]] Step next();

  /// Why nothing can be read (any more).
  [[nodiscard]] const std::optional<std::string>& failure() const { return lines_.input().failure(); }
  /// As shown to people: the path, or "standard input".
  [[nodiscard]] const std::string& name() const { return lines_.input().name(); }
  /// The number of the last line that next() looked at, from 1.
  [[nodiscard]] std::size_t lineNumber() const { return lines_.lineNumber(); }

  /// "at" of the last event, where the end of the recording can be looked at beforehand: not in a pipe.
  [[nodiscard]] std::optional<double> duration() const;
  /// Back to the first line; false when there is no way back, as in a pipe.
  [[nodiscard]] bool rewind() { return lines_.rewind(); }

 private:
  [[nodiscard]] BadLine badLine(std::string_view reason) const;

  LineReader lines_;
  RecordedEventParser parser_;
};

}  // namespace vesk
