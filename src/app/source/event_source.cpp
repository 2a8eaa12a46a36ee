#include "app/source/event_source.h"

#include <chrono>
#include <cmath>
#include <cstdio>
#include <utility>

#include "app/source/events_input.h"
#include "app/source/recording_input.h"
#include "app/source/recording_service.h"
#include "app/source/replay_control.h"
#include "diag/framing/frame.h"
#include "diag/port/port_service.h"
#include "handset/handset_service.h"
#include "recording/record_file.h"
#include "system/main_queue.h"
#include "values/text_form.h"

namespace vesk {

namespace {

/// Minutes and seconds, as in 3:07; hours in front when there are some.
std::string playingTime(double seconds) {
  const auto whole = static_cast<long>(std::floor(seconds));
  char text[32];
  if (whole < 3600) {
    std::snprintf(text, sizeof text, "%ld:%02ld", whole / 60, whole % 60);
  } else {
    std::snprintf(text, sizeof text, "%ld:%02ld:%02ld", whole / 3600, whole / 60 % 60, whole % 60);
  }
  return text;
}

/// "ttyUSB0: 23 packets/s, 2 damaged", and what else has gone wrong.
ShownState stateOfPort(const std::string& port, const diag::PortState& state) {
  using Phase = diag::PortState::Phase;
  std::string text = port.substr(port.rfind('/') + 1) + ": ";
  switch (state.phase) {
    case Phase::starting:
      return {text + "starting"};
    case Phase::unplugged:
      return {text + "unplugged, waiting"};
    case Phase::ended:
      return {text + "ended"};
    case Phase::silent:
      text += "silent";
      break;
    case Phase::watching:
      text += std::to_string(state.packetsPerSecond) + " packets/s";
      break;
  }
  const std::pair<std::uint64_t, const char*> counts[] = {
      {state.damaged, " damaged"}, {state.passedOver, " passed over"}, {state.dropped, " dropped"}};
  for (const auto& [count, what] : counts) {
    if (count > 0) text += ", " + std::to_string(count) + what;
  }
  return {text, true};
}

double secondsOf(const Clock& clock) {
  return std::chrono::duration<double>(clock.now().time_since_epoch()).count();
}

/// Keeps every frame in `file`; `failed` is told, on the main queue, when that is no longer possible.
diag::PortService::FrameHandler keepFrames(std::shared_ptr<RecordFile> file,
                                           std::function<void(const std::string&)> failed) {
  return [file = std::move(file), failed = std::move(failed),
          frame = std::vector<std::uint8_t>()](std::span<const std::uint8_t> content) mutable {
    if (file->failure()) return;
    frame.clear();
    diag::appendFrame(frame, content);
    if (!file->append(frame)) MainQueue::shared().post([failed, reason = *file->failure()] { failed(reason); });
  };
}

EventSource makePortSource(const SourceOptions& options, std::unique_ptr<RecordFile> file, const Clock& clock,
                           SourceHandlers handlers) {
  diag::Port port(*options.port);
  if (!port.isOpen()) return {nullptr, nullptr, port.failure()};
  auto service = std::make_shared<diag::PortService>(std::move(port), options.sim, clock);
  service->setRemarkHandler(std::move(handlers.remark));
  service->setEndHandler([ended = std::move(handlers.ended)](const std::string& failure) { ended(failure); });
  if (file != nullptr) service->setFrameHandler(keepFrames(std::move(file), std::move(handlers.badLine)));
  diag::PortService& watched = *service;
  return {std::move(service), [&watched, port = *options.port] { return stateOfPort(port, watched.state()); },
          std::nullopt, [&clock] { return secondsOf(clock); }};
}

EventSource makeSimulatedSource(const SourceOptions& options, const Clock& clock) {
  const auto sinceEpoch = std::chrono::system_clock::now().time_since_epoch();
  const auto now = std::chrono::duration_cast<std::chrono::milliseconds>(sinceEpoch).count();
  return {std::make_shared<handset::HandsetService>(options.seed, static_cast<std::uint64_t>(now), clock),
          [] { return ShownState{"simulated"}; }, std::nullopt, [&clock] { return secondsOf(clock); }};
}

EventSource makeReplaySource(const SourceOptions& options, const Clock& clock, SourceHandlers handlers) {
  auto opened = std::make_unique<EventsInput>(*options.replay, options.sim);
  const EventsInput& input = *opened;
  // What a pipe holds is waited for where it is played.
  if (!input.isLive()) {
    if (const auto failure = opened->open()) return {nullptr, nullptr, failure};
    opened->measure();
  }
  auto service = std::make_shared<corvik::RecordedService>(std::move(opened), clock, options.playback);
  service->setBadLineHandler(std::move(handlers.badLine));
  corvik::RecordedService& recorded = *service;
  service->setEndHandler([&recorded, &input, path = *options.replay, tell = std::move(handlers.remark),
                          ended = std::move(handlers.ended)](const std::optional<std::string>& failure) {
    if (const auto state = recorded.state(); state.events == 0 && state.badLines > 0) tell(remarkOnNoRecording(path));
    for (const std::string& remark : input.remarks())
      tell(remark);
    ended(failure);
  });
  service->setSeekHandlers(std::move(handlers.seekBegun), std::move(handlers.seekEnded));
  return {std::move(service), [&recorded, &input] { return stateOfReplay(recorded.state(), input.isLive()); },
          std::nullopt, [&recorded] { return recorded.state().position; }, &recorded.player()};
}

}  // namespace

ShownState stateOfReplay(const corvik::PlaybackState& state, bool isLive) {
  using Phase = corvik::PlaybackState::Phase;
  const std::string bad = state.badLines > 0 ? ", " + counted(state.badLines, "bad line", "bad lines") : "";
  switch (state.phase) {
    case Phase::notStarted:
    case Phase::waitingForInput:
      return {"waiting" + bad};
    case Phase::ended:
      return {"ended" + bad, false, 0};
    case Phase::playing:
      break;
  }
  // A pipe is as good as live.
  if (isLive) return {"live" + bad};
  const std::string_view sign = state.isSeeking ? "▶▶ " : state.isHeld ? "▮▮ " : "▶ ";
  std::string text = std::string(sign) + speedText(state.speed) + "  " + playingTime(state.position);
  if (state.duration) text += " of " + playingTime(*state.duration);
  if (state.shortenedPause) text += ", shortening a pause of " + playingTime(*state.shortenedPause);
  text += bad;
  const bool isMoving = !state.isHeld || state.isSeeking;
  return {text, isMoving, isMoving && !state.isSeeking ? state.speed.value_or(0) : 0};
}

EventSource makeEventSource(const SourceOptions& options, const Clock& clock, SourceHandlers handlers,
                            Redaction* redaction) {
  std::string reason;
  std::unique_ptr<RecordFile> file;
  if (options.record) {
    file = RecordFile::create(*options.record, reason);
    if (file == nullptr) return {nullptr, nullptr, reason};
  }
  // A capture has identities: where they are to be left out, a recording is kept instead.
  std::unique_ptr<RecordFile> capture;
  if (options.port && redaction == nullptr) capture = std::move(file);
  const auto failed = handlers.badLine;
  EventSource source = options.port     ? makePortSource(options, std::move(capture), clock, std::move(handlers))
                       : options.replay ? makeReplaySource(options, clock, std::move(handlers))
                                        : makeSimulatedSource(options, clock);
  if (source.failure) return source;
  if (redaction != nullptr) source.service = makeRedactedService(std::move(source.service), *redaction);
  if (file != nullptr)
    source.service = std::make_shared<RecordingService>(source.service, std::move(file), source.seconds, failed);
  return source;
}

}  // namespace vesk
