#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>

#include "intake/date_format.h"
#include "intake/stores.h"
#include "link/corvik_wrapper.h"
#include "messages/registry/metric_identifiers.h"
#include "values/optional_number.h"
#include "values/value.h"

namespace vesk {

struct HandledMetric;

/// What became of a metric event.
enum class EventFate {
  stored,
  /// Its metric is handled, its payload is no encoding of one.
  undecodable,
  /// Its metric is not handled.
  ignored,
};

/// A metric event, told once the intake is done with it.
struct TakenEvent {
  EventFate fate;
  /// Absent when the event had none.
  OptionalNumber<std::int64_t> metricId{};
  /// What the record had under "timestamp" before that became a date: milliseconds since 1970-01-01 00:00:00 UTC.
  /// Absent unless stored, and where the record has none that fits.
  OptionalNumber<std::int64_t> timestamp{};
  /// The latest record of its kind; null unless stored.
  const Record* record = nullptr;
};

/// Takes in every metric event: decodes it, keeps it as the latest record of its kind, and fills the technology
/// stores. The one object of the process is shared(); everything happens on the main queue.
class MetricValidator : public CorvikWrapperDelegate {
 public:
  /// The one of the process. Made on the first call; it then listens to the shared wrapper and is its delegate.
  static const std::shared_ptr<MetricValidator>& shared();
  /// Another one, which listens to `wrapper` (null for none) and becomes its delegate: for tests.
  static std::shared_ptr<MetricValidator> listeningTo(std::shared_ptr<CorvikWrapper> wrapper);

  void metricsDidUpdate(const std::optional<Dictionary>& event) override;
  void eventsDidUpdate(const std::optional<Dictionary>& event) override;

  /// `observer` is told of every metric that was stored; for whoever wants to know when, which no store tells.
  void setArrivalObserver(std::function<void(std::int64_t metricId)> observer) {
    arrivalObserver_ = std::move(observer);
  }

  /// `observer` is told of every metric event, stored or not; the stores are then as the event left them.
  void setEventObserver(std::function<void(const TakenEvent&)> observer) { eventObserver_ = std::move(observer); }

  /// Decodes and stores the event. False, with nothing stored, for a metric that is not handled and for a payload that
  /// cannot be decoded.
  bool validateMetric(const Dictionary& event);

  [[nodiscard]] const std::shared_ptr<CorvikWrapper>& sharedCorvikInstance() const { return mySharedCorvikInstance; }

  /// Forgets all that came, so that the same events, or others, can be followed from their start.
  void startAnew();

  /// The metric identifier of the latest event; absent when it had none.
  std::optional<std::int64_t> metricID;

  /// What the events so far have left behind; whoever shows it reads it here.
  Stores stores;

 private:
  MetricValidator() = default;

  TakenEvent take(const Dictionary& event);
  /// Keeps the record as the latest of its metric, and takes the metric's steps.
  const Record& store(const HandledMetric& metric, Record record);

  std::shared_ptr<CorvikWrapper> mySharedCorvikInstance;
  DateFormat dates_;
  std::function<void(std::int64_t)> arrivalObserver_;
  std::function<void(const TakenEvent&)> eventObserver_;
};

}  // namespace vesk
