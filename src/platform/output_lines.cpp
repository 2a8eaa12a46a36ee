#include "platform/output_lines.h"

#include <algorithm>
#include <cerrno>
#include <climits>
#include <csignal>
#include <cstring>
#include <limits>
#include <poll.h>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

#include "platform/file.h"
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
  std::string_view rest = buffer_;
  while (!rest.empty() && !hasFailed_) {
    const Room room = mayBlock ? Room::some : waitForRoom();
    if (room == Room::interrupted) break;
    if (room == Room::neverAgain) {
      fail("nobody reads it");
      break;
    }
    const ssize_t written = mayBlock ? ::write(descriptor_, rest.data(), rest.size()) : writeWhatFits(rest);
    if (written >= 0) {
      rest.remove_prefix(static_cast<std::size_t>(written));
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

DescriptorSink::Room DescriptorSink::waitForRoom() const {
  // A negative descriptor is passed over.
  pollfd polled[] = {{descriptor_, POLLOUT, 0}, {interrupt_ != nullptr ? interrupt_->descriptor() : -1, POLLIN, 0}};
  // What poll fails for, the write that follows tells better.
  int count = 0;
  do
    count = poll(polled, std::size(polled), longestWait());
  while ((count < 0 && errno == EINTR) || (count == 0 && std::chrono::steady_clock::now() < *deadline_));
  if (count == 0) return Room::neverAgain;
  const bool isBlocked = polled[0].revents == 0;
  return isBlocked && polled[1].revents != 0 ? Room::interrupted : Room::some;
}

int DescriptorSink::longestWait() const {
  if (!deadline_) return -1;
  using std::chrono::milliseconds;
  const auto left = std::chrono::ceil<milliseconds>(*deadline_ - std::chrono::steady_clock::now());
  const auto wait = std::max(left, milliseconds(0)) + patience_;
  return static_cast<int>(std::min<milliseconds::rep>(wait.count(), std::numeric_limits<int>::max()));
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
