#include "system/output_lines.h"

#include <algorithm>
#include <cerrno>
#include <climits>
#include <csignal>
#include <cstring>
#include <poll.h>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

#include "system/clock.h"
#include "system/file.h"
#include "values/visible_text.h"

namespace vesk {

namespace {

constexpr std::size_t kMuch = 65536;

std::size_t chunkOf(int descriptor) {
  struct stat status {};
  const bool isFile = fstat(descriptor, &status) == 0 && S_ISREG(status.st_mode);
  return isFile ? kMuch : PIPE_BUF;
}

std::unique_ptr<OutputSink>& sinkInForce() {
  static std::unique_ptr<OutputSink> theSink = std::make_unique<DescriptorSink>(STDOUT_FILENO, "standard output");
  return theSink;
}

/// Milliseconds.
constexpr int kUntilAskedAgain = 10;

}  // namespace

DescriptorSink::DescriptorSink(int descriptor, std::string name)
    : descriptor_(descriptor),
      name_(std::move(name)),
      isTerminal_(isatty(descriptor) == 1),
      terminal_(openUnblocked(descriptor)),
      chunk_(chunkOf(descriptor)) {
  std::signal(SIGPIPE, SIG_IGN);
}

void DescriptorSink::write(std::string_view line) {
  if (hasFailed_) return;
  buffer_ += line;
  buffer_ += '\n';
  if (isTerminal_ || buffer_.size() >= kMuch) flush();
}

void DescriptorSink::flush() {
  const bool mayBlock = interrupt_ == nullptr && !deadline_;
  std::optional<Instant> end = endOfPatience();
  bool wasRefused = false;
  std::string_view rest = buffer_;
  while (!rest.empty() && !hasFailed_) {
    const Room room = mayBlock ? Room::some : waitForRoom(end, wasRefused);
    if (room == Room::interrupted) break;
    if (room == Room::neverAgain) {
      fail("nobody reads it");
      break;
    }
    const ssize_t written = mayBlock ? ::write(descriptor_, rest.data(), rest.size()) : writeWhatFits(rest);
    wasRefused = written < 0 && errno == EAGAIN;
    if (written >= 0) {
      rest.remove_prefix(static_cast<std::size_t>(written));
      end = endOfPatience();
    } else if (errno != EINTR && errno != EAGAIN) {
      fail(std::strerror(errno));
    }
  }
  buffer_.clear();
}

ssize_t DescriptorSink::writeWhatFits(std::string_view bytes) const {
  const int descriptor = terminal_.isOpen() ? terminal_.get() : descriptor_;
  return ::write(descriptor, bytes.data(), std::min(bytes.size(), chunk_));
}

std::optional<DescriptorSink::Instant> DescriptorSink::endOfPatience() const {
  if (!deadline_) return std::nullopt;
  return std::max(*deadline_, std::chrono::steady_clock::now()) + patience_;
}

DescriptorSink::Room DescriptorSink::waitForRoom(std::optional<Instant> end, bool wasRefused) const {
  // A negative descriptor is passed over.
  pollfd polled[] = {{wasRefused ? -1 : descriptor_, POLLOUT, 0},
                     {interrupt_ != nullptr ? interrupt_->descriptor() : -1, POLLIN, 0}};
  for (;;) {
    const int untilEnd = end ? pollTimeout(*end - std::chrono::steady_clock::now()) : -1;
    const int count = poll(polled, std::size(polled), wasRefused ? kUntilAskedAgain : untilEnd);
    if (polled[0].revents != 0) return Room::some;
    if (polled[1].revents != 0) return Room::interrupted;
    if (end && std::chrono::steady_clock::now() >= *end) return Room::neverAgain;
    // What poll fails for, the write that follows tells better.
    if (wasRefused || (count < 0 && errno != EINTR)) return Room::some;
  }
}

void DescriptorSink::fail(const char* reason) {
  hasFailed_ = true;
  if (onFailure_) onFailure_(name_ + ": " + reason);
}

std::unique_ptr<OutputSink> OutputLines::setSink(std::unique_ptr<OutputSink> sink) {
  flush();
  return std::exchange(sinkInForce(), std::move(sink));
}

bool OutputLines::isOpen() {
  return sinkInForce() != nullptr;
}

void OutputLines::print(std::initializer_list<std::string_view> items) {
  OutputSink* sink = sinkInForce().get();
  if (sink == nullptr) return;
  // Kept for its storage: lines are printed for every event.
  static std::string line;
  line.clear();
  std::string_view separator;
  for (const std::string_view item : items) {
    line += separator;
    appendVisible(line, item);
    separator = " ";
  }
  sink->write(line);
}

void OutputLines::flush() {
  if (OutputSink* sink = sinkInForce().get()) sink->flush();
}

}  // namespace vesk
