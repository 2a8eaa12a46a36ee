#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

#include "diag/packet.h"
#include "messages/codec/proto_writer.h"
#include "messages/registry/metric_of_message.h"

namespace vesk::diag {

/// The events of one packet, encoded one behind the other in a buffer that is used again for the next packet.
class EventBatch {
 public:
  /// Forgets what is held; the events to come are stamped with this time.
  void begin(std::uint64_t milliseconds) {
    milliseconds_ = milliseconds;
    writer_.clear();
    events_.clear();
    ends_.clear();
  }

  template <class MetricMessage>
  void add(MetricMessage& message) {
    message.setTimestamp(milliseconds_);
    message.writeTo(writer_);
    events_.push_back({kMetricId<MetricMessage>, milliseconds_, {}});
    ends_.push_back(writer_.written().size());
  }

  /// In the order in which they were added; valid until the next begin().
  [[nodiscard]] std::span<const Event> events() {
    std::size_t start = 0;
    for (std::size_t index = 0; index < events_.size(); ++index) {
      events_[index].payload = writer_.written().subspan(start, ends_[index] - start);
      start = ends_[index];
    }
    return events_;
  }

 private:
  std::uint64_t milliseconds_ = 0;
  ProtoWriter writer_;
  std::vector<Event> events_;
  /// Where each event ends in what is written, which moves as it grows.
  std::vector<std::size_t> ends_;
};

}  // namespace vesk::diag
