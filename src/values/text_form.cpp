#include "values/text_form.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <string_view>

#include "values/utf8.h"

namespace vesk {

namespace {

/// Long enough for every 64-bit number and for the shortest form of every double.
constexpr std::size_t kLongestNumber = 32;

template <class Number>
void appendInteger(std::string& out, Number number) {
  std::array<char, kLongestNumber> digits;
  const auto result = std::to_chars(digits.data(), digits.data() + digits.size(), number);
  out.append(digits.data(), result.ptr);
}

/// Of "1.5" and -20: the digits, with the point where the exponent puts it.
void appendShifted(std::string& out, std::string_view mantissa, int exponent) {
  if (mantissa.front() == '-') {
    out += '-';
    mantissa.remove_prefix(1);
  }
  std::string digits(mantissa.substr(0, 1));
  if (mantissa.size() > 2) digits += mantissa.substr(2);
  if (exponent < 0) digits.insert(0, static_cast<std::size_t>(-exponent), '0');
  const auto point = static_cast<std::size_t>(std::max(exponent, 0)) + 1;
  if (digits.size() <= point) digits.resize(point + 1, '0');
  out += digits.insert(point, 1, '.');
}

template <class Number>
void appendReal(std::string& out, Number number) {
  std::array<char, kLongestNumber> digits;
  const auto result = std::to_chars(digits.data(), digits.data() + digits.size(), number);
  const std::string_view shortest(digits.data(), static_cast<std::size_t>(result.ptr - digits.data()));
  if (const std::size_t e = shortest.find('e'); e != std::string_view::npos) {
    const char* exponentText = shortest.data() + e + (shortest[e + 1] == '+' ? 2 : 1);
    int exponent = 0;
    std::from_chars(exponentText, result.ptr, exponent);
    return appendShifted(out, shortest.substr(0, e), exponent);
  }
  out += shortest;
  if (std::isfinite(number) && shortest.find('.') == std::string_view::npos) out += ".0";
}

struct TextForm {
  std::string& out;

  void operator()(bool value) const { out += value ? "true" : "false"; }
  void operator()(std::int64_t number) const { appendDecimal(out, number); }
  void operator()(std::uint64_t number) const { appendDecimal(out, number); }
  void operator()(float number) const { appendDecimal(out, number); }
  void operator()(const Text& text) const { appendUtf8(out, text.view()); }
  void operator()(const Data& data) const {
    out += "0x";
    appendHex(out, data.bytes());
  }
  void operator()(const Array& array) const { appendText(out, array); }
  void operator()(const Dictionary& dictionary) const { appendText(out, dictionary); }
};

}  // namespace

std::string counted(std::uint64_t count, std::string_view one, std::string_view more) {
  return std::to_string(count) + " " + std::string(count == 1 ? one : more);
}

void appendDecimal(std::string& out, std::int64_t number) {
  appendInteger(out, number);
}
void appendDecimal(std::string& out, std::uint64_t number) {
  appendInteger(out, number);
}
void appendDecimal(std::string& out, float number) {
  appendReal(out, number);
}
void appendDecimal(std::string& out, double number) {
  appendReal(out, number);
}

void appendUpperHex(std::string& out, std::uint64_t number) {
  constexpr std::string_view kDigits = "0123456789ABCDEF";
  std::array<char, 16> digits;
  std::size_t first = digits.size();
  do {
    digits[--first] = kDigits[number & 0x0F];
    number >>= 4;
  } while (number != 0);
  out.append(digits.data() + first, digits.size() - first);
}

void appendHex(std::string& out, std::span<const std::uint8_t> bytes) {
  constexpr std::string_view kDigits = "0123456789abcdef";
  const std::size_t start = out.size();
  out.resize(start + 2 * bytes.size());
  char* place = out.data() + start;
  for (const std::uint8_t byte : bytes) {
    *place++ = kDigits[byte >> 4];
    *place++ = kDigits[byte & 0x0F];
  }
}

void appendText(std::string& out, const Value& value) {
  std::visit(TextForm{out}, value.held());
}

void appendText(std::string& out, const Array& array) {
  out += '[';
  std::string_view separator;
  for (const Value& value : array) {
    out += separator;
    appendText(out, value);
    separator = ", ";
  }
  out += ']';
}

void appendText(std::string& out, const Dictionary& dictionary) {
  out += '{';
  std::string_view separator;
  for (const auto& [key, value] : dictionary) {
    out += separator;
    appendUtf8(out, key.view());
    out += ": ";
    appendText(out, value);
    separator = ", ";
  }
  out += '}';
}

}  // namespace vesk
