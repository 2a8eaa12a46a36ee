#pragma once

#include <ctime>
#include <string>

namespace vesk {

/// Writes instants as "yyyy-MM-dd HH:mm:ss zzz" in the process's time zone, daylight saving included: "zzz"
/// is the zone's short name, as UTC or CET, or its distance, as GMT+5, where it has none. Remembers the
/// day it wrote last, for instants come in clusters; of no zone are the clocks changed twice in a day. One thread at a
/// time; takes up the zone when it is made.
class DateFormat {
 public:
  DateFormat();

  /// Appends the instant that lies `milliseconds` behind 1970-01-01 00:00:00 UTC; the fraction of a second is
  /// dropped, toward the past. For what is no instant, as NaN or years beyond the calendar's, "no date".
  void append(std::string& out, double milliseconds);

 private:
  [[nodiscard]] bool writeDay(std::time_t instant);

  /// The instants for which the texts hold: empty, or within one day of local time.
  std::time_t begin_ = 0;
  std::time_t end_ = 0;
  /// How far into its day begin_ lies.
  int secondOfBegin_ = 0;
  /// 1 for a leap second, which follows secondOfBegin_ in the same minute.
  int leap_ = 0;
  /// What stands before and behind the time of the day.
  std::string date_;
  std::string zone_;
};

}  // namespace vesk
