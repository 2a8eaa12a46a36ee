#pragma once

#include <cstddef>
#include <cstdint>
#include <initializer_list>
#include <span>
#include <string_view>
#include <vector>

#include "insight/present.h"
#include "terminal/panels/canvas.h"
#include "terminal/panels/trend_span.h"

namespace vesk {

/// The sign of some kinds of events on a graph.
struct EventMark {
  std::string_view sign;
  std::string_view meaning;
  Role role;
  std::initializer_list<insight::EventKind> kinds;
};

/// The one that matters most first.
[[nodiscard]] std::span<const EventMark> eventMarks();

/// Null for an event that bears none, as the first technology and the first cell of a stretch: they are no changes.
[[nodiscard]] const EventMark* markOf(const insight::TimelineEvent& event);

/// How the event's kind is written in lists.
[[nodiscard]] Role roleOf(const insight::TimelineEvent& event);
/// Whether it is told where there is room for the most important alone. Connections, discontinuous reception and
/// bearers come and go all the time.
[[nodiscard]] bool isNotable(insight::EventKind kind);

/// Which events happened when: of those in one place the mark that matters most, null where there is none. A place is
/// `slotsPerPlace` slots of the span.
[[nodiscard]] std::vector<const EventMark*> marksOf(const insight::Present& drive, const TrendSpan& span,
                                                    int slotsPerPlace);

/// Where values were forgotten, in order.
[[nodiscard]] std::vector<insight::Moment> breaksOf(const insight::Present& drive);

/// How many events with that mark happened from a position on.
[[nodiscard]] std::size_t countSince(const insight::Present& drive, const EventMark& mark, std::int64_t start);

}  // namespace vesk
