#include "insight/present.h"

namespace vesk::insight {

void Present::forgetOldHappenings() {
  for (std::size_t size = happenings_.size(); size > kMostHappenings; --size) {
    happenings_.pop_front();
    ++happenedBefore_;
  }
}

}  // namespace vesk::insight
