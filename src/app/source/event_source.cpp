#include "app/source/event_source.h"

#include <chrono>
#include <cmath>
#include <cstdio>

#include "handset/handset_service.h"
#include "recording/recording_reader.h"

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

ShownState shown(const corvik::PlaybackState& state) {
  using Phase = corvik::PlaybackState::Phase;
  switch (state.phase) {
    case Phase::notStarted:
    case Phase::waitingForInput:
      return {"waiting"};
    case Phase::ended:
      return {"ended"};
    case Phase::playing:
      break;
  }
  // A pipe has no length, and is as good as live.
  if (!state.duration) return {"live"};
  return {"replaying " + playingTime(state.position) + " of " + playingTime(*state.duration), true};
}

}  // namespace

EventSource makeEventSource(const SourceOptions& options, const Clock& clock, SourceHandlers handlers) {
  if (!options.replay) {
    const auto sinceEpoch = std::chrono::system_clock::now().time_since_epoch();
    const auto now = std::chrono::duration_cast<std::chrono::milliseconds>(sinceEpoch).count();
    return {std::make_shared<handset::HandsetService>(options.seed, static_cast<std::uint64_t>(now), clock),
            [] { return ShownState{"simulated"}; }};
  }
  auto recording = std::make_unique<RecordingReader>(*options.replay);
  const std::optional<std::string> failure = recording->failure();
  auto service = std::make_shared<corvik::RecordedService>(std::move(recording), clock, options.playback);
  service->setBadLineHandler(std::move(handlers.badLine));
  service->setEndHandler(std::move(handlers.ended));
  corvik::RecordedService& recorded = *service;
  return {std::move(service), [&recorded] { return shown(recorded.state()); }, failure};
}

}  // namespace vesk
