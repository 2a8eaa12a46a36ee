#include <algorithm>
#include <array>
#include <string>

#include "insight/reading_rules.h"
#include "insight/text_forms.h"

namespace vesk::insight {

namespace {

constexpr std::uint64_t kSecondInMilliseconds = 1000;

std::string withUnit(double number, std::string_view unit) {
  std::string out = numberText(number);
  out += ' ';
  out += unit;
  return out;
}

std::optional<Mark> markOf(const Quantity& quantity, double value) {
  if (quantity.floor && (value == quantity.floor->low || value == quantity.floor->high)) return Mark::floor;
  if (quantity.high && value >= *quantity.high) return Mark::high;
  return std::nullopt;
}

Reading durationReading(std::int64_t number, std::string_view unit, std::uint64_t milliseconds) {
  return {.text = durationText(milliseconds), .value = static_cast<double>(number), .unit = unit};
}

struct Bandwidth {
  float megahertz;
  int resourceBlocks;
};

/// In the order of their codes.
constexpr std::array<Bandwidth, 6> kBandwidths{{{1.4F, 6}, {3, 15}, {5, 25}, {10, 50}, {15, 75}, {20, 100}}};

Reading bandwidthReading(const Bandwidth& bandwidth) {
  return {.text = withUnit(bandwidth.megahertz, "MHz, ") + std::to_string(bandwidth.resourceBlocks) + " RB",
          .value = bandwidth.megahertz,
          .unit = "MHz"};
}

}  // namespace

std::optional<Reading> readByCode(const ReadingRule& rule, const Value& value, const Dictionary& /*record*/) {
  if (!value.number()) return std::nullopt;
  const std::optional<std::int64_t> code = value.integer();
  if (!code || *code < rule.lowest || *code > rule.highest) return impossibleReading();
  return rule.readCode(*code);
}

Reading levelReading(const Quantity& quantity, double number) {
  if (!isPossible(quantity, number)) return impossibleReading();
  Reading reading{.text = withUnit(number, quantity.unit),
                  .value = number,
                  .unit = quantity.unit,
                  .grade = gradeOf(quantity, number),
                  .mark = markOf(quantity, number)};
  if (reading.mark == Mark::floor) reading.text += " or below";
  if (reading.mark == Mark::high) reading.text += ", high";
  if (reading.grade) {
    reading.text += ", ";
    reading.text += nameOf(*reading.grade);
  }
  return reading;
}

std::optional<Reading> readLevel(const ReadingRule& rule, const Value& value, const Dictionary& /*record*/) {
  const std::optional<double> code = value.number();
  if (!code) return std::nullopt;
  return levelReading(*rule.quantity, *code * rule.scale + rule.offset);
}

std::optional<Reading> readNumber(const ReadingRule& rule, const Value& value, const Dictionary& /*record*/) {
  const std::optional<double> code = value.number();
  if (!code) return std::nullopt;
  if (*code < static_cast<double>(rule.lowest) || *code > static_cast<double>(rule.highest)) return impossibleReading();
  const double number = *code * rule.scale + rule.offset;
  return Reading{.text = withUnit(number, rule.unit), .value = number, .unit = rule.unit};
}

std::optional<Reading> readBandwidth(const ReadingRule& /*rule*/, const Value& value, const Dictionary& /*record*/) {
  if (!value.number()) return std::nullopt;
  const std::optional<float> megahertz = value.exactFloat();
  // Half of the narrowest, in whole units, is what comes of it.
  if (megahertz == 1.0F) return bandwidthReading(kBandwidths.front());
  const auto* found = std::find_if(kBandwidths.begin(), kBandwidths.end(),
                                   [&](const Bandwidth& each) { return each.megahertz == megahertz; });
  return found == kBandwidths.end() ? impossibleReading() : bandwidthReading(*found);
}

std::optional<Reading> readBandwidthCode(std::int64_t code) {
  return bandwidthReading(kBandwidths[static_cast<std::size_t>(code)]);
}

std::optional<Reading> readMilliseconds(std::int64_t code) {
  return durationReading(code, "ms", static_cast<std::uint64_t>(code));
}

std::optional<Reading> readSeconds(std::int64_t code) {
  return durationReading(code, "s", static_cast<std::uint64_t>(code) * kSecondInMilliseconds);
}

std::optional<Reading> readSixMinutes(std::int64_t code) {
  constexpr std::uint64_t kStep = std::uint64_t{6} * 60 * kSecondInMilliseconds;
  return Reading{.text = code == 0 ? "off" : durationText(static_cast<std::uint64_t>(code) * kStep)};
}

std::optional<Reading> readBlocks(std::int64_t code) {
  constexpr std::uint64_t kBlock = 480;
  const auto blocks = static_cast<double>(code);
  return Reading{.text = withUnit(blocks, "blocks, ") + durationText(static_cast<std::uint64_t>(code) * kBlock),
                 .value = blocks,
                 .unit = "blocks"};
}

}  // namespace vesk::insight
