#pragma once

#include <chrono>
#include <functional>
#include <initializer_list>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

#include "system/clock.h"
#include "system/descriptor_writer.h"
#include "system/wake_up.h"

namespace vesk {

/// Where the program's own lines go. Called on the main thread.
class OutputSink {
 public:
  virtual ~OutputSink() = default;
  /// One line without its line feed, nothing in it that acts on a terminal; valid during the call.
  virtual void write(std::string_view line) = 0;
  /// Hands on what is buffered.
  virtual void flush() = 0;
};

/// Writes whole lines to a descriptor: at once to a terminal, otherwise when flushed or when much has
/// gathered. Waits for a slow reader.
class DescriptorSink : public OutputSink {
 public:
  using FailureHandler = std::function<void(const std::string& reason)>;

  /// The descriptor is borrowed; `name` is what messages call it. From here on a closed pipe does not end the
  /// process: SIGPIPE is ignored.
  DescriptorSink(int descriptor, std::string name);
  ~DescriptorSink() override { DescriptorSink::flush(); }
  DescriptorSink(const DescriptorSink&) = delete;
  DescriptorSink& operator=(const DescriptorSink&) = delete;

  /// Called once, when the lines can no longer be written, with NAME: reason. They are dropped from then on.
  void setFailureHandler(FailureHandler handler) { onFailure_ = std::move(handler); }
  /// While this is signalled no slow reader is waited for, and what it does not take is dropped; null for
  /// always waiting. Must outlive the sink.
  void setInterrupt(const WakeUp* interrupt) { interrupt_ = interrupt; }
  /// From `deadline` on a reader that takes nothing for as long as `patience` has failed. Absent for never.
  void setDeadline(std::optional<Clock::Instant> deadline, Clock::Duration patience = std::chrono::seconds(1)) {
    deadline_ = deadline;
    patience_ = patience;
  }

  void write(std::string_view line) override;
  void flush() override;
  [[nodiscard]] bool hasFailed() const { return hasFailed_; }

 private:
  void fail(const char* reason);

  DescriptorWriter writer_;
  std::string name_;
  bool isTerminal_;
  const WakeUp* interrupt_ = nullptr;
  std::optional<Clock::Instant> deadline_;
  Clock::Duration patience_{};
  FailureHandler onFailure_;
  bool hasFailed_ = false;
  std::string buffer_;
};

/// The program's diagnostic lines; on the main thread. They go to standard output until a sink is set.
class OutputLines {
 public:
  /// Puts `sink` in the place of the one in force and returns that. Null drops all lines.
  static std::unique_ptr<OutputSink> setSink(std::unique_ptr<OutputSink> sink);
  /// Whether a line would go anywhere: ask before building a costly one.
  [[nodiscard]] static bool isOpen();
  /// Prints one line: the items, separated by one blank, control characters made visible.
  static void print(std::initializer_list<std::string_view> items);
  static void flush();
};

}  // namespace vesk
