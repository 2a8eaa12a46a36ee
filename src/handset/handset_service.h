#pragma once

#include <mutex>
#include <optional>
#include <stop_token>
#include <thread>

#include "corvik/service.h"
#include "handset/handset.h"
#include "system/clock.h"

namespace vesk::handset {

/// The baseband manager service of a simulated handset, in real time: raises each event when its time has come, on a
/// thread of its own, as soon as the client wants metrics and no faster than it takes them. While nobody wants any,
/// the handset stands still. Of queries it answers that of the SIM files, at any time. Can be connected again after a
/// disconnection, and then goes on.
class HandsetService final : public ::corvik::Service {
 public:
  /// `startMs` is the time of now, in milliseconds since 1970-01-01 UTC; `clock` must outlive the service.
  HandsetService(std::uint64_t seed, std::uint64_t startMs, const Clock& clock);
  ~HandsetService() override { endThread(); }
  HandsetService(const HandsetService&) = delete;
  HandsetService& operator=(const HandsetService&) = delete;

 private:
  void start(::corvik::EventStream& events) override;
  void stop() override { endThread(); }
  [[nodiscard]] ::corvik::Result answer(const ::corvik::MetricQuery& query, ::corvik::EventStream& events) override;

  void endThread();
  /// These run on the service's thread.
  void play(const std::stop_token& stop, ::corvik::EventStream& events);
  [[nodiscard]] HandsetEvent takeNext();
  void waitUntil(std::int64_t atMs);

  const Clock& clock_;
  /// Guards the handset, which is queried on the main thread.
  std::mutex mutex_;
  Handset handset_;

  /// What was taken from the handset and not raised yet.
  std::optional<HandsetEvent> event_;
  /// When the last event was due, and its time.
  std::optional<Clock::Instant> due_;
  std::int64_t atMs_ = 0;

  WakeUp interrupt_;
  std::jthread thread_;
};

}  // namespace vesk::handset
