#include "platform/output_lines.h"

#include <algorithm>
#include <cerrno>
#include <climits>
#include <csignal>
#include <cstring>
#include <poll.h>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

#include "platform/visible_text.h"

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

}  // namespace

DescriptorSink::DescriptorSink(int descriptor, std::string name)
    : descriptor_(descriptor),
      name_(std::move(name)),
      isTerminal_(isatty(descriptor) == 1),
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
  std::string_view rest = buffer_;
  while (!rest.empty() && !hasFailed_) {
    if (waitForRoom() == Room::interrupted) break;
    const std::size_t most = interrupt_ == nullptr ? rest.size() : chunk_;
    const ssize_t written = ::write(descriptor_, rest.data(), std::min(rest.size(), most));
    if (written >= 0) {
      rest.remove_prefix(static_cast<std::size_t>(written));
    } else if (errno != EINTR && errno != EAGAIN) {
      fail(errno);
    }
  }
  buffer_.clear();
}

DescriptorSink::Room DescriptorSink::waitForRoom() const {
  if (interrupt_ == nullptr) return Room::some;
  pollfd polled[] = {{descriptor_, POLLOUT, 0}, {interrupt_->descriptor(), POLLIN, 0}};
  // What poll fails for, the write that follows tells better.
  while (poll(polled, std::size(polled), -1) < 0 && errno == EINTR) {
  }
  const bool isBlocked = polled[0].revents == 0;
  return isBlocked && polled[1].revents != 0 ? Room::interrupted : Room::some;
}

void DescriptorSink::fail(int error) {
  hasFailed_ = true;
  if (onFailure_) onFailure_(name_ + ": " + std::strerror(error));
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
