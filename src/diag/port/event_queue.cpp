#include "diag/port/event_queue.h"

#include <algorithm>
#include <iterator>
#include <utility>

#include "corvik/service.h"
#include "messages/registry/metric_identifiers.h"

namespace vesk::diag {

namespace {

/// Those of which the next one says the same anew.
constexpr std::int64_t kMeasurements[] = {
    K_LTE_RSRP_RSRQ_SINR, K_LTE_TX_POWER,        K_LTE_CA_STATUS,  K_LTE_INTERRAT_MEAS,
    K_LTE_INTRARAT_MEAS,  K_UMTS_SCELL_MEAS,     K_UMTS_TX_POWER,  K_UMTS_NCELL_MEAS,
    K_GSM_CS_RF_MEAS,     K_GSM_IDLE_SCELL_MEAS, K_GSM_NCELL_MEAS,
};

bool isMeasurement(std::int64_t metricId) {
  return std::find(std::begin(kMeasurements), std::end(kMeasurements), metricId) != std::end(kMeasurements);
}

}  // namespace

void EventQueue::add(const Event& event, const std::stop_token& stop) {
  std::unique_lock lock(mutex_);
  if (events_.size() >= kMostWaiting && isMeasurement(event.metricId)) {
    ++dropped_;
    return;
  }
  if (!changed_.wait(lock, stop, [this] { return events_.size() < kMostOfAll; })) return;
  events_.push_back(::corvik::makeMetricEvent(event.metricId, event.payload));
  changed_.notify_all();
}

std::optional<InterProcessDictionary> EventQueue::take(const std::stop_token& stop) {
  std::unique_lock lock(mutex_);
  if (!changed_.wait(lock, stop, [this] { return !events_.empty(); })) return std::nullopt;
  InterProcessDictionary event = std::move(events_.front());
  events_.pop_front();
  if (events_.size() + 1 == kMostOfAll) changed_.notify_all();
  return event;
}

std::uint64_t EventQueue::dropped() const {
  const std::lock_guard lock(mutex_);
  return dropped_;
}

}  // namespace vesk::diag
