#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>

#include "insight/present.h"
#include "system/clock.h"
#include "terminal/view/diagnostic_lines.h"

namespace vesk {

/// What the source of the events is at: "live", "replaying 3:12 of 9:40", "ended", "waiting".
struct SourceState {
  std::string text;
  /// When the text will be another one by the passing of time alone.
  std::optional<Clock::Instant> nextChange{};
};

/// How often the metric behind a screen arrived.
struct Arrivals {
  std::optional<Clock::Instant> last{};
  std::uint64_t count = 0;
};

/// What the terminal shows besides the screens, and whom it tells. Every member is optional; all are called
/// on the main queue.
struct Surroundings {
  std::function<SourceState()> sourceState;
  /// Absent for an area and category that no metric feeds.
  std::function<std::optional<Arrivals>(std::string_view area, std::string_view category)> arrivals;
  /// What the drive comes to, for the screens over the tables; without it there are none. Must outlive the terminal.
  const insight::Present* drive = nullptr;
  /// Goes to the moment of an event; absent where the source cannot.
  std::function<void(const insight::TimelineEvent& event)> goToEvent{};
  /// Must outlive the terminal.
  DiagnosticLines* diagnostics = nullptr;
  /// While true, the user holds a list with the mouse: timers of the default mode wait.
  std::function<void(bool)> setTracking;
  std::function<void()> quit;
  /// The program was stopped (true) and goes on (false).
  std::function<void(bool)> setInBackground;
};

}  // namespace vesk
