#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "recording/byte_input.h"
#include "recording/timed_events.h"

namespace vesk {

class RecordingReader;

namespace diag {
class CaptureReader;
}

/// The events of a file or pipe that holds a recording or a capture, which its content tells.
class EventsInput final : public TimedEvents {
 public:
  /// Over the file at `path`; "-" is standard input. `sim` is the one whose packets a capture is read for, absent for
  /// all; a recording is not read with it.
  EventsInput(const std::string& path, std::optional<std::uint32_t> sim);
  ~EventsInput() override;
  EventsInput(const EventsInput&) = delete;
  EventsInput& operator=(const EventsInput&) = delete;

  /// Whether it can be read, and its end is elsewhere than in a file.
  [[nodiscard]] bool isLive() const { return isLive_; }
  /// Finds out what it holds, which next() does otherwise; a pipe is waited for. Why it cannot be read, as NAME:
  /// reason.
  std::optional<std::string> open();
  /// Once it is open: learns how long a capture takes by reading it, where that is not felt.
  void measure();
  /// Where it is open and a recording; else null.
  [[nodiscard]] RecordingReader* recording() const { return recording_; }
  /// Once all was read: what the user should know of a capture, one line each.
  [[nodiscard]] std::vector<std::string> remarks() const;

  void setBeforeRead(BeforeRead beforeRead) override;
  [[nodiscard]] Step next() override;
  [[nodiscard]] bool rewind() override { return reader_ != nullptr && reader_->rewind(); }
  [[nodiscard]] std::optional<double> duration() const override;

 private:
  std::optional<std::uint32_t> sim_;
  /// Before it is open.
  ByteInput input_;
  bool isLive_ = false;
  std::int64_t size_ = 0;
  std::unique_ptr<TimedEvents> reader_;
  /// The reader, as what it is.
  RecordingReader* recording_ = nullptr;
  diag::CaptureReader* capture_ = nullptr;
};

}  // namespace vesk
