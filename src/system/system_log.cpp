#include "system/system_log.h"

#include <atomic>
#include <chrono>
#include <cstdarg>
#include <cstdio>
#include <fcntl.h>
#include <mutex>
#include <syslog.h>
#include <unistd.h>
#include <utility>

#include "system/descriptor_writer.h"
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
      : writer_(std::move(descriptor)), patience_(patience) {}

  void write(std::string_view line) override {
    std::string whole;
    if (dropped_ > 0) {
      if (isCut_) whole += '\n';
      whole += std::to_string(dropped_) + " lines were dropped here\n";
    }
    whole += line;
    whole += '\n';
    // The reader is waited for once; when it has let that pass, no more until it reads.
    const std::chrono::milliseconds patience = dropped_ > 0 ? std::chrono::milliseconds(0) : patience_;
    const std::size_t taken = writer_.write(whole, {.end = std::chrono::steady_clock::now() + patience}).count;
    if (taken == whole.size()) {
      dropped_ = 0;
      isCut_ = false;
    } else {
      ++dropped_;
      if (taken > 0) isCut_ = true;
    }
  }

 private:
  DescriptorWriter writer_;
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
