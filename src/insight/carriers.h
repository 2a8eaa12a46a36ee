#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <vector>

#include "insight/report.h"
#include "insight/step.h"
#include "values/optional_number.h"

namespace vesk::insight {

/// A secondary component carrier that is configured or activated.
struct Carrier {
  std::int64_t index;
  CarrierState state;
  OptionalNumber<std::int64_t> channel{};
  OptionalNumber<std::int64_t> code{};
  /// MHz.
  OptionalNumber<double> bandwidth{};
};

/// The secondary component carriers of LTE.
class Carriers {
 public:
  /// Those that are not released, by index.
  [[nodiscard]] std::span<const Carrier> configured() const { return carriers_; }
  [[nodiscard]] bool isConfigured(const OptionalNumber<std::int64_t>& index) const;
  [[nodiscard]] bool isAnyActivated() const;

  void take(std::span<const CarrierReport> reports, Step& step);
  /// Releases them all.
  void end(Step& step);
  void forget() { carriers_.clear(); }

 private:
  /// More than a phone can have at once; what goes beyond is passed over.
  static constexpr std::size_t kMostCarriers = 64;

  void take(std::int64_t index, CarrierState state, const CarrierReport& report, Step& step);

  std::vector<Carrier> carriers_;
};

}  // namespace vesk::insight
