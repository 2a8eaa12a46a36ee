#pragma once

#include <span>
#include <vector>

#include "insight/report.h"
#include "insight/step.h"

namespace vesk::insight {

/// The bearers that are up.
class Bearers {
 public:
  /// By number, each once.
  [[nodiscard]] std::span<const Bearer> active() const { return bearers_; }

  /// `reported` are all bearers; the first of one number counts.
  void take(std::vector<Bearer> reported, Step& step);
  void forget() { bearers_.clear(); }

 private:
  std::vector<Bearer> bearers_;
};

}  // namespace vesk::insight
