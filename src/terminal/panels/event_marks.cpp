#include "terminal/panels/event_marks.h"

#include <algorithm>
#include <array>
#include <iterator>
#include <optional>
#include <variant>

namespace vesk {

using insight::EventKind;

namespace {

const EventMark kMarks[] = {
    {"D", "dropped", Role::Alarm, {EventKind::drop}},
    {"F", "failed", Role::Alarm, {EventKind::connectionFailed}},
    {"R", "re-established", Role::Alarm, {EventKind::reestablished}},
    {"N", "no service", Role::Alarm, {EventKind::noService}},
    {"X", "rejected", Role::Alarm, {EventKind::reject}},
    {"A", "alerts", Role::Alarm, {EventKind::alert}},
    {"P", "ping-pongs", Role::Fair, {EventKind::pingPong}},
    {"T", "technology changes", Role::Key, {EventKind::technology}},
    {"C", "cell changes", Role::Plain, {EventKind::cell, EventKind::handover, EventKind::reselection}},
    {"┆", "gaps", Role::Faint, {EventKind::gap}},
};

bool isMarkOf(const EventMark& mark, EventKind kind) {
  return std::find(mark.kinds.begin(), mark.kinds.end(), kind) != mark.kinds.end();
}

auto firstSince(const insight::Present& drive, std::int64_t start) {
  const auto& happenings = drive.happenings();
  return std::lower_bound(
      happenings.begin(), happenings.end(), start,
      [](const insight::TimelineEvent& each, std::int64_t position) { return each.moment.position < position; });
}

}  // namespace

std::span<const EventMark> eventMarks() {
  return kMarks;
}

const EventMark* markOf(const insight::TimelineEvent& event) {
  const auto* technology = std::get_if<insight::TechnologyChange>(&event.fields);
  const auto* cell = std::get_if<insight::CellChange>(&event.fields);
  if ((technology != nullptr && !technology->from) || (cell != nullptr && !cell->from)) return nullptr;
  const auto* found = std::find_if(std::begin(kMarks), std::end(kMarks),
                                   [&](const EventMark& mark) { return isMarkOf(mark, event.kind); });
  return found == std::end(kMarks) ? nullptr : found;
}

Role roleOf(const insight::TimelineEvent& event) {
  const EventMark* mark = markOf(event);
  return mark == nullptr ? Role::Value : mark->role;
}

bool isNotable(EventKind kind) {
  constexpr std::array kOrdinary{EventKind::rrc, EventKind::cdrxSetUp, EventKind::cdrxReleased, EventKind::bearerUp,
                                 EventKind::bearerDown};
  return std::find(kOrdinary.begin(), kOrdinary.end(), kind) == kOrdinary.end();
}

std::vector<const EventMark*> marksOf(const insight::Present& drive, const TrendSpan& span, int slotsPerPlace) {
  std::vector<const EventMark*> marks(static_cast<std::size_t>(span.slots / slotsPerPlace), nullptr);
  for (auto each = firstSince(drive, span.start); each != drive.happenings().end(); ++each) {
    const auto slot = span.slotOf(each->moment.position);
    const EventMark* mark = markOf(*each);
    if (!slot || mark == nullptr) continue;
    const EventMark*& place = marks[static_cast<std::size_t>(*slot / slotsPerPlace)];
    if (place == nullptr || mark < place) place = mark;
  }
  return marks;
}

std::vector<insight::Moment> breaksOf(const insight::Present& drive) {
  std::vector<insight::Moment> breaks;
  for (const auto& each : drive.happenings())
    if (each.kind == EventKind::gap || each.kind == EventKind::technology) breaks.push_back(each.moment);
  return breaks;
}

std::size_t countSince(const insight::Present& drive, const EventMark& mark, std::int64_t start) {
  return static_cast<std::size_t>(
      std::count_if(firstSince(drive, start), drive.happenings().end(),
                    [&](const insight::TimelineEvent& each) { return markOf(each) == &mark; }));
}

}  // namespace vesk
