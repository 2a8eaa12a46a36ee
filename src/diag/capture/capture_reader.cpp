#include "diag/capture/capture_reader.h"

#include <utility>

#include "diag/framing/packet_reader.h"

namespace vesk::diag {

namespace {

constexpr std::size_t kAtOnce = std::size_t{64} << 10;

}  // namespace

CaptureReader::CaptureReader(ByteInput input, CaptureForm form, std::optional<std::uint32_t> sim)
    : input_(std::move(input)), receiver_(sim), buffer_(kAtOnce) {
  if (form == CaptureForm::packetList) packets_.emplace<PacketListReader>();
}

CaptureReader::Step CaptureReader::next() {
  while (waiting_.empty()) {
    const Events events = takePacket();
    if (events) {
      waiting_ = *events;
    } else if (input_.failure()) {
      return ReadFailure{*input_.failure()};
    } else {
      return EndOfRecording{};
    }
  }
  const Event& event = waiting_.front();
  waiting_ = waiting_.subspan(1);
  return RecordedEvent{time_.at(event.milliseconds), event.metricId, event.payload};
}

bool CaptureReader::rewind() {
  if (!input_.rewind()) return false;
  receiver_.startOver();
  std::visit([](auto& packets) { packets = {}; }, packets_);
  time_ = {};
  hasEnded_ = isCutOff_ = false;
  waiting_ = {};
  return true;
}

void CaptureReader::measure() {
  if (!rewind()) return;
  std::optional<double> last;
  for (Step step = next(); std::holds_alternative<RecordedEvent>(step); step = next())
    last = std::get<RecordedEvent>(step).at;
  duration_ = last;
  static_cast<void>(rewind());
}

CaptureReader::Events CaptureReader::takePacket() {
  while (!hasEnded_) {
    const Events events = std::visit([this](auto& packets) { return takeFrom(packets); }, packets_);
    if (events) return events;
    if (hasEnded_) break;
    const auto bytes = std::span(buffer_).first(input_.read(buffer_));
    if (bytes.empty() && !input_.failure()) std::visit([this](auto& packets) { end(packets); }, packets_);
    hasEnded_ = bytes.empty();
    std::visit([bytes](auto& packets) { packets.take(bytes); }, packets_);
  }
  return std::nullopt;
}

CaptureReader::Events CaptureReader::takeFrom(FrameReader& frames) {
  while (const std::optional<Frame> frame = frames.next()) {
    if (frame->isSound) return receiver_.take(readPacket(frame->content));
    receiver_.noteDamagedFrame();
  }
  return std::nullopt;
}

CaptureReader::Events CaptureReader::takeFrom(PacketListReader& list) {
  if (const std::optional<LogPacket> packet = list.next()) return receiver_.take(*packet);
  if (list.isDamaged()) {
    receiver_.noteDamagedPacket();
    hasEnded_ = true;
  }
  return std::nullopt;
}

void CaptureReader::end(FrameReader& frames) {
  isCutOff_ = frames.endsWithinFrame();
  if (isCutOff_) receiver_.noteDamagedFrame();
}

void CaptureReader::end(PacketListReader& list) {
  list.end();
  isCutOff_ = list.isDamaged();
  if (isCutOff_) receiver_.noteDamagedPacket();
}

}  // namespace vesk::diag
