#pragma once

#include <atomic>
#include <cstdint>
#include <memory>
#include <optional>
#include <span>

#include "corvik/service.h"
#include "values/data.h"

namespace vesk {

/// Redacts events, and counts those that have to be left out because nobody knows what they hold. Usable from any
/// thread.
class Redaction {
 public:
  /// The payload without identities; absent when the event is to be left out.
  [[nodiscard]] std::optional<Data> redacted(std::int64_t metricId, std::span<const std::uint8_t> payload);
  /// Of an event that is no metric.
  void leaveOut() { ++leftOut_; }
  /// Tells the user how many were left out, if any were.
  void tellLeftOut() const;

 private:
  std::atomic<std::uint64_t> leftOut_ = 0;
};

/// A service that hands on what `service` raises, redacted. Events that are no metrics are left out. `redaction` must
/// outlive it.
[[nodiscard]] std::shared_ptr<corvik::Service> makeRedactedService(std::shared_ptr<corvik::Service> service,
                                                                   Redaction& redaction);

}  // namespace vesk
