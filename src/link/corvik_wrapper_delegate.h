#pragma once

#include <optional>

#include "values/value.h"

namespace vesk {

/// Receives the events of the baseband manager service, on the main queue.
class CorvikWrapperDelegate {
 public:
  virtual ~CorvikWrapperDelegate() = default;

  virtual void metricsDidUpdate(const std::optional<Dictionary>& event) = 0;
  virtual void eventsDidUpdate(const std::optional<Dictionary>& event) = 0;
};

}  // namespace vesk
