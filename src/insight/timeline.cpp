#include "insight/timeline.h"

namespace vesk::insight {

void Timeline::take(const Report& report, Step& step) {
  if (const auto left = mobility_.takeTechnology(report, step)) leave(*left, step);
  kpis_.take(report.kpis, step.now());
  mobility_.take(report, connections_, kpis_, step);
  if (report.rrc) {
    const bool isIdle = connections_.take(*report.rrc, mobility_.cell(), kpis_, step);
    if (isIdle && report.rrc->technology == Technology::lte) endConnectedMode(step);
  }
  if (report.registration) registrations_.take(*report.registration, step);
  carriers_.take(report.carriers, step);
  if (report.bearers) bearers_.take(*report.bearers, step);
  if (report.cdrx) connectedDrx_.take(*report.cdrx, step);
  if (report.simFiles) step.add(EventKind::sim, SimRead{*report.simFiles});
  registrations_.judgeService(mobility_.technology(), step);
}

void Timeline::leave(Technology technology, Step& step) {
  kpis_.forget(technology);
  connections_.forget(technology);
  if (technology == Technology::lte) endConnectedMode(step);
}

void Timeline::endConnectedMode(Step& step) {
  carriers_.end(step);
  connectedDrx_.end(step);
}

void Timeline::forget() {
  kpis_.forget();
  mobility_.forget();
  connections_.forget();
  registrations_.forget();
  carriers_.forget();
  bearers_.forget();
  connectedDrx_.forget();
}

}  // namespace vesk::insight
