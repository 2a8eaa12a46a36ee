#include "insight/carriers.h"

#include <algorithm>

namespace vesk::insight {

namespace {

template <class Part>
bool changes(const OptionalNumber<Part>& reported, const OptionalNumber<Part>& known) {
  return reported && reported != known;
}

template <class Part>
void update(OptionalNumber<Part>& known, const OptionalNumber<Part>& reported) {
  if (reported) known = reported;
}

EventKind entryTo(CarrierState state) {
  return state == CarrierState::activated ? EventKind::caActivated : EventKind::caConfigured;
}

void tell(EventKind kind, const Carrier& carrier, Step& step) {
  step.add(kind, CarrierChange{carrier.index, carrier.channel, carrier.code, carrier.bandwidth});
}

}  // namespace

bool Carriers::isConfigured(const OptionalNumber<std::int64_t>& index) const {
  return std::any_of(carriers_.begin(), carriers_.end(), [&](const Carrier& each) { return each.index == index; });
}

bool Carriers::isAnyActivated() const {
  return std::any_of(carriers_.begin(), carriers_.end(),
                     [](const Carrier& each) { return each.state == CarrierState::activated; });
}

void Carriers::take(std::span<const CarrierReport> reports, Step& step) {
  for (const CarrierReport& report : reports)
    if (report.index && report.state) take(*report.index, *report.state, report, step);
}

void Carriers::take(std::int64_t index, CarrierState state, const CarrierReport& report, Step& step) {
  const auto place = std::lower_bound(carriers_.begin(), carriers_.end(), index,
                                      [](const Carrier& each, std::int64_t other) { return each.index < other; });
  const bool isNew = place == carriers_.end() || place->index != index;
  if (isNew) {
    if (state == CarrierState::released || carriers_.size() == kMostCarriers) return;
    const Carrier carrier{index, state, report.channel, report.code, report.bandwidth};
    tell(entryTo(state), *carriers_.insert(place, carrier), step);
    return;
  }
  const bool isOtherCell = changes(report.channel, place->channel) || changes(report.code, place->code);
  const CarrierState before = place->state;
  place->state = state;
  update(place->channel, report.channel);
  update(place->code, report.code);
  update(place->bandwidth, report.bandwidth);
  if (state == CarrierState::released) {
    tell(EventKind::caReleased, *place, step);
    carriers_.erase(place);
  } else if (isOtherCell || state > before) {
    tell(entryTo(state), *place, step);
  } else if (state < before) {
    tell(EventKind::caDeactivated, *place, step);
  }
}

void Carriers::end(Step& step) {
  for (const Carrier& carrier : carriers_)
    tell(EventKind::caReleased, carrier, step);
  carriers_.clear();
}

}  // namespace vesk::insight
