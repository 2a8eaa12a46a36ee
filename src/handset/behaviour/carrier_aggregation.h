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
  void start(const LteCell& primary, const StepContext& now);
  /// The connection is over.
  void end(const StepContext& now);
  void step(const StepContext& now);

 private:
  struct Secondary {
    const LteCell* cell;
    metrics::SccState state;
    std::int64_t activationMs;
  };

  void configureAnother(const StepContext& now);
  void deconfigureLast(const StepContext& now);
  void tellCarriers(const StepContext& now) const;
  void tellStatus(const StepContext& now);

  const LteCell* primary_ = nullptr;
  std::vector<Secondary> secondaries_;
  std::int64_t changeMs_ = 0;
  Periodic status_{2000};
};

}  // namespace vesk::handset
