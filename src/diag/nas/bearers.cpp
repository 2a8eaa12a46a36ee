#include "diag/nas/bearers.h"

#include <utility>

namespace vesk::diag {

using namespace metrics;

void Bearers::reset() {
  *this = {};
  areAllKnown_ = true;
}

bool Bearers::accept(std::uint8_t identity) {
  if (!requested_[identity]) return false;
  const RequestedBearer bearer = *std::exchange(requested_[identity], std::nullopt);
  active_[identity] = bearer.context;
  if (bearer.linkedTo && active_[*bearer.linkedTo] == nullptr) {
    auto linked = makeMessage<BearerContext>();
    linked->setNsapi(*bearer.linkedTo);
    active_[*bearer.linkedTo] = std::move(linked);
  }
  return true;
}

bool Bearers::deactivate(std::uint8_t identity) {
  dropRequest(identity);
  return std::exchange(active_[identity], nullptr) != nullptr;
}

KCellularActivatedBearerContexts Bearers::report() const {
  KCellularActivatedBearerContexts report;
  for (const auto& bearer : active_) {
    if (bearer != nullptr) report.addBearerContexts(bearer);
  }
  if (areAllKnown_) report.setBearerContextCount(static_cast<std::uint32_t>(report.bearerContextsCount()));
  return report;
}

}  // namespace vesk::diag
