#include "screens/shown_stores.h"

#include <optional>

#include "intake/metric_validator.h"

namespace vesk {

namespace {

std::optional<Stores>& heldStores() {
  static std::optional<Stores> held;
  return held;
}

}  // namespace

const Stores& shownStores() {
  return heldStores() ? *heldStores() : MetricValidator::shared()->stores;
}

void holdShownStores() {
  heldStores() = MetricValidator::shared()->stores;
}

void releaseShownStores() {
  heldStores().reset();
}

}  // namespace vesk
