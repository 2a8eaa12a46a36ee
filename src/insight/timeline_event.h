#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <deque>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <variant>

#include "insight/cell_identity.h"
#include "insight/drive_clock.h"
#include "insight/moment.h"
#include "insight/report.h"
#include "insight/technology.h"
#include "values/json_form.h"
#include "values/optional_number.h"
#include "values/recycled_memory.h"
#include "values/text.h"

/// What happened on a drive: the events of its timeline, as plain values. Times are milliseconds; names of enumeration
/// values are whole.
namespace vesk::insight {

/// In the order in which the events of one moment follow each other.
enum class EventKind : std::uint8_t {
  gap,
  technology,
  cell,
  handover,
  reselection,
  pingPong,
  area,
  rrc,
  reestablished,
  connectionFailed,
  drop,
  emm,
  mm,
  gmm,
  reject,
  caConfigured,
  caActivated,
  caDeactivated,
  caReleased,
  bearerUp,
  bearerDown,
  cdrxSetUp,
  cdrxReleased,
  sim,
  noService,
  service,
  alert,
};

inline constexpr std::size_t kEventKindCount = 27;

/// "handover", "connection-failed".
[[nodiscard]] std::string_view nameOf(EventKind kind);
[[nodiscard]] std::optional<EventKind> eventKindNamed(std::string_view name);

struct TechnologyChange {
  std::optional<Technology> from;
  Technology to;
};

/// How a cell came to serve where it was neither handover nor reselection.
enum class CellEntry : std::uint8_t { first, reestablishment, unknown };

struct CellChange {
  Technology technology;
  /// Of EventKind::cell only.
  std::optional<CellEntry> how;
  std::optional<CellIdentity> from;
  CellIdentity to;
  OptionalNumber<double> level;
  /// How long the cell left had served.
  OptionalNumber<std::int64_t> stay;
};

struct PingPong {
  Technology technology;
  CellIdentity cell;
  CellIdentity other;
  std::int64_t stay;
};

struct AreaChange {
  Area area;
  std::optional<AreaIdentity> from;
  AreaIdentity to;
};

struct RrcChange {
  Technology technology;
  std::optional<Text> from;
  Text to;
  std::optional<Text> cause;
  OptionalNumber<std::int64_t> duration;
};

struct Reestablishment {
  Technology technology;
  std::optional<Text> cause;
  OptionalNumber<std::int64_t> duration;
  std::optional<CellIdentity> from;
  std::optional<CellIdentity> to;
  /// Before it.
  OptionalNumber<double> level;
};

/// A connection that failed to come about, or was lost.
struct ConnectionLoss {
  Technology technology;
  std::optional<Text> cause;
  std::optional<CellIdentity> cell;
  OptionalNumber<double> level;
};

struct RegistrationChange {
  std::optional<Text> from;
  Text to;
  std::optional<Text> procedure;
};

struct Reject {
  Registration registration;
  Text cause;
  std::optional<Text> procedure;
};

struct ServiceChange {
  std::optional<Technology> technology;
  /// How long there was none; of EventKind::service only.
  OptionalNumber<std::int64_t> duration;
};

struct CarrierChange {
  std::int64_t index;
  OptionalNumber<std::int64_t> channel;
  OptionalNumber<std::int64_t> code;
  /// MHz.
  OptionalNumber<double> bandwidth;
};

struct BearerChange {
  Bearer bearer;
};

/// Absent parameters when it is released.
struct CdrxChange {
  std::optional<CdrxParameters> parameters;
};

struct SimRead {
  std::size_t files;
};

struct Alert {
  std::string rule;
  /// From when on the rule has held.
  std::int64_t since;
  /// Of the KPI; absent for a rule of events.
  OptionalNumber<double> value;
};

using EventFields =
    std::variant<Gap, TechnologyChange, CellChange, PingPong, AreaChange, RrcChange, Reestablishment, ConnectionLoss,
                 RegistrationChange, Reject, ServiceChange, CarrierChange, BearerChange, CdrxChange, SimRead, Alert>;

struct TimelineEvent {
  Moment moment;
  EventKind kind;
  EventFields fields;

  /// `told`: the fields, of the type that `what` has.
  template <class Fields>
  TimelineEvent(const Moment& when, EventKind what, Fields&& told)
      : moment(when), kind(what), fields(std::forward<Fields>(told)) {}
};

/// Events in the order in which they happened.
using Happenings = std::deque<TimelineEvent, RecyclingAllocator<TimelineEvent>>;

/// What a person reads beside the kind.
[[nodiscard]] std::string textOf(const TimelineEvent& event);

/// Writes {"timestamp":…,"event":…,"kind":…,"text":…} with the fields of its kind.
void writeJson(JsonWriter& json, const TimelineEvent& event);

/// The time of day, UTC: "21:52:41.565".
[[nodiscard]] std::string timeOfDay(std::int64_t time);
/// "21:52:41.565  handover  PCI 443 B2 850 -> …".
[[nodiscard]] std::string lineOf(const TimelineEvent& event);

}  // namespace vesk::insight
