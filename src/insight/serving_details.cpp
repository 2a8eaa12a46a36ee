#include "insight/serving_details.h"

#include "insight/rrc_states.h"

namespace vesk::insight {

OptionalNumber<double> ServingDetails::leastLevel() const {
  return broadcast_ ? std::optional(broadcast_->leastLevel) : std::nullopt;
}

void ServingDetails::take(const Report& report, const Mobility& mobility, std::int64_t now) {
  if (mobility.technology().value_or(Technology::lte) != Technology::lte) return forget();
  if (report.leastLevel) broadcast_ = {*report.leastLevel, now};
  if (transmissionMode_ && report.rrc && rrcClassOf(Technology::lte, report.rrc->state) == RrcClass::idle)
    transmissionMode_.reset();
  if (report.transmissionMode) transmissionMode_ = report.transmissionMode;
  if (report.samplePci) samplePci_ = report.samplePci;
  const auto& cell = mobility.cell();
  if (cell && (!cell_ || differ(cell->identity, *cell_))) {
    // What was broadcast this shortly before is the new cell's: a phone reads that first.
    constexpr std::int64_t kShortly = 500;
    if (broadcast_ && now - broadcast_->heardAt > kShortly) broadcast_.reset();
    bandwidth_.reset();
  }
  if (cell) cell_ = cell->identity;
  if (report.bandwidth) bandwidth_ = report.bandwidth;
}

}  // namespace vesk::insight
