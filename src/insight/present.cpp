#include "insight/present.h"

namespace vesk::insight {

void Present::keep(const std::vector<TimelineEvent>& events) {
  for (const TimelineEvent& event : events) {
    if (happenings_.size() == kMostHappenings) {
      happenings_.pop_front();
      ++happenedBefore_;
    }
    happenings_.push_back({event, clock_.counted()});
  }
}

}  // namespace vesk::insight
