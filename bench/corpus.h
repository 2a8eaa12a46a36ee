#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <vector>

#include "bench/kinds.h"

namespace vesk::bench {

struct Event {
  /// Seconds since the recording began.
  double at;
  const Kind* kind;
  std::span<const std::uint8_t> payload;
};

/// The events that are measured. Their payloads stand in memory one behind another, in the order of the events.
class Corpus {
 public:
  explicit Corpus(std::span<const Event> events);
  Corpus(Corpus&&) = default;
  Corpus& operator=(Corpus&&) = default;

  [[nodiscard]] const std::vector<Event>& events() const { return events_; }
  /// Of all payloads.
  [[nodiscard]] std::size_t bytes() const { return payloads_.size(); }

 private:
  std::vector<std::uint8_t> payloads_;
  std::vector<Event> events_;
};

inline constexpr std::size_t kShortRecording = 2000;
inline constexpr std::size_t kLongRecording = 50000;

/// `count` events of simulated drives, every kind that the intake handles as likely as any other; always the same ones.
/// Fewer are the first of more.
[[nodiscard]] Corpus mixedCorpus(std::size_t count);

/// The events of a recording that have a class. Ends the program with one line when it cannot be read or has none.
[[nodiscard]] Corpus recordedCorpus(const std::string& path);

}  // namespace vesk::bench
