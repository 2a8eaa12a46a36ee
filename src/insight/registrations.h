#pragma once

#include <array>
#include <cstdint>
#include <optional>

#include "insight/cause_counts.h"
#include "insight/report.h"
#include "insight/step.h"
#include "values/optional_number.h"

namespace vesk::insight {

/// The registrations with the network, their rejects, and whether there is service.
class Registrations {
 public:
  /// The state's whole name; absent while unknown.
  [[nodiscard]] const std::optional<Text>& status(Registration registration) const { return of(registration).status; }
  /// Why the network refuses the registration; absent when it does not.
  [[nodiscard]] const std::optional<Text>& rejectCause(Registration registration) const {
    return of(registration).rejectCause;
  }
  /// Since when there is no service; absent while there is.
  [[nodiscard]] const OptionalNumber<std::int64_t>& noServiceSince() const { return noServiceSince_; }
  /// On the whole drive.
  [[nodiscard]] const CauseCounts& rejects(Registration registration) const {
    return rejects_[static_cast<std::size_t>(registration)];
  }

  void take(const RegistrationReport& report, Step& step);
  /// Judges the service, once all else of a step is known.
  void judgeService(const std::optional<Technology>& technology, Step& step);
  /// The states; what was counted stays.
  void forget();

 private:
  struct Known {
    std::optional<Text> status;
    std::optional<Text> rejectCause;
  };

  [[nodiscard]] const Known& of(Registration registration) const {
    return known_[static_cast<std::size_t>(registration)];
  }
  [[nodiscard]] bool hasNoService(const std::optional<Technology>& technology) const;

  std::array<Known, 3> known_;
  std::array<CauseCounts, 3> rejects_;
  OptionalNumber<std::int64_t> noServiceSince_;
};

}  // namespace vesk::insight
