#pragma once

#include <vector>

#include "insight/bearers.h"
#include "insight/carriers.h"
#include "insight/connected_drx.h"
#include "insight/connections.h"
#include "insight/kpis.h"
#include "insight/mobility.h"
#include "insight/registrations.h"
#include "insight/report.h"
#include "insight/step.h"

namespace vesk::insight {

/// What is known at the moment of the last event, and what happened at each: every rule looks only at the past.
class Timeline {
 public:
  void take(const Report& report, Step& step);
  /// Forgets all that is known, at a gap; what was counted on the whole drive stays.
  void forget();

  [[nodiscard]] const KnownKpis& kpis() const { return kpis_; }
  [[nodiscard]] const Mobility& mobility() const { return mobility_; }
  [[nodiscard]] const Connections& connections() const { return connections_; }
  [[nodiscard]] const Registrations& registrations() const { return registrations_; }
  [[nodiscard]] const Carriers& carriers() const { return carriers_; }
  [[nodiscard]] const Bearers& bearers() const { return bearers_; }
  [[nodiscard]] const ConnectedDrx& connectedDrx() const { return connectedDrx_; }

 private:
  void leave(Technology technology, Step& step);
  void endConnectedMode(Step& step);

  KnownKpis kpis_;
  Mobility mobility_;
  Connections connections_;
  Registrations registrations_;
  Carriers carriers_;
  Bearers bearers_;
  ConnectedDrx connectedDrx_;
};

}  // namespace vesk::insight
