#include "platform/date_format.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstdlib>
#include <optional>
#include <string_view>

namespace vesk {

namespace {

constexpr double kMillisecondsPerSecond = 1000.0;
constexpr int kSecondsPerMinute = 60;
constexpr int kMinutesPerHour = 60;
constexpr int kFirstYear = 1900;
/// No year within a calendar's int lies beyond this many seconds.
constexpr double kMostSeconds = 1e17;

void appendPadded(std::string& out, long number, std::size_t width) {
  char digits[20];
  const char* end = std::to_chars(digits, digits + sizeof digits, number).ptr;
  const auto size = static_cast<std::size_t>(end - digits);
  if (size < width) out.append(width - size, '0');
  out.append(digits, size);
}

std::optional<std::tm> localTime(std::time_t instant) {
  std::tm local{};
  if (localtime_r(&instant, &local) == nullptr) return std::nullopt;
  return local;
}

/// The year within its era: what "yyyy" asks for.
long yearOf(const std::tm& local) {
  const long year = long{local.tm_year} + kFirstYear;
  return year > 0 ? year : 1 - year;
}

bool isLetter(char character) {
  return (character >= 'A' && character <= 'Z') || (character >= 'a' && character <= 'z');
}

std::string zoneName(const std::tm& local) {
  const std::string_view name = local.tm_zone == nullptr ? "" : local.tm_zone;
  if (!name.empty() && std::all_of(name.begin(), name.end(), isLetter)) return std::string(name);
  const long minutes = std::labs(local.tm_gmtoff) / kSecondsPerMinute;
  std::string distance = "GMT";
  if (minutes == 0) return distance;
  distance += local.tm_gmtoff < 0 ? '-' : '+';
  appendPadded(distance, minutes / kMinutesPerHour, 1);
  if (minutes % kMinutesPerHour != 0) {
    distance += ':';
    appendPadded(distance, minutes % kMinutesPerHour, 2);
  }
  return distance;
}

}  // namespace

DateFormat::DateFormat() {
  tzset();
}

void DateFormat::append(std::string& out, double milliseconds) {
  const double seconds = std::floor(std::floor(milliseconds) / kMillisecondsPerSecond);
  if (!(std::abs(seconds) < kMostSeconds)) {
    out += "no date";
    return;
  }
  const auto instant = static_cast<std::time_t>(seconds);
  const bool isRemembered = begin_ <= instant && instant < end_;
  if (!isRemembered && !writeMinute(instant)) {
    out += "no date";
    return;
  }
  const auto second = static_cast<int>(instant - begin_) + firstSecond_;
  out += untilSeconds_;
  out += static_cast<char>('0' + second / 10);
  out += static_cast<char>('0' + second % 10);
  out += ' ';
  out += zone_;
}

bool DateFormat::writeMinute(std::time_t instant) {
  begin_ = end_ = 0;
  const std::optional<std::tm> local = localTime(instant);
  if (!local) return false;
  untilSeconds_.clear();
  appendPadded(untilSeconds_, yearOf(*local), 4);
  for (const auto& [separator, number] :
       {std::pair{'-', local->tm_mon + 1}, {'-', local->tm_mday}, {' ', local->tm_hour}, {':', local->tm_min}}) {
    untilSeconds_ += separator;
    appendPadded(untilSeconds_, number, 2);
  }
  untilSeconds_ += ':';
  zone_ = zoneName(*local);

  begin_ = instant;
  firstSecond_ = local->tm_sec;
  // Where the zone's clocks are changed within the minute, only this second is sure.
  const std::time_t minuteEnd = instant + std::max(1, kSecondsPerMinute - local->tm_sec);
  const std::optional<std::tm> last = localTime(minuteEnd - 1);
  const bool isSameRule = last && last->tm_gmtoff == local->tm_gmtoff && last->tm_isdst == local->tm_isdst;
  end_ = isSameRule ? minuteEnd : instant + 1;
  return true;
}

}  // namespace vesk
