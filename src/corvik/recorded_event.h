#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace corvik {

/// One metric event of a recording.
struct RecordedEvent {
  /// Seconds since the recording began: finite, not negative.
  double at;
  std::int64_t metricId;
  std::span<const std::uint8_t> payload;
};

/// Appends a metric identifier as JSON: "0x3C4E04", or an integer where it is negative.
void appendMetricId(std::string& out, std::int64_t metricId);

/// Appends the event's line, with its line feed:
/// {"at": 12.5, "metric": "0x3C4E04", "payload": "0895"}
void appendRecordedEvent(std::string& out, const RecordedEvent& event);

/// Reads such lines: a JSON object with "at" (a number), "metric" (an integer or "0x…" text) and "payload"
/// (hex text) in any order. Other keys are ignored, and what stands under
/// them is not looked at. The hex text is taken as it stands, without escapes.
class RecordedEventParser {
 public:
  /// A line must be followed by this many bytes that may be read, whatever they hold.
  static constexpr std::size_t kPadding = 64;

  RecordedEventParser();
  RecordedEventParser(RecordedEventParser&&) noexcept;
  RecordedEventParser& operator=(RecordedEventParser&&) noexcept;
  ~RecordedEventParser();

  /// The event; its payload is valid until the next call. Absent when `line` holds none: see reason().
  [[nodiscard]] std::optional<RecordedEvent> parse(std::string_view line);
  /// What was wrong with the last line, in words for the person who wrote it.
  [[nodiscard]] const std::string& reason() const { return reason_; }

 private:
  struct Json;
  struct Fields;

  [[nodiscard]] bool readFields(std::string_view line, Fields& fields);
  [[nodiscard]] bool decodePayload(std::string_view digits);
  bool fail(std::string reason);

  std::unique_ptr<Json> json_;
  std::vector<std::uint8_t> payload_;
  std::size_t payloadSize_ = 0;
  std::string reason_;
};

}  // namespace corvik
