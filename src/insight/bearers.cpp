#include "insight/bearers.h"

#include <algorithm>

namespace vesk::insight {

namespace {

bool isBefore(const Bearer& one, const Bearer& other) {
  return one.number < other.number;
}

/// Tells of each of `bearers` that is not among `others`.
void tellMissing(std::span<const Bearer> bearers, std::span<const Bearer> others, EventKind kind, Step& step) {
  for (const Bearer& bearer : bearers)
    if (!std::binary_search(others.begin(), others.end(), bearer, isBefore)) step.add(kind, BearerChange{bearer});
}

}  // namespace

void Bearers::take(std::vector<Bearer> reported, Step& step) {
  std::stable_sort(reported.begin(), reported.end(), isBefore);
  const auto areSame = [](const Bearer& one, const Bearer& other) { return one.number == other.number; };
  reported.erase(std::unique(reported.begin(), reported.end(), areSame), reported.end());
  tellMissing(bearers_, reported, EventKind::bearerDown, step);
  tellMissing(reported, bearers_, EventKind::bearerUp, step);
  bearers_ = std::move(reported);
}

}  // namespace vesk::insight
