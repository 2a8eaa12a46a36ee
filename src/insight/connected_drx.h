#pragma once

#include <optional>

#include "insight/report.h"
#include "insight/step.h"

namespace vesk::insight {

/// Discontinuous reception in connected mode, as the cell sets it up.
class ConnectedDrx {
 public:
  /// Absent while it is off or unknown.
  [[nodiscard]] const std::optional<CdrxParameters>& parameters() const { return parameters_; }

  void take(const CdrxReport& report, Step& step) {
    if (!report.isSetUp) return end(step);
    if (parameters_ == report.parameters) return;
    parameters_ = report.parameters;
    step.add(EventKind::cdrxSetUp, CdrxChange{parameters_});
  }
  void end(Step& step) {
    if (!parameters_) return;
    parameters_.reset();
    step.add(EventKind::cdrxReleased, CdrxChange{});
  }
  void forget() { parameters_.reset(); }

 private:
  std::optional<CdrxParameters> parameters_;
};

}  // namespace vesk::insight
