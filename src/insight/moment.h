#pragma once

#include <cstdint>

namespace vesk::insight {

/// When something happened: the drive's time, in milliseconds since 1970-01-01 00:00:00 UTC, and which of the drive's
/// metric events told it, counted from 0.
struct Moment {
  std::int64_t time = 0;
  std::uint64_t event = 0;
};

}  // namespace vesk::insight
