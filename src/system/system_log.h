#pragma once

#include <chrono>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

namespace vesk {

/// Where the lines of the system log go. A sink is called from any thread, one call at a time, with one line
/// that has no line feed.
class LogSink {
 public:
  virtual ~LogSink() = default;
  virtual void write(std::string_view line) = 0;
};

[[nodiscard]] std::unique_ptr<LogSink> makeSyslogSink();
/// How long the program waits for a reader of the log that has stopped reading. From then on lines are dropped until it
/// reads again, and it is told how many they were.
inline constexpr std::chrono::milliseconds kLogPatience{1000};

[[nodiscard]] std::unique_ptr<LogSink> makeStandardErrorSink();
/// Appends to the file, and drops what does not fit on a full disk; null when it cannot be opened, with errno telling
/// why. The file may be a pipe with a name. In a directory that others may write to, a link is not followed (ELOOP): it
/// might be theirs.
[[nodiscard]] std::unique_ptr<LogSink> makeFileSink(const std::string& path,
                                                    std::chrono::milliseconds patience = kLogPatience);

/// The log of the process. Without a sink, as at start, nothing is written.
class SystemLog {
 public:
  /// Puts `sink` in the place of the one in force and returns that. Null closes the log.
  static std::unique_ptr<LogSink> setSink(std::unique_ptr<LogSink> sink);
  /// Whether a line would be read by anybody: ask before building a costly one.
  [[nodiscard]] static bool isOpen();
  /// Writes one line in printf's manner; without a sink no text is built.
  [[gnu::format(printf, 1, 2)]] static void write(const char* format, ...);
};

}  // namespace vesk
