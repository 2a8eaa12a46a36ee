#pragma once

#include <cstdint>

#include "handset/behaviour/gsm_mode.h"
#include "handset/behaviour/lte_mode.h"
#include "handset/behaviour/registration.h"
#include "handset/behaviour/umts_mode.h"
#include "handset/model/drive.h"
#include "handset/model/network.h"
#include "handset/model/radio.h"
#include "handset/reports/outbox.h"

namespace vesk::handset {

/// A handset in a car on a ring road through a town: on LTE where there is LTE, on UMTS and GSM in the cutting and
/// its tunnel that follow after the first few hundred metres. It lives in simulated time, and the same seed makes
/// the same drive. One thread at a time.
class Handset {
 public:
  /// Switched on at `startMs`, in milliseconds since 1970-01-01 UTC.
  Handset(std::uint64_t seed, std::uint64_t startMs);
  Handset(const Handset&) = delete;
  Handset& operator=(const Handset&) = delete;

  /// The next event, in the order of time. There is always another one.
  [[nodiscard]] HandsetEvent next();
  /// The answer to a query of the SIM files, at the time of the last event.
  [[nodiscard]] HandsetEvent simFiles();

 private:
  void step();
  [[nodiscard]] Mode& mode();

  Random random_;
  Network network_;
  Drive drive_;
  Radio radio_;
  Registration registration_;
  Outbox outbox_;
  LteMode lte_;
  UmtsMode umts_;
  GsmMode gsm_;
  Technology technology_ = Technology::lte;
  std::int64_t nowMs_ = 0;
};

}  // namespace vesk::handset
