#include "insight/text_forms.h"

#include <array>
#include <cmath>
#include <cstdio>
#include <string_view>

namespace vesk::insight {

namespace {

constexpr std::uint64_t kSecond = 1000;
constexpr std::uint64_t kMinute = 60 * kSecond;
constexpr std::uint64_t kHour = 60 * kMinute;
constexpr std::uint64_t kDay = 24 * kHour;

std::string twoDigits(std::uint64_t number) {
  return (number < 10 ? "0" : "") + std::to_string(number);
}

}  // namespace

void appendNumber(std::string& out, double number) {
  // Room for every double: 309 digits before the point.
  std::array<char, 320> digits;
  const int length = std::snprintf(digits.data(), digits.size(), "%.2f", number);
  std::string_view text(digits.data(), static_cast<std::size_t>(length));
  if (text.find('.') != std::string_view::npos) {
    text.remove_suffix(text.size() - 1 - text.find_last_not_of('0'));
    if (text.back() == '.') text.remove_suffix(1);
  }
  out += text == "-0" ? "0" : text;
}

std::string numberText(double number) {
  std::string out;
  appendNumber(out, number);
  return out;
}

std::string megahertzText(int hundredKilohertz) {
  return std::to_string(hundredKilohertz / 10) + "." + std::to_string(hundredKilohertz % 10);
}

std::string durationText(std::uint64_t milliseconds) {
  const auto whole = [&](std::uint64_t unit) { return std::to_string(milliseconds / unit); };
  const auto rest = [&](std::uint64_t of, std::uint64_t unit) { return milliseconds % of / unit; };
  if (milliseconds < kSecond) return whole(1) + " ms";
  if (milliseconds < kMinute) return whole(kSecond) + "." + std::to_string(rest(kSecond, kSecond / 10)) + " s";
  if (milliseconds < kHour) return whole(kMinute) + " min " + twoDigits(rest(kMinute, kSecond)) + " s";
  if (milliseconds < kDay) return whole(kHour) + " h " + twoDigits(rest(kHour, kMinute)) + " min";
  return whole(kDay) + " d " + std::to_string(rest(kDay, kHour)) + " h";
}

}  // namespace vesk::insight
