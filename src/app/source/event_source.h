#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "corvik/recorded_service.h"
#include "corvik/service.h"
#include "system/clock.h"

namespace vesk {

/// Which events the program is fed with.
struct SourceOptions {
  /// A recording; "-" is standard input. Without one a simulated handset is driven.
  std::optional<std::string> replay;
  /// Which drive of the handset.
  std::uint64_t seed = 1;
  corvik::Playback playback;
};

/// What a status bar shows of a source.
struct ShownState {
  /// "live", "replaying 3:12 of 9:40", "waiting", "ended".
  std::string text;
  /// Whether the text changes with the seconds.
  bool isMoving = false;
};

/// A service with what the program shows of it.
struct EventSource {
  std::shared_ptr<corvik::Service> service;
  std::function<ShownState()> state;
  /// Why the recording cannot be read at all.
  std::optional<std::string> failure{};
};

/// What an event source tells; both on the main queue.
struct SourceHandlers {
  /// A line that is no event.
  std::function<void(const std::string& message)> badLine;
  /// Everything has been delivered; `failure` tells why a recording could not be read to its end.
  std::function<void(const std::optional<std::string>& failure)> ended;
};

/// `clock` must outlive the source.
[[nodiscard]] EventSource makeEventSource(const SourceOptions& options, const Clock& clock, SourceHandlers handlers);

}  // namespace vesk
