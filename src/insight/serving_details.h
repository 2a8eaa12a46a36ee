#pragma once

#include <cstdint>
#include <optional>

#include "insight/mobility.h"
#include "insight/report.h"
#include "values/optional_number.h"

namespace vesk::insight {

/// What the serving LTE cell says of itself besides its identity; each absent while it is unknown.
class ServingDetails {
 public:
  /// Of the downlink, MHz.
  [[nodiscard]] const OptionalNumber<double>& bandwidth() const { return bandwidth_; }
  /// The level that a phone must receive to stay (QRxLevMin), dBm.
  [[nodiscard]] OptionalNumber<double> leastLevel() const;
  [[nodiscard]] const OptionalNumber<std::int64_t>& transmissionMode() const { return transmissionMode_; }
  /// Of the last measurement: during a change it may be another cell's.
  [[nodiscard]] const OptionalNumber<std::int64_t>& samplePci() const { return samplePci_; }

  /// `mobility` is as the report left it.
  void take(const Report& report, const Mobility& mobility, std::int64_t now);
  void forget() { *this = ServingDetails(); }

 private:
  struct Broadcast {
    double leastLevel;
    std::int64_t heardAt;
  };

  std::optional<CellIdentity> cell_;
  OptionalNumber<double> bandwidth_;
  std::optional<Broadcast> broadcast_;
  OptionalNumber<std::int64_t> transmissionMode_;
  OptionalNumber<std::int64_t> samplePci_;
};

}  // namespace vesk::insight
