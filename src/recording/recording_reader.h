#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "recording/line_reader.h"
#include "recording/recorded_event.h"
#include "recording/timed_events.h"

namespace vesk {

/// Reads a recording event by event: a file, or a pipe while it is being written. An event is handed on as
/// soon as its line is complete, and memory does not grow with the recording. One thread at a time.
class RecordingReader final : public TimedEvents {
 public:
  /// Over the file at `path`; "-" is standard input. One that cannot be opened shows in failure().
  explicit RecordingReader(const std::string& path);
  /// Over an open descriptor, called `name` in messages.
  RecordingReader(FileDescriptor descriptor, std::string name, std::size_t longestLine = LineReader::kLongestLine);

  void setBeforeRead(BeforeRead beforeRead) override { lines_.setBeforeRead(std::move(beforeRead)); }
  /// Passes over blank lines.
  [[nodiscard]] Step next() override;
  [[nodiscard]] bool rewind() override { return lines_.rewind(); }
  [[nodiscard]] std::optional<double> duration() const override;

  /// Why nothing can be read (any more).
  [[nodiscard]] const std::optional<std::string>& failure() const { return failure_; }
  /// As shown to people: the path, or "standard input".
  [[nodiscard]] const std::string& name() const { return name_; }
  /// The number of the last line that next() looked at, from 1.
  [[nodiscard]] std::size_t lineNumber() const { return lines_.lineNumber(); }

 private:
  [[nodiscard]] BadLine badLine(std::string_view reason) const;

  std::string name_;
  std::optional<std::string> failure_;
  LineReader lines_;
  RecordedEventParser parser_;
};

}  // namespace vesk
