#include "system/output_lines.h"

#include <algorithm>
#include <csignal>
#include <cstring>
#include <unistd.h>
#include <utility>

#include "values/visible_text.h"

namespace vesk {

namespace {

constexpr std::size_t kFullBuffer = 65536;

std::unique_ptr<OutputSink>& sinkInForce() {
  static std::unique_ptr<OutputSink> theSink = std::make_unique<DescriptorSink>(STDOUT_FILENO, "standard output");
  return theSink;
}

}  // namespace

DescriptorSink::DescriptorSink(int descriptor, std::string name)
    : writer_(FileDescriptor::borrowed(descriptor)), name_(std::move(name)), isTerminal_(isatty(descriptor) == 1) {
  std::signal(SIGPIPE, SIG_IGN);
}

void DescriptorSink::write(std::string_view line) {
  if (hasFailed_) return;
  buffer_ += line;
  buffer_ += '\n';
  if (isTerminal_ || buffer_.size() >= kFullBuffer) flush();
}

void DescriptorSink::flush() {
  if (buffer_.empty()) return;
  WaitingPolicy policy{.interrupt = interrupt_};
  if (deadline_) {
    policy.end = std::max(*deadline_, std::chrono::steady_clock::now()) + patience_;
    policy.renewal = patience_;
  }
  const DescriptorWriter::Written written = writer_.write(buffer_, policy);
  buffer_.clear();
  switch (written.outcome) {
    case DescriptorWriter::Outcome::timedOut:
      return fail("nobody reads it");
    case DescriptorWriter::Outcome::failed:
      return fail(std::strerror(written.error));
    case DescriptorWriter::Outcome::done:
    case DescriptorWriter::Outcome::interrupted:
      break;
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
