#include "intake/date_format.h"

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
constexpr int kLastSecond = 59;
constexpr int kMinutesPerHour = 60;
constexpr int kSecondsPerHour = kSecondsPerMinute * kMinutesPerHour;
constexpr int kSecondsPerDay = 24 * kSecondsPerHour;
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

void appendTwoDigits(std::string& out, int number) {
  out += static_cast<char>('0' + number / 10);
  out += static_cast<char>('0' + number % 10);
}

std::optional<std::tm> localTime(std::time_t instant) {
  std::tm local{};
  if (localtime_r(&instant, &local) == nullptr) return std::nullopt;
  return local;
}

/// Of a leap second that of the second before.
int secondOfDay(const std::tm& local) {
  return local.tm_hour * kSecondsPerHour + local.tm_min * kSecondsPerMinute + std::min(local.tm_sec, kLastSecond);
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
  if (!isRemembered && !writeDay(instant)) {
    out += "no date";
    return;
  }
  const int second = secondOfBegin_ + static_cast<int>(instant - begin_);
  out += date_;
  appendTwoDigits(out, second / kSecondsPerHour);
  out += ':';
  appendTwoDigits(out, second / kSecondsPerMinute % kMinutesPerHour);
  out += ':';
  appendTwoDigits(out, second % kSecondsPerMinute + leap_);
  out += zone_;
}

bool DateFormat::writeDay(std::time_t instant) {
  begin_ = end_ = 0;
  const std::optional<std::tm> local = localTime(instant);
  if (!local) return false;
  date_.clear();
  appendPadded(date_, yearOf(*local), 4);
  date_ += '-';
  appendTwoDigits(date_, local->tm_mon + 1);
  date_ += '-';
  appendTwoDigits(date_, local->tm_mday);
  date_ += ' ';
  zone_ = ' ' + zoneName(*local);

  const int second = secondOfDay(*local);
  leap_ = std::max(0, local->tm_sec - kLastSecond);
  const auto isSoAt = [&](std::time_t other) {
    const std::optional<std::tm> there = localTime(other);
    return there && there->tm_gmtoff == local->tm_gmtoff && zoneName(*there) == zoneName(*local) &&
           secondOfDay(*there) - second == other - instant;
  };
  // Where the zone's clocks are changed within the day it is the hour that is remembered, or only this second.
  for (const int stretch : {kSecondsPerDay, kSecondsPerHour, 1}) {
    secondOfBegin_ = second - second % stretch;
    begin_ = instant - second % stretch;
    end_ = begin_ + stretch;
    if (leap_ == 0 && isSoAt(begin_) && isSoAt(end_ - 1)) break;
  }
  return true;
}

}  // namespace vesk
