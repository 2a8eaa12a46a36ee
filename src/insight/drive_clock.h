#pragma once

#include <cstdint>
#include <optional>

#include "values/optional_number.h"

namespace vesk::insight {

/// A jump of the events' time that is no passing of time: from one session of a drive to the next, or a clock set back.
struct Gap {
  std::int64_t from;
  std::int64_t to;

  [[nodiscard]] std::int64_t jump() const { return to - from; }
};

/// The time of a drive, told by its events alone. Times are milliseconds since 1970-01-01 00:00:00 UTC. It stands still
/// at small steps back, and jumps at a gap, where a new stretch of the drive begins.
class DriveClock {
 public:
  struct Step {
    /// What passed before the event, and counts.
    std::int64_t passed = 0;
    std::optional<Gap> gap{};
  };

  /// Takes the timestamp of the next event. Absent while no event has had a time yet: such an event takes no part.
  std::optional<Step> take(OptionalNumber<std::int64_t> timestamp);

  /// Absent before the first event with a time.
  [[nodiscard]] OptionalNumber<std::int64_t> now() const { return now_; }
  [[nodiscard]] OptionalNumber<std::int64_t> first() const { return first_; }
  /// All that passed in the stretches.
  [[nodiscard]] std::int64_t counted() const { return counted_; }
  [[nodiscard]] std::uint64_t stretches() const { return stretches_; }

 private:
  OptionalNumber<std::int64_t> now_;
  OptionalNumber<std::int64_t> first_;
  std::int64_t counted_ = 0;
  std::uint64_t stretches_ = 0;
};

}  // namespace vesk::insight
