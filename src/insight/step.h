#pragma once

#include <cstddef>
#include <utility>

#include "insight/moment.h"
#include "insight/timeline_event.h"

namespace vesk::insight {

/// One metric event's step of the timeline: its moment, and what happened at it, in order.
class Step {
 public:
  /// Adds what happens to `happened`, which belongs to nobody else while the step lasts. `moment` outlives the step.
  Step(const Moment& moment, Happenings& happened) : moment_(moment), happened_(happened) {}

  [[nodiscard]] std::int64_t now() const { return moment_.time; }
  /// `fields` are those of the kind, one of EventFields.
  template <class Fields>
  void add(EventKind kind, Fields&& fields) {
    happened_.emplace_back(moment_, kind, std::forward<Fields>(fields));
    ++size_;
  }

  [[nodiscard]] std::size_t size() const { return size_; }
  [[nodiscard]] bool empty() const { return size_ == 0; }
  [[nodiscard]] const TimelineEvent& operator[](std::size_t index) const {
    return happened_[happened_.size() - size_ + index];
  }
  [[nodiscard]] auto begin() const { return happened_.cend() - static_cast<std::ptrdiff_t>(size_); }
  [[nodiscard]] auto end() const { return happened_.cend(); }

 private:
  const Moment& moment_;
  Happenings& happened_;
  std::size_t size_ = 0;
};

}  // namespace vesk::insight
