#pragma once

#include <cstdint>
#include <optional>

#include "handset/behaviour/registration.h"
#include "handset/model/radio.h"
#include "handset/reports/outbox.h"

namespace vesk::handset {

/// What a mode works with in one step.
struct StepContext {
  std::int64_t nowMs;
  const Radio& radio;
  Outbox& outbox;
  Registration& registration;
  Random& random;
};

/// Where a handset goes when it leaves a technology.
struct Departure {
  Technology to;
  /// With its connection.
  bool isHandover = false;
};

/// How the handset behaves on one technology, and what it tells of it.
class Mode {
 public:
  virtual ~Mode() = default;

  /// Finds a cell and camps on it; or, in a handover, is connected at once. Some cell of the technology is heard.
  virtual void enter(const StepContext& now, bool isHandover) = 0;
  /// One step in time; the technology to go to, or none to stay.
  [[nodiscard]] virtual std::optional<Departure> step(const StepContext& now) = 0;
};

/// Whether a technology's best cell is good enough to stay on.
[[nodiscard]] inline bool isLteUsable(const Radio& radio) {
  return !radio.lte().empty() && radio.lte().front().rsrp > -108;
}
[[nodiscard]] inline bool isUmtsUsable(const Radio& radio) {
  return !radio.umts().empty() && radio.umts().front().rscp > -100;
}
[[nodiscard]] inline bool isGsmUsable(const Radio& radio) {
  return !radio.gsm().empty() && radio.gsm().front().rxLev > -104;
}

}  // namespace vesk::handset
