#include "diag/port/port_service.h"

#include <algorithm>
#include <chrono>
#include <cmath>
#include <poll.h>
#include <utility>

#include "diag/framing/packet_reader.h"
#include "system/system_log.h"

namespace vesk::diag {

using ::corvik::EventStream;
using namespace std::chrono_literals;

namespace {

constexpr std::size_t kReadAtOnce = std::size_t{64} << 10;
/// Between two looks whether the port has come back.
constexpr auto kLookAgain = 1s;
/// A modem that was just plugged in takes a while to answer.
constexpr auto kStartUp = 5s;
constexpr auto kBetweenLogsOfState = 60s;

}  // namespace

PortService::PortService(Port port, std::optional<std::uint32_t> sim, const Clock& clock)
    : clock_(clock), port_(std::move(port)), receiver_(sim), buffer_(kReadAtOnce) {}

PortState PortService::state() const {
  const Clock::Instant now = clock_.now();
  const std::lock_guard lock(mutex_);
  PortState shown = state_;
  shown.dropped = queue_.dropped();
  if (now - secondBegan_ > 2s) shown.packetsPerSecond = 0;
  return shown;
}

void PortService::start(EventStream& events) {
  reader_ = std::jthread([this, &events](const std::stop_token& stop) { run(stop, events); });
  deliverer_ = std::jthread([this, &events](const std::stop_token& stop) { deliver(stop, events); });
}

void PortService::endThreads() {
  if (!reader_.joinable()) return;
  reader_.request_stop();
  interrupt_.signal();
  reader_.join();
  interrupt_.clear();
  deliverer_.request_stop();
  deliverer_.join();
}

::corvik::Result PortService::answer(const ::corvik::MetricQuery&, EventStream&) {
  return {};
}

void PortService::deliver(const std::stop_token& stop, EventStream& events) {
  while (events.waitUntilWanted(stop)) {
    std::optional<InterProcessDictionary> event = queue_.take(stop);
    if (!event) return;
    events.deliver(::corvik::kEventMetric, std::move(*event));
  }
}

void PortService::run(const std::stop_token& stop, EventStream& events) {
  if (!events.waitUntilWanted(stop)) return;
  if (!port_.isTerminal()) tell(port_.path() + " is no terminal, and used without terminal settings", events);
  nextLogOfState_ = clock_.now() + kBetweenLogsOfState;
  for (;;) {
    Ending ending = port_.isOpen() ? watch(stop, events) : Ending::portGone;
    if (ending == Ending::stopped) break;
    if (ending == Ending::portGone && !hasWatched_) {
      failure_ = port_.path() + ": it ended without an answer: not a diagnostic port, or just unplugged";
      ending = Ending::failed;
    }
    if (ending == Ending::failed && !hasWatched_) {
      if (onEnd_) events.afterDelivery([end = onEnd_, failure = failure_] { end(failure); });
      break;
    }
    tell(ending == Ending::failed ? failure_ + "; trying again" : port_.path() + " was unplugged, and is waited for",
         events);
    if (!waitForPort(ending == Ending::failed ? kStartUp : kLookAgain, stop)) break;
    tell(port_.path() + " is back", events);
  }
  note(PortState::Phase::ended);
}

PortService::Ending PortService::watch(const std::stop_token& stop, EventStream& events) {
  note(PortState::Phase::starting);
  port_.drain();
  FrameReader frames;
  Session session(clock_.now());
  for (;;) {
    if (!sendAndTell(session, events)) return Ending::portGone;
    const bool isStopped = stop.stop_requested();
    if (isStopped) {
      session.end(clock_.now());
      if (!sendAndTell(session, events)) return Ending::stopped;
    }
    if (session.phase() == Session::Phase::ended) return Ending::stopped;
    if (session.phase() == Session::Phase::failed) {
      failure_ = port_.path() + ": " + session.failure();
      return Ending::failed;
    }
    const Clock::Instant wakeAt = std::min(session.deadline().value_or(nextLogOfState_), nextLogOfState_);
    pollfd waited[] = {{port_.descriptor(), POLLIN, 0}, {interrupt_.descriptor(), POLLIN, 0}};
    // The interrupt stays signalled while the modem is waited for to have stopped.
    clock_.waitUntil(wakeAt, std::span(waited).first(isStopped ? 1 : 2));
    if (waited[0].revents != 0 && !readSome(frames, session, stop))
      return isStopped ? Ending::stopped : Ending::portGone;
    session.advance(clock_.now());
    if (clock_.now() >= nextLogOfState_) logState();
  }
}

bool PortService::sendAndTell(Session& session, EventStream& events) {
  while (const std::optional<Command> command = session.takeCommand()) {
    if (!port_.send(*command)) return false;
  }
  for (const std::string& remark : session.takeRemarks())
    tell(port_.path() + ": " + remark, events);
  for (const std::string& remark : remarks_.take(receiver_.counts()))
    tell(port_.path() + ": " + remark, events);
  noteWatching(session);
  return true;
}

void PortService::noteWatching(const Session& session) {
  if (session.phase() != Session::Phase::watching) return;
  if (state().phase == PortState::Phase::starting)
    SystemLog::write("%s: watching the logs of firmware %s", port_.path().c_str(), session.firmware().c_str());
  hasWatched_ = true;
  note(session.isSilent() ? PortState::Phase::silent : PortState::Phase::watching);
}

bool PortService::readSome(FrameReader& frames, Session& session, const std::stop_token& stop) {
  const auto bytes = port_.read(buffer_);
  if (!bytes) return false;
  frames.take(*bytes);
  while (const std::optional<Frame> frame = frames.next()) {
    if (frame->isSound) {
      take(frame->content, session, stop);
    } else if (hasWatched_) {
      // Before that, it is what a program before this one has left there.
      receiver_.noteDamagedFrame();
      // Known before the events behind it come.
      noteCounts();
    }
  }
  noteCounts();
  return true;
}

void PortService::take(std::span<const std::uint8_t> content, Session& session, const std::stop_token& stop) {
  if (onFrame_) onFrame_(content);
  const Packet packet = readPacket(content);
  const Clock::Instant now = clock_.now();
  if (packet.kind == PacketKind::log) {
    session.noteLog(now);
    noteLog(now);
  } else if (packet.kind == PacketKind::encryptedLog) {
    session.noteEncryptedLog();
  } else if (!packet.content.empty()) {
    session.takeAnswer(packet.content, now);
    // Known before the first log comes.
    noteWatching(session);
  }
  for (const Event& event : receiver_.take(packet))
    queue_.add(event, stop);
}

bool PortService::waitForPort(Clock::Duration first, const std::stop_token& stop) {
  note(PortState::Phase::unplugged);
  Clock::Duration wait = first;
  do {
    port_.close();
    clock_.sleepUntil(clock_.now() + wait, interrupt_);
    if (stop.stop_requested()) return false;
    port_ = Port(port_.path());
    wait = kLookAgain;
  } while (!port_.isOpen());
  return true;
}

void PortService::noteLog(Clock::Instant now) {
  const std::lock_guard lock(mutex_);
  if (const Clock::Duration passed = now - secondBegan_; passed >= 1s) {
    const double seconds = std::chrono::duration<double>(passed).count();
    state_.packetsPerSecond = static_cast<std::uint32_t>(std::lround(packetsOfSecond_ / seconds));
    packetsOfSecond_ = 0;
    secondBegan_ = now;
  }
  ++packetsOfSecond_;
}

void PortService::note(PortState::Phase phase) {
  const std::lock_guard lock(mutex_);
  state_.phase = phase;
}

void PortService::noteCounts() {
  const std::lock_guard lock(mutex_);
  state_.damaged = receiver_.counts().damaged();
  state_.passedOver = receiver_.counts().passedOver();
}

void PortService::logState() {
  nextLogOfState_ = clock_.now() + kBetweenLogsOfState;
  const PortState shown = state();
  SystemLog::write("%s: %u packets/s, %llu damaged, %llu passed over, %llu dropped", port_.path().c_str(),
                   static_cast<unsigned>(shown.packetsPerSecond), static_cast<unsigned long long>(shown.damaged),
                   static_cast<unsigned long long>(shown.passedOver), static_cast<unsigned long long>(shown.dropped));
}

void PortService::tell(std::string remark, EventStream& events) {
  SystemLog::write("%s", remark.c_str());
  if (onRemark_) events.afterDelivery([tell = onRemark_, remark = std::move(remark)] { tell(remark); });
}

}  // namespace vesk::diag
