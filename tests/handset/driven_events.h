#pragma once

#include <optional>
#include <vector>

#include "handset/handset.h"
#include "messages/registry/metric_classes.h"

namespace vesk::handset {

inline constexpr std::uint64_t kStartMs = 1'700'000'000'000;

/// What a handset tells in its first `seconds`.
inline std::vector<HandsetEvent> drivenEvents(std::uint64_t seed, int seconds) {
  Handset handset(seed, kStartMs);
  std::vector<HandsetEvent> events;
  for (HandsetEvent event = handset.next(); event.atMs <= std::int64_t{1000} * seconds; event = handset.next())
    events.push_back(std::move(event));
  return events;
}

/// The message of a metric, read back; absent for what has no class and for triggers.
inline std::optional<Dictionary> fieldsOf(const HandsetEvent& event) {
  const MetricClass* metricClass = findMetricClass(event.id);
  if (event.kind == HandsetEvent::Kind::trigger || metricClass == nullptr) return std::nullopt;
  return metricClass->decode(event.payload.bytes());
}

}  // namespace vesk::handset
