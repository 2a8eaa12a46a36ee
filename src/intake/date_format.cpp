#include "intake/date_format.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstdlib>
#include <optional>

namespace vesk {

namespace {

constexpr double kMillisecondsPerSecond = 1000.0;
constexpr int kSecondsPerMinute = 60;
constexpr int kMinutesPerHour = 60;
constexpr int kSecondsPerQuarter = 15 * kSecondsPerMinute;
constexpr int kFirstYear = 1900;
/// No year within a calendar's int lies beyond this many seconds.
constexpr double kMostSeconds = 1e17;
constexpr std::string_view kNoDate = "no date";

void appendPadded(std::string& out, long number, std::size_t width) {
  char digits[20];
  const char* end = std::to_chars(digits, digits + sizeof digits, number).ptr;
  const auto size = static_cast<std::size_t>(end - digits);
  if (size < width) out.append(width - size, '0');
  out.append(digits, size);
}

void writeTwoDigits(char* place, int number) {
  place[0] = static_cast<char>('0' + number / 10);
  place[1] = static_cast<char>('0' + number % 10);
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

std::string_view DateFormat::write(double milliseconds) {
  const double seconds = std::floor(std::floor(milliseconds) / kMillisecondsPerSecond);
  if (!(std::abs(seconds) < kMostSeconds)) return kNoDate;
  const auto instant = static_cast<std::time_t>(seconds);
  const bool isRemembered = begin_ <= instant && instant < end_;
  if (!isRemembered && !writeHourOf(instant)) return kNoDate;
  const int second = secondOfBegin_ + static_cast<int>(instant - begin_);
  writeTwoDigits(&text_[minutesAt_], second / kSecondsPerMinute);
  writeTwoDigits(&text_[minutesAt_ + 3], second % kSecondsPerMinute);
  return text_;
}

bool DateFormat::writeHourOf(std::time_t instant) {
  begin_ = end_ = 0;
  const std::optional<std::tm> local = localTime(instant);
  if (!local) return false;
  text_.clear();
  appendPadded(text_, yearOf(*local), 4);
  text_ += '-';
  appendPadded(text_, local->tm_mon + 1, 2);
  text_ += '-';
  appendPadded(text_, local->tm_mday, 2);
  text_ += ' ';
  appendPadded(text_, local->tm_hour, 2);
  text_ += ':';
  minutesAt_ = text_.size();
  text_ += "mm:ss ";
  text_ += zoneName(*local);

  // The quarter of the local hour, where no clock is changed within it, and otherwise only this second.
  secondOfBegin_ = local->tm_min * kSecondsPerMinute + local->tm_sec;
  begin_ = instant;
  end_ = instant + 1;
  const int secondOfQuarter = secondOfBegin_ % kSecondsPerQuarter;
  const auto isSoAt = [&](int seconds) {
    const std::optional<std::tm> there = localTime(instant + seconds);
    return there && there->tm_gmtoff == local->tm_gmtoff && zoneName(*there) == zoneName(*local);
  };
  if (isSoAt(-secondOfQuarter) && isSoAt(kSecondsPerQuarter - 1 - secondOfQuarter)) {
    secondOfBegin_ -= secondOfQuarter;
    begin_ -= secondOfQuarter;
    end_ = begin_ + kSecondsPerQuarter;
  }
  return true;
}

}  // namespace vesk
