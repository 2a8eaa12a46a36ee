#pragma once

#include <condition_variable>
#include <cstddef>
#include <cstdint>
#include <deque>
#include <mutex>
#include <optional>
#include <stop_token>

#include "corvik/inter_process_dictionary.h"
#include "diag/packet.h"

namespace vesk::diag {

/// Events on their way from the thread that reads a port, which must not be late, to the one that waits for the client.
/// While the client is behind, measurements are dropped: the next ones are as good. What tells of a state is kept.
class EventQueue {
 public:
  /// Measurements are dropped while so many events wait.
  static constexpr std::size_t kMostWaiting = 1024;
  /// While so many wait, the reader waits too.
  static constexpr std::size_t kMostOfAll = 16384;

  void add(const Event& event, const std::stop_token& stop);
  /// The oldest one's message; blocks until there is one. Absent when a stop was requested.
  [[nodiscard]] std::optional<InterProcessDictionary> take(const std::stop_token& stop);
  [[nodiscard]] std::uint64_t dropped() const;

 private:
  mutable std::mutex mutex_;
  std::condition_variable_any changed_;
  std::deque<InterProcessDictionary> events_;
  std::uint64_t dropped_ = 0;
};

}  // namespace vesk::diag
