#pragma once

#include <utility>
#include <vector>

#include "insight/moment.h"
#include "insight/timeline_event.h"

namespace vesk::insight {

/// One metric event's step of the timeline: its moment, and what happened at it, in order.
class Step {
 public:
  Step(Moment moment, std::vector<TimelineEvent>& events) : moment_(moment), events_(events) {}

  [[nodiscard]] const Moment& moment() const { return moment_; }
  [[nodiscard]] std::int64_t now() const { return moment_.time; }
  void add(EventKind kind, EventFields fields) { events_.push_back({moment_, kind, std::move(fields)}); }

 private:
  Moment moment_;
  std::vector<TimelineEvent>& events_;
};

}  // namespace vesk::insight
