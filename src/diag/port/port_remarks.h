#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "diag/packet_counts.h"

namespace vesk::diag {

/// What a user should know of what has come from a port so far. Each is said once, however long it holds.
class PortRemarks {
 public:
  /// What is to be said now, one line each; `counts` is of one port, and only grows.
  [[nodiscard]] std::vector<std::string> take(const PacketCounts& counts);

 private:
  bool isDamageSaid_ = false;
  bool areSimsSaid_ = false;
  bool areMoreSimsSaid_ = false;
  bool areOnlyOtherSimsSaid_ = false;
  bool isClockSaid_ = false;
  /// Where the frames begin among which damaged ones are counted: trouble that comes late is noticed too.
  std::uint64_t damagedBefore_ = 0;
  std::uint64_t framesBefore_ = 0;
};

}  // namespace vesk::diag
