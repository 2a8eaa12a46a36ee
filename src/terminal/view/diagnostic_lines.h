#pragma once

#include <cstddef>
#include <cstdint>
#include <deque>
#include <functional>
#include <string>
#include <string_view>

#include "system/output_lines.h"

namespace vesk {

/// The last lines that the program wrote for diagnosis, kept for showing. Main queue only.
class DiagnosticLines {
 public:
  /// `capacity` is at least 1.
  explicit DiagnosticLines(std::size_t capacity = 1000) : capacity_(capacity) {}

  /// More of a line is not kept.
  static constexpr std::size_t kLongestLine = 4096;

  /// Adds one line without its line feed; beyond the capacity the oldest goes.
  void append(std::string_view line) {
    if (lines_.size() == capacity_) lines_.pop_front();
    lines_.emplace_back(line.substr(0, kLongestLine));
    ++total_;
    if (observer_) observer_();
  }
  /// `observer` is called after every line.
  void setObserver(std::function<void()> observer) { observer_ = std::move(observer); }

  [[nodiscard]] const std::deque<std::string>& lines() const { return lines_; }
  /// How many there ever were.
  [[nodiscard]] std::uint64_t total() const { return total_; }

 private:
  std::size_t capacity_;
  std::deque<std::string> lines_;
  std::uint64_t total_ = 0;
  std::function<void()> observer_;
};

/// Brings the program's output lines there instead of to standard output.
class DiagnosticSink : public OutputSink {
 public:
  /// `lines` must outlive the sink.
  explicit DiagnosticSink(DiagnosticLines& lines) : lines_(lines) {}

  void write(std::string_view line) override { lines_.append(line); }
  void flush() override {}

 private:
  DiagnosticLines& lines_;
};

}  // namespace vesk
