#pragma once

#include <ctime>
#include <string>
#include <string_view>

namespace vesk {

/// Writes instants as "yyyy-MM-dd HH:mm:ss zzz" in the time zone of the process, with daylight saving time. "zzz" is
/// the zone's short name, such as UTC or CET, or its distance, such as GMT+5, when it has no name. It takes up the time
/// zone when it is made. To be used by one thread.
class DateFormat {
 public:
  DateFormat();

  /// The date of the instant `milliseconds` after 1970-01-01 00:00:00 UTC. The fraction of a second is dropped, toward
  /// the past. What is no instant (NaN, a year that a calendar cannot hold) is "no date". The text lasts until the next
  /// call.
  [[nodiscard]] std::string_view write(double milliseconds);

 private:
  /// Writes the hour of `instant` into text_; false when it has none.
  [[nodiscard]] bool writeHourOf(std::time_t instant);

  std::string text_;
  /// text_ holds from begin_ to before end_, but for its minutes and seconds. Instants come in clusters: this saves 7 %
  /// of the instructions of `vesk stores`.
  std::time_t begin_ = 0;
  std::time_t end_ = 0;
  /// How far begin_ lies in its hour of local time.
  int secondOfBegin_ = 0;
  /// Where the minutes stand in text_.
  std::size_t minutesAt_ = 0;
};

}  // namespace vesk
