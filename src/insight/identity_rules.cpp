#include <algorithm>
#include <string>

#include "insight/plmn.h"
#include "insight/reading_rules.h"
#include "values/text_form.h"

namespace vesk::insight {

namespace {

/// A code that is two numbers in one: code / divisor and code % divisor.
Reading pairReading(std::int64_t code, std::int64_t divisor, std::string_view first, std::string_view second) {
  Reading reading{.text = std::string(first)};
  reading.text += std::to_string(code / divisor);
  reading.text += second;
  reading.text += std::to_string(code % divisor);
  return reading;
}

std::string hexadecimalText(std::int64_t code, std::size_t digits) {
  std::string number;
  appendUpperHex(number, static_cast<std::uint64_t>(code));
  return "0x" + std::string(digits - std::min(digits, number.size()), '0') + number;
}

std::optional<std::int64_t> integerAt(const Dictionary& record, std::string_view key) {
  const Value* value = record.find(key);
  return value == nullptr ? std::nullopt : value->integer();
}

}  // namespace

std::optional<Reading> readPci(std::int64_t code) {
  return pairReading(code, 3, "group ", ", identity ");
}

std::optional<Reading> readPsc(std::int64_t code) {
  return pairReading(code, 8, "group ", ", code ");
}

std::optional<Reading> readBsic(std::int64_t code) {
  return pairReading(code, 8, "NCC ", ", BCC ");
}

std::optional<Reading> readEci(std::int64_t code) {
  constexpr std::int64_t kSectors = 256;
  Reading reading = pairReading(code, kSectors, "eNB ", " / ");
  reading.enb = code / kSectors;
  reading.sector = code % kSectors;
  return reading;
}

std::optional<Reading> readUci(std::int64_t code) {
  constexpr std::int64_t kCells = 65536;
  if (code < kCells) return Reading{.text = "cell " + std::to_string(code), .cell = code};
  Reading reading = pairReading(code, kCells, "RNC ", " / cell ");
  reading.rnc = code / kCells;
  reading.cell = code % kCells;
  return reading;
}

std::optional<Reading> readCountryCode(std::int64_t code) {
  return Reading{.text = codeText(code, 3)};
}

std::optional<Reading> readNetworkCode(const ReadingRule& rule, const Value& value, const Dictionary& record) {
  if (!value.number()) return std::nullopt;
  const std::optional<std::int64_t> code = value.integer();
  if (!code || *code < rule.lowest || *code > rule.highest) return impossibleReading();
  const Value* digits = record.find("num_mnc_digits");
  const std::optional<Plmn> plmn = plmnOf(record.find(rule.sibling), &value, digits);
  if (!plmn) return Reading{.text = codeText(*code, mncDigitsOf(digits))};
  return Reading{.text = textOf(*plmn), .plmn = textOf(*plmn)};
}

std::optional<Reading> readAreaCode(std::int64_t code) {
  constexpr std::int64_t kDeleted = 0xFFFE;
  Reading reading{.text = hexadecimalText(code, 4)};
  if (code == 0 || code == kDeleted) {
    reading.text += ", reserved";
    reading.mark = Mark::reserved;
  }
  return reading;
}

std::optional<Reading> readHexadecimal(std::int64_t code) {
  return Reading{.text = hexadecimalText(code, 8)};
}

std::optional<Reading> readArea(const ReadingRule& rule, const Value& value, const Dictionary& /*record*/) {
  const Dictionary* area = value.dictionary();
  if (area == nullptr) return std::nullopt;
  const std::optional<Plmn> plmn = encodedPlmnOf(*area);
  const std::optional<std::int64_t> lac = integerAt(*area, "lac");
  if (!plmn || !lac) return std::nullopt;
  Reading reading{.text = textOf(*plmn) + " LAC " + std::to_string(*lac), .plmn = textOf(*plmn)};
  if (rule.sibling.empty()) return reading;
  const std::optional<std::int64_t> rac = integerAt(*area, rule.sibling);
  if (!rac) return std::nullopt;
  reading.text += " RAC " + std::to_string(*rac);
  return reading;
}

}  // namespace vesk::insight
