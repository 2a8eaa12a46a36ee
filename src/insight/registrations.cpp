#include "insight/registrations.h"

#include <utility>

#include "insight/enumeration_names.h"

namespace vesk::insight {

namespace {

EventKind kindOf(Registration registration) {
  constexpr std::array kKinds{EventKind::emm, EventKind::mm, EventKind::gmm};
  return kKinds[static_cast<std::size_t>(registration)];
}

bool isWithoutService(const Text& status) {
  return status == "KREG_STATUS_NO_SERVICE"_text || status == "KREG_STATUS_POWER_OFF_NO_SERVICE"_text;
}

}  // namespace

void Registrations::take(const RegistrationReport& report, Step& step) {
  Known& known = known_[static_cast<std::size_t>(report.registration)];
  if (report.status && report.status != known.status) {
    step.add(kindOf(report.registration), RegistrationChange{known.status, *report.status, report.procedure});
    known.status = report.status;
  }
  const bool isReject = report.rejectCause && causeCode(report.rejectCause->view()) != 0;
  const auto before = std::exchange(known.rejectCause, isReject ? report.rejectCause : std::nullopt);
  if (!isReject || before == report.rejectCause) return;
  rejects_[static_cast<std::size_t>(report.registration)].add(report.rejectCause);
  step.add(EventKind::reject, Reject{report.registration, *report.rejectCause, report.procedure});
}

void Registrations::judgeService(const std::optional<Technology>& technology, Step& step) {
  const bool hasNone = hasNoService(technology);
  if (hasNone == noServiceSince_.has_value()) return;
  if (hasNone) {
    noServiceSince_ = step.now();
    step.add(EventKind::noService, ServiceChange{technology, std::nullopt});
  } else {
    step.add(EventKind::service, ServiceChange{technology, step.now() - *noServiceSince_});
    noServiceSince_.reset();
  }
}

bool Registrations::hasNoService(const std::optional<Technology>& technology) const {
  const auto isWithout = [this](Registration registration) {
    const auto& known = status(registration);
    return known && isWithoutService(*known);
  };
  if (technology.value_or(Technology::lte) == Technology::lte) return isWithout(Registration::emm);
  const auto mayBeWithout = [&](Registration registration) { return !status(registration) || isWithout(registration); };
  const bool isAnyKnown = status(Registration::mm) || status(Registration::gmm);
  return isAnyKnown && mayBeWithout(Registration::mm) && mayBeWithout(Registration::gmm);
}

void Registrations::forget() {
  for (Known& each : known_) {
    each.status.reset();
    each.rejectCause.reset();
  }
  noServiceSince_.reset();
}

}  // namespace vesk::insight
