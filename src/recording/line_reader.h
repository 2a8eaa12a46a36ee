#pragma once

#include <cstddef>
#include <memory>
#include <span>
#include <utility>

#include "recording/timed_events.h"
#include "system/file_descriptor.h"

namespace vesk {

/// Splits what a file descriptor yields into lines, each handed on as soon as its line feed has arrived. One
/// buffer holds what was read; it grows only for a line that does not fit.
class LineReader {
 public:
  enum class Found { line, tooLongLine, end, failure };
  static constexpr std::size_t kLongestLine = std::size_t{8} << 20;

  /// `padding` bytes behind every line may be read, whatever they hold, and the first be overwritten.
  LineReader(FileDescriptor descriptor, std::size_t padding, std::size_t longestLine = kLongestLine);

  void setBeforeRead(TimedEvents::BeforeRead beforeRead) { beforeRead_ = std::move(beforeRead); }

  /// Finds the next line. One beyond the longest is passed over without being kept. After a failure errno
  /// tells why, and so it stays.
  [[nodiscard]] Found next();
  /// The line found, without its line feed; valid, and to do with as one likes, until the next call.
  [[nodiscard]] std::span<char> line() const { return line_; }
  /// Its number, from 1.
  [[nodiscard]] std::size_t lineNumber() const { return lineNumber_; }

  [[nodiscard]] int descriptor() const { return descriptor_.get(); }
  /// Back to the first line; false when the input has no way back.
  [[nodiscard]] bool rewind();

 private:
  enum class Input { more, end, failure };

  [[nodiscard]] Input refill();
  void makeRoom();
  Found take(std::size_t end, std::size_t next);

  FileDescriptor descriptor_;
  std::size_t padding_;
  std::size_t longestLine_;
  TimedEvents::BeforeRead beforeRead_;

  std::unique_ptr<char[]> buffer_;
  std::size_t capacity_;
  std::size_t begin_ = 0;    ///< of what has not been handed on
  std::size_t scanned_ = 0;  ///< no line feed between begin_ and here
  std::size_t end_ = 0;      ///< of what was read
  bool isPassingOver_ = false;

  std::span<char> line_;
  std::size_t lineNumber_ = 0;
};

}  // namespace vesk
