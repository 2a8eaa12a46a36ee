#pragma once

#include <cstdint>

namespace vesk::insight {

/// When something happened. Times are milliseconds.
struct Moment {
  /// The drive's time, since 1970-01-01 00:00:00 UTC.
  std::int64_t time = 0;
  /// Which of the drive's metric events told it, counted from 0.
  std::uint64_t event = 0;
  /// The drive's counted time, without its gaps.
  std::int64_t position = 0;
};

}  // namespace vesk::insight
