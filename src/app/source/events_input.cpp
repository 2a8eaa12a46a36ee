#include "app/source/events_input.h"

#include <sys/stat.h>
#include <utility>

#include "diag/capture/capture_reader.h"
#include "diag/capture/capture_remarks.h"
#include "diag/capture/content.h"
#include "recording/recording_reader.h"

namespace vesk {

namespace {

using diag::Content;

/// Bytes of a capture that are read twice without being felt.
constexpr std::int64_t kMostMeasured = std::int64_t{64} << 20;

}  // namespace

EventsInput::EventsInput(const std::string& path, std::optional<std::uint32_t> sim) : sim_(sim), input_(path) {
  struct stat status {};
  if (input_.failure() || fstat(input_.descriptor(), &status) != 0) return;
  isLive_ = !S_ISREG(status.st_mode);
  size_ = status.st_size;
}

EventsInput::~EventsInput() = default;

std::optional<std::string> EventsInput::open() {
  if (reader_ != nullptr) return std::nullopt;
  const Content content = diag::tellContent(input_);
  if (input_.failure()) return input_.failure();
  if (const char* reason = diag::whyUnreadable(content)) return input_.name() + ' ' + reason;
  if (sim_ && content == Content::recording)
    return input_.name() + " is a recording, which does not tell SIMs apart: leave out --sim, or give it the capture";
  if (const auto form = diag::captureFormOf(content)) {
    auto capture = std::make_unique<diag::CaptureReader>(std::move(input_), *form, sim_);
    capture_ = capture.get();
    reader_ = std::move(capture);
  } else {
    auto recording = std::make_unique<RecordingReader>(std::move(input_));
    recording_ = recording.get();
    reader_ = std::move(recording);
  }
  return std::nullopt;
}

void EventsInput::measure() {
  if (capture_ != nullptr && !isLive_ && size_ <= kMostMeasured) capture_->measure();
}

std::vector<std::string> EventsInput::remarks() const {
  return capture_ == nullptr ? std::vector<std::string>() : diag::remarksOn(*capture_);
}

void EventsInput::setBeforeRead(BeforeRead beforeRead) {
  if (reader_ == nullptr) {
    input_.setBeforeRead(std::move(beforeRead));
  } else {
    reader_->setBeforeRead(std::move(beforeRead));
  }
}

TimedEvents::Step EventsInput::next() {
  if (const std::optional<std::string> failure = open()) return ReadFailure{*failure};
  return reader_->next();
}

std::optional<double> EventsInput::duration() const {
  return reader_ == nullptr ? std::nullopt : reader_->duration();
}

}  // namespace vesk
