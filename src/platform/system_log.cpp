#include "platform/system_log.h"

#include <atomic>
#include <cstdarg>
#include <cstdio>
#include <mutex>
#include <syslog.h>
#include <utility>

#include "platform/visible_text.h"

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

class StreamSink : public LogSink {
 public:
  using Stream = std::unique_ptr<std::FILE, int (*)(std::FILE*)>;

  explicit StreamSink(Stream stream) : stream_(std::move(stream)) {}

  void write(std::string_view line) override {
    std::string whole(line);
    whole += '\n';
    std::fwrite(whole.data(), 1, whole.size(), stream_.get());
    std::fflush(stream_.get());
  }

 private:
  Stream stream_;
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
  return std::make_unique<StreamSink>(StreamSink::Stream(stderr, [](std::FILE*) { return 0; }));
}

std::unique_ptr<LogSink> makeFileSink(const std::string& path) {
  StreamSink::Stream stream(std::fopen(path.c_str(), "ae"), &std::fclose);
  if (stream == nullptr) return nullptr;
  return std::make_unique<StreamSink>(std::move(stream));
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
