#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "handset/behaviour/mode.h"
#include "handset/behaviour/timing.h"
#include "messages/lte/lte.h"

namespace vesk::handset {

/// The secondary carriers of an LTE connection: up to two, on other carriers of the same site, that come and go with
/// the traffic.
class CarrierAggregation {
 public:
  /// A connection on `primary` begins, or goes on there after a handover; no secondary carrier yet.
  void start(const LteCell& primary, const Surroundings& now);
  /// The connection is over.
  void end(const Surroundings& now);
  void step(const Surroundings& now);

 private:
  struct Secondary {
    const LteCell* cell;
    metrics::SccState state;
    std::int64_t activationMs;
  };

  void configureAnother(const Surroundings& now);
  void deconfigureLast(const Surroundings& now);
  void tellCarriers(const Surroundings& now) const;
  void tellStatus(const Surroundings& now);

  const LteCell* primary_ = nullptr;
  std::vector<Secondary> secondaries_;
  std::int64_t changeMs_ = 0;
  Periodic status_{2000};
};

}  // namespace vesk::handset
