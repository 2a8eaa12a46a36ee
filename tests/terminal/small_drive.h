#pragma once

#include <vector>

#include "insight/drive.h"

namespace vesk::insight {

/// Half a minute on LTE: a handover to a better cell, and a connection found again.
inline std::vector<DriveEvent> smallDrive() {
  using S = LteRrcState;
  using C = LteRrcCause;
  return {
      lteCell(0, 5815, 316, 48898065, 19980),
      lteRrc(100, S::KLTE_RRC_STATE_CONNECTED),
      lteLevel(1000, -112, -15),
      lteNeighbors(1500, {{5815, 338, -104}, {2000, 62, -118}, {{}, 7, -120}}),
      lteSelection(9900, -61),
      lteCell(10'000, 5815, 338, 48906257, 19980),
      lteLevel(11'000, -96, -9),
      emm(12'000, RegStatus::KREG_STATUS_NORMAL_SERVICE),
      lteRrc(20'000, S::KLTE_RRC_STATE_ATMPT_CONNECTION, C::KLTE_RRC_CAUSE_REEST_OTHER_FAIL),
      lteRrc(20'200, S::KLTE_RRC_STATE_CONNECTED, C::KLTE_RRC_CAUSE_REEST_OTHER_FAIL),
      lteLevel(25'000, -88, -9, 338),
  };
}

}  // namespace vesk::insight
