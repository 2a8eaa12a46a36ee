#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "recording/timed_events.h"

namespace vesk {

/// Appends a metric identifier as JSON: "0x3C4E04", or an integer where it is negative.
void appendMetricId(std::string& out, std::int64_t metricId);

/// Appends the event's line, with its line feed:
/// {"at": 12.5, "metric": "0x3C4E04", "payload": "0895"}
void appendRecordedEvent(std::string& out, const RecordedEvent& event);

/// Reads such lines: a JSON object with "at" (a number), "metric" (an integer or "0x…" text) and "payload"
/// (hex text) in any order. Other keys are ignored; what stands under them must be JSON, of numbers that a double can
/// hold and nested no deeper than anyone needs.
class RecordedEventParser {
 public:
  /// A line must be followed by this many bytes that may be read; the first is overwritten.
  static constexpr std::size_t kPadding = 16;

  /// The event; its payload is valid until the next call. Absent when `line` holds none: see reason(). Texts are
  /// read in their place, and the line is of no use afterwards.
  [[nodiscard]] std::optional<RecordedEvent> parse(std::span<char> line);
  /// What was wrong with the last line, in words for the person who wrote it.
  [[nodiscard]] const std::string& reason() const { return reason_; }

 private:
  class Fields;

  [[nodiscard]] bool readFields(std::span<char> line, Fields& fields);
  [[nodiscard]] bool decodePayload(std::string_view digits);
  bool fail(std::string reason);

  std::vector<std::uint8_t> payload_;
  std::size_t payloadSize_ = 0;
  std::string reason_;
};

}  // namespace vesk
