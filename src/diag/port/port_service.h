#pragma once

#include <cstdint>
#include <functional>
#include <mutex>
#include <optional>
#include <span>
#include <stop_token>
#include <string>
#include <thread>
#include <vector>

#include "corvik/service.h"
#include "diag/framing/frame_reader.h"
#include "diag/port/event_queue.h"
#include "diag/port/port.h"
#include "diag/port/port_remarks.h"
#include "diag/port/session.h"
#include "diag/receiver.h"
#include "system/clock.h"
#include "system/wake_up.h"

namespace vesk::diag {

/// What a status bar shows of a port.
struct PortState {
  enum class Phase {
    /// The modem is asked for its logs.
    starting,
    watching,
    /// No log has come for ten seconds.
    silent,
    unplugged,
    ended,
  };

  Phase phase = Phase::starting;
  std::uint32_t packetsPerSecond = 0;
  std::uint64_t damaged = 0;
  std::uint64_t passedOver = 0;
  /// Measurements for which the client was too far behind.
  std::uint64_t dropped = 0;
};

/// The baseband manager service of a real handset, or of a modem: turns on the logs that are read here at its
/// diagnostic port, raises what they become as it comes, and turns them off at the end. A port that goes is waited for.
/// Queries are accepted; what answers them comes by itself or not at all. Reads on a thread of its own, delivers on
/// another.
class PortService final : public ::corvik::Service {
 public:
  /// Each is called on the main queue.
  using RemarkHandler = std::function<void(const std::string& remark)>;
  using EndHandler = std::function<void(const std::string& failure)>;
  /// Called on the port's thread with the content of every frame that is whole.
  using FrameHandler = std::function<void(std::span<const std::uint8_t> content)>;

  /// `sim` is the one that is wanted, absent for all; `clock` must outlive the service.
  PortService(Port port, std::optional<std::uint32_t> sim, const Clock& clock);
  ~PortService() override { endThreads(); }
  PortService(const PortService&) = delete;
  PortService& operator=(const PortService&) = delete;

  /// To be set before the service is connected.
  void setRemarkHandler(RemarkHandler handler) { onRemark_ = std::move(handler); }
  /// Called when no log can be had from the port.
  void setEndHandler(EndHandler handler) { onEnd_ = std::move(handler); }
  void setFrameHandler(FrameHandler handler) { onFrame_ = std::move(handler); }

  /// From any thread.
  [[nodiscard]] PortState state() const;

 private:
  void start(::corvik::EventStream& events) override;
  void stop() override { endThreads(); }
  [[nodiscard]] ::corvik::Result answer(const ::corvik::MetricQuery& query, ::corvik::EventStream& events) override;

  void endThreads();

  /// These run on the reading thread.
  enum class Ending { stopped, portGone, failed };
  void run(const std::stop_token& stop, ::corvik::EventStream& events);
  [[nodiscard]] Ending watch(const std::stop_token& stop, ::corvik::EventStream& events);
  /// False when the port is gone.
  [[nodiscard]] bool sendAndTell(Session& session, ::corvik::EventStream& events);
  void noteWatching(const Session& session);
  [[nodiscard]] bool readSome(FrameReader& frames, Session& session, const std::stop_token& stop);
  void take(std::span<const std::uint8_t> content, Session& session, const std::stop_token& stop);
  /// False when a stop was requested.
  [[nodiscard]] bool waitForPort(Clock::Duration first, const std::stop_token& stop);
  void noteLog(Clock::Instant now);
  void note(PortState::Phase phase);
  void noteCounts();
  void logState();
  void tell(std::string remark, ::corvik::EventStream& events);

  /// On the delivering thread.
  void deliver(const std::stop_token& stop, ::corvik::EventStream& events);

  const Clock& clock_;
  RemarkHandler onRemark_;
  EndHandler onEnd_;
  FrameHandler onFrame_;

  Port port_;
  Receiver receiver_;
  PortRemarks remarks_;
  std::vector<std::uint8_t> buffer_;
  std::string failure_;
  bool hasWatched_ = false;
  Clock::Instant nextLogOfState_;

  mutable std::mutex mutex_;
  PortState state_;
  /// The second in which packets are counted.
  Clock::Instant secondBegan_;
  std::uint32_t packetsOfSecond_ = 0;

  EventQueue queue_;
  WakeUp interrupt_;
  std::jthread reader_;
  std::jthread deliverer_;
};

}  // namespace vesk::diag
