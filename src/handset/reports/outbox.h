#pragma once

#include <cstdint>
#include <deque>
#include <span>

#include "messages/codec/proto_writer.h"
#include "messages/registry/metric_of_message.h"
#include "values/data.h"

namespace vesk::handset {

/// Something that the handset tells.
struct HandsetEvent {
  enum class Kind { metric, trigger };

  /// Milliseconds since it was switched on.
  std::int64_t atMs;
  Kind kind;
  /// Of the metric or the trigger.
  std::int64_t id;
  /// The metric's message; empty for a trigger.
  Data payload;
};

/// Stamps and encodes what is to be told, and keeps it until it is taken.
class Outbox {
 public:
  /// `startMs` is when the handset is switched on, in milliseconds since 1970-01-01 UTC.
  explicit Outbox(std::uint64_t startMs) : startMs_(startMs) {}

  /// Milliseconds since the start; never goes back. What is told at one time follows millisecond by millisecond.
  void setTime(std::int64_t ms) {
    if (ms > ms_) ms_ = ms;
  }

  template <class MetricMessage>
  void tell(MetricMessage& message) {
    events_.push_back(encode(message, ms_));
    ++ms_;
  }
  /// An event of its own, not kept here, at the time of the one taken last.
  template <class MetricMessage>
  [[nodiscard]] HandsetEvent answer(MetricMessage& message) {
    return encode(message, takenMs_);
  }
  void tellRadioLinkFailure() {
    writer_.clear();
    writer_.writeUInt64(timestamp(ms_), 1);
    events_.push_back(makeMetric(K_LTE_RLF, ms_));
    ++ms_;
  }
  void raiseTrigger(std::int64_t id) {
    events_.push_back({ms_, HandsetEvent::Kind::trigger, id, {}});
    ++ms_;
  }

  [[nodiscard]] bool isEmpty() const { return events_.empty(); }
  /// The oldest event; there must be one.
  HandsetEvent take() {
    HandsetEvent event = std::move(events_.front());
    events_.pop_front();
    takenMs_ = event.atMs;
    return event;
  }

 private:
  template <class MetricMessage>
  [[nodiscard]] HandsetEvent encode(MetricMessage& message, std::int64_t atMs) {
    message.setTimestamp(timestamp(atMs));
    writer_.clear();
    message.writeTo(writer_);
    return makeMetric(kMetricId<MetricMessage>, atMs);
  }
  [[nodiscard]] std::uint64_t timestamp(std::int64_t atMs) const { return startMs_ + static_cast<std::uint64_t>(atMs); }
  [[nodiscard]] HandsetEvent makeMetric(std::int64_t id, std::int64_t atMs) const {
    return {atMs, HandsetEvent::Kind::metric, id, Data::copy(writer_.written())};
  }

  std::uint64_t startMs_;
  std::int64_t ms_ = 0;
  std::int64_t takenMs_ = 0;
  ProtoWriter writer_;
  std::deque<HandsetEvent> events_;
};

}  // namespace vesk::handset
