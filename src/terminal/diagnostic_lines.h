#pragma once

#include <cstddef>
#include <cstdint>
#include <deque>
#include <string>
#include <string_view>

namespace vesk {

/// The last lines that the program wrote for diagnosis, kept for showing. Main queue only.
class DiagnosticLines {
 public:
  explicit DiagnosticLines(std::size_t capacity = 1000) : capacity_(capacity) {}

  /// Adds one line without its line feed; beyond the capacity the oldest goes.
  void append(std::string_view line) {
    if (lines_.size() == capacity_) lines_.pop_front();
    lines_.emplace_back(line);
    ++total_;
  }

  [[nodiscard]] const std::deque<std::string>& lines() const { return lines_; }
  /// How many there ever were.
  [[nodiscard]] std::uint64_t total() const { return total_; }

 private:
  std::size_t capacity_;
  std::deque<std::string> lines_;
  std::uint64_t total_ = 0;
};

}  // namespace vesk
