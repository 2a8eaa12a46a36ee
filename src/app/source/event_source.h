#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "app/source/redaction.h"
#include "corvik/recorded_service.h"
#include "corvik/service.h"
#include "system/clock.h"

namespace vesk {

/// Which events the program is fed with.
struct SourceOptions {
  /// A recording or a capture; "-" is standard input.
  std::optional<std::string> replay;
  /// A modem's diagnostic port. Without one and without a recording a simulated handset is driven.
  std::optional<std::string> port;
  /// Which SIM of a port or a capture; absent for all.
  std::optional<std::uint32_t> sim;
  /// Where what comes is kept: of a port the capture, of anything else, and redacted, a recording. Absent for nowhere.
  std::optional<std::string> record;
  /// Which drive of the handset.
  std::uint64_t seed = 1;
  corvik::Playback playback;
};

/// What a status bar shows of a source.
struct ShownState {
  /// "live", "▶ ×1  3:12 of 9:40", "waiting", "ended, 2 bad lines".
  std::string text;
  /// Whether the text changes with the seconds.
  bool isMoving = false;
  /// How many seconds of the drive pass in one; 0 where they are not known to pass.
  double pace = 1;
};

/// How far a replay is, and what has gone wrong; `isLive` tells that it is of a pipe.
[[nodiscard]] ShownState stateOfReplay(const corvik::PlaybackState& state, bool isLive);

/// A service with what the program shows of it.
struct EventSource {
  std::shared_ptr<corvik::Service> service;
  std::function<ShownState()> state;
  /// Why the recording cannot be read at all, the port not be opened, or nothing be kept.
  std::optional<std::string> failure{};
  /// How far its own time has come, in seconds from some start; from any thread.
  std::function<double()> seconds{};
  /// What steers it; null for a source that is no replay.
  corvik::Player* player = nullptr;
};

/// What an event source tells, on the main queue.
struct SourceHandlers {
  /// A line that is no event, or that what comes can no longer be kept.
  std::function<void(const std::string& message)> badLine;
  /// Something that the user should know, and no fault.
  std::function<void(const std::string& remark)> remark;
  /// Everything has been delivered; `failure` tells why a recording could not be read to its end.
  std::function<void(const std::optional<std::string>& failure)> ended;
  /// A replay is on its way to another moment; `isFromStart` tells that all events come once more.
  std::function<void(bool isFromStart)> seekBegun;
  std::function<void(double sinceLastEvent)> seekEnded;
};

/// With `redaction`, all that comes is redacted before anybody sees or keeps it; null for what comes as it is. `clock`
/// and `redaction` must outlive the source.
[[nodiscard]] EventSource makeEventSource(const SourceOptions& options, const Clock& clock, SourceHandlers handlers,
                                          Redaction* redaction);

}  // namespace vesk
