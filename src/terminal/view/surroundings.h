#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>

#include "insight/present.h"
#include "system/clock.h"
#include "terminal/view/diagnostic_lines.h"
#include "toolkit/table_data_source.h"

namespace vesk {

/// What the source of the events is at: "simulated", "▶ ×1  3:12 of 9:40", "ended", "waiting".
struct SourceState {
  std::string text;
  /// When the text will be another one by the passing of time alone.
  std::optional<Clock::Instant> nextChange{};
  /// The drive's date, shown behind the text where there is room; empty for none.
  std::string date{};
};

/// A moment of the drive, in its own time, which a replay may let pass faster or slower.
struct DriveMoment {
  /// Since some start.
  std::chrono::milliseconds time{0};
  /// How many seconds of the drive pass in one; 0 where its time stands still.
  double pace = 0;
};

/// How often the metric behind a screen arrived.
struct Arrivals {
  /// In the drive's time; absent before the first.
  std::optional<std::chrono::milliseconds> last{};
  std::uint64_t count = 0;
  /// It came, but never with the list that the screen shows.
  bool isWithoutList = false;
};

/// What the terminal shows besides the screens, and whom it tells. Every member is optional; all are called
/// on the main queue.
struct Surroundings {
  /// Called before everything that is drawn: what grows old by itself is to be as of now.
  std::function<void()> growOlder{};
  std::function<SourceState()> sourceState{};
  /// Absent for an area and category that no metric feeds.
  std::function<std::optional<Arrivals>(std::string_view area, std::string_view category)> arrivals{};
  /// What time it is in the drive; without it no age is told.
  std::function<DriveMoment()> driveMoment{};
  /// The most telling value of a category, for its row in the menu; empty for none.
  std::function<std::string(std::string_view area, std::string_view category)> headline{};
  /// What a row of a category's screen means, asked for when the row is; empty for none. `name` is what the row has at
  /// its left.
  std::function<std::string(std::string_view area, std::string_view category, IndexPath at, std::string_view name)>
      reading{};
  /// The technology that the handset uses in place of that of a category; empty while it uses that.
  std::function<std::string(std::string_view area, std::string_view category)> technologyInstead{};

  /// Whether the source is a replay that goes back and forth.
  bool isSeekable = false;
  /// Holds all that shows at the present moment, and the replay with it; or lets it go on.
  std::function<void(bool isHeld)> setHeld{};
  /// One step faster for +1, slower for -1.
  std::function<void(int step)> changeSpeed{};
  /// Forward in the replay, or back.
  std::function<void(std::chrono::seconds distance)> jump{};

  /// What the drive comes to, for the screens over the tables; without it there are none. Must outlive the terminal.
  const insight::Present* drive = nullptr;
  /// Goes to the moment of an event; absent where the source cannot.
  std::function<void(const insight::TimelineEvent& event)> goToEvent{};
  /// Must outlive the terminal.
  DiagnosticLines* diagnostics = nullptr;
  /// While true, the user holds a list with the mouse: timers of the default mode wait.
  std::function<void(bool)> setTracking{};
  std::function<void()> quit{};
  /// Says a line to the user before the terminal is taken over.
  std::function<void(const std::string& line)> warn{};
  /// The program was stopped (true) and goes on (false).
  std::function<void(bool)> setInBackground{};
};

}  // namespace vesk
