#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <stop_token>
#include <string>

#include "corvik/constants.h"
#include "corvik/inter_process_dictionary.h"
#include "system/task.h"

namespace corvik {

/// The outcome of a command.
struct Result {
  /// 0 is success.
  std::int32_t code = 0;
  std::string message;
};

inline constexpr std::int32_t kStatusNoService = 1;
inline constexpr std::int32_t kStatusUnknownCommand = 2;
inline constexpr std::int32_t kStatusInvalidArgument = 3;
inline constexpr std::int32_t kStatusNotSupported = 4;

/// What a query asks for.
struct MetricQuery {
  std::int64_t triggerRef;
  std::int64_t triggerType;
  std::int64_t triggerId;
  std::int64_t profileId;
  std::int64_t metricId;
};

/// A metric event's message.
[[nodiscard]] vesk::InterProcessDictionary makeMetricEvent(std::int64_t metricId,
                                                           std::span<const std::uint8_t> payload);

/// The client's end of a service's events. Usable from any thread.
class EventStream {
 public:
  /// Hands an event on; never blocks. `event` is kEventMetric or kEventTrigger.
  virtual void raise(const vesk::Text& event, vesk::InterProcessDictionary message) = 0;
  /// The same for a source on a thread of its own, which waits until the event has been handled, and spares it a change
  /// of threads.
  virtual void deliver(const vesk::Text& event, vesk::InterProcessDictionary message) = 0;
  /// Runs `task` on the main queue, behind the delivery of all events raised before.
  virtual void afterDelivery(vesk::Task task) = 0;
  /// To be called by a source, on a thread of its own, before each metric: blocks until the client wants
  /// metrics, that is, has had a configuration accepted and switched events on, and is not behind with those
  /// it got. False when a stop was requested.
  [[nodiscard]] virtual bool waitUntilWanted(const std::stop_token& stop) = 0;

 protected:
  ~EventStream() = default;
};

/// A baseband manager service, as the client library sees it. All operations on the main thread.
class Service {
 public:
  virtual ~Service() = default;

  /// From here on events go to `events`, and no longer to the stream connected before.
  void connect(EventStream& events);
  /// No event goes to `events` once this has returned.
  void disconnect(EventStream& events);
  /// Ends the source for good, whoever is connected: what the service was made over may go afterwards.
  void shutDown();

  /// Executes a command, or refuses it with a status and a message that says why: an unknown command, an
  /// empty configuration, an incomplete query.
  [[nodiscard]] virtual Result perform(const vesk::Text& command, const vesk::InterProcessDictionary& message);
  /// Lets every command end with `refusal`; absent, they are executed again.
  void refuseAll(std::optional<Result> refusal) { refusal_ = std::move(refusal); }

 protected:
  /// A source may run from here on.
  virtual void start(EventStream& events) = 0;
  /// The source must have ended when this returns.
  virtual void stop() = 0;
  /// Answers a query, by raising the metric if there is one.
  [[nodiscard]] virtual Result answer(const MetricQuery& query, EventStream& events) = 0;

 private:
  [[nodiscard]] Result query(const vesk::InterProcessDictionary& message);

  EventStream* events_ = nullptr;
  std::optional<Result> refusal_;
};

/// Puts `service` where the next client::CreateManager finds it; null for none.
void installService(std::shared_ptr<Service> service);
[[nodiscard]] std::shared_ptr<Service> installedService();

}  // namespace corvik
