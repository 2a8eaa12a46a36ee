#include "system/system_log.h"

#include <algorithm>
#include <atomic>
#include <cerrno>
#include <chrono>
#include <climits>
#include <cstdarg>
#include <cstdio>
#include <fcntl.h>
#include <mutex>
#include <poll.h>
#include <syslog.h>
#include <unistd.h>
#include <utility>

#include "system/clock.h"
#include "system/file.h"
#include "values/visible_text.h"

namespace vesk {

namespace {

class SyslogSink : public LogSink {
 public:
  SyslogSink() { openlog("vesk", LOG_PID, LOG_USER); }
  ~SyslogSink() override { closelog(); }
  SyslogSink(const SyslogSink&) = delete;
  SyslogSink& operator=(const SyslogSink&) = delete;

  void write(std::string_view line) override { syslog(LOG_NOTICE, "%.*s", static_cast<int>(line.size()), line.data()); }
};

class DescriptorLogSink : public LogSink {
 public:
  DescriptorLogSink(FileDescriptor descriptor, std::chrono::milliseconds patience)
      : descriptor_(std::move(descriptor)), patience_(patience) {
    if (FileDescriptor unblocked = openUnblocked(descriptor_.get()); unblocked.isOpen()) {
      descriptor_ = std::move(unblocked);
    }
  }

  void write(std::string_view line) override {
    std::string whole;
    if (dropped_ > 0) {
      if (isCut_) whole += '\n';
      whole += std::to_string(dropped_) + " lines were dropped here\n";
    }
    whole += line;
    whole += '\n';
    const std::size_t left = leftOf(whole);
    if (left == 0) {
      dropped_ = 0;
      isCut_ = false;
    } else {
      ++dropped_;
      if (left < whole.size()) isCut_ = true;
    }
  }

 private:
  /// How many bytes the reader does not take. It is waited for once; when it has let that pass, no more until it reads.
  std::size_t leftOf(std::string_view bytes) {
    using std::chrono::steady_clock;
    const auto deadline = steady_clock::now() + (dropped_ > 0 ? std::chrono::milliseconds(0) : patience_);
    while (!bytes.empty()) {
      const int wait = pollTimeout(deadline - steady_clock::now());
      const ssize_t written = writeWithin(wait, bytes);
      if (written > 0) {
        bytes.remove_prefix(static_cast<std::size_t>(written));
      } else if (wait == 0 || (written < 0 && errno != EINTR && errno != EAGAIN)) {
        break;
      }
    }
    return bytes.size();
  }

  /// write(2), of some of the bytes, once there is room; 0 when there is none within that many milliseconds.
  [[nodiscard]] ssize_t writeWithin(int milliseconds, std::string_view bytes) const {
    pollfd polled{descriptor_.get(), POLLOUT, 0};
    const int ready = poll(&polled, 1, milliseconds);
    if (ready <= 0) return ready;
    return ::write(descriptor_.get(), bytes.data(), std::min<std::size_t>(bytes.size(), PIPE_BUF));
  }

  FileDescriptor descriptor_;
  std::chrono::milliseconds patience_;
  /// Lines since the reader last took one, and whether the first of them was written in part.
  std::size_t dropped_ = 0;
  bool isCut_ = false;
};

struct State {
  std::mutex mutex;
  std::unique_ptr<LogSink> sink;
};

std::atomic<bool> logIsOpen = false;

State& state() {
  static State theState;
  return theState;
}

std::string formatted(const char* format, std::va_list arguments) {
  std::va_list measured;
  va_copy(measured, arguments);
  const int size = std::vsnprintf(nullptr, 0, format, measured);
  va_end(measured);
  if (size < 0) return format;
  std::string line(static_cast<std::size_t>(size), '\0');
  std::vsnprintf(line.data(), line.size() + 1, format, arguments);
  return line;
}

}  // namespace

std::unique_ptr<LogSink> makeSyslogSink() {
  return std::make_unique<SyslogSink>();
}

std::unique_ptr<LogSink> makeStandardErrorSink() {
  return std::make_unique<DescriptorLogSink>(FileDescriptor::borrowed(STDERR_FILENO), kLogPatience);
}

std::unique_ptr<LogSink> makeFileSink(const std::string& path, std::chrono::milliseconds patience) {
  constexpr int kMode = 0666;
  FileDescriptor file(open(path.c_str(), O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC, kMode));
  if (!file.isOpen()) return nullptr;
  return std::make_unique<DescriptorLogSink>(std::move(file), patience);
}

std::unique_ptr<LogSink> SystemLog::setSink(std::unique_ptr<LogSink> sink) {
  const std::lock_guard lock(state().mutex);
  logIsOpen = sink != nullptr;
  return std::exchange(state().sink, std::move(sink));
}

bool SystemLog::isOpen() {
  return logIsOpen.load(std::memory_order_relaxed);
}

void SystemLog::write(const char* format, ...) {
  if (!isOpen()) return;
  std::va_list arguments;
  va_start(arguments, format);
  std::string line;
  appendVisible(line, formatted(format, arguments));
  va_end(arguments);
  const std::lock_guard lock(state().mutex);
  if (state().sink != nullptr) state().sink->write(line);
}

}  // namespace vesk
