#include "insight/report_fields.h"

#include <array>
#include <limits>

namespace vesk::insight {

namespace {

constexpr std::int64_t kLastPci = 503;
constexpr std::int64_t kLastPsc = 511;
constexpr std::int64_t kLastBsic = 63;

}  // namespace

Integer integerOf(OrderedLookup& record, const Text& key) {
  constexpr std::array<std::int64_t, 3> kNoValues{std::numeric_limits<std::uint32_t>::max(),
                                                  std::numeric_limits<std::int32_t>::max(),
                                                  std::numeric_limits<std::int32_t>::min()};
  const Value* value = record.find(key);
  const Integer number = value == nullptr ? std::nullopt : value->integer();
  const bool isValue = number && std::find(kNoValues.begin(), kNoValues.end(), *number) == kNoValues.end();
  return isValue ? number : std::nullopt;
}

Integer integerIn(OrderedLookup& record, const Text& key, std::int64_t first, std::int64_t last) {
  const Integer number = integerOf(record, key);
  return number && *number >= first && *number <= last ? number : std::nullopt;
}

Integer anyInteger(OrderedLookup& record, const Text& key) {
  const Value* value = record.find(key);
  return value == nullptr ? std::nullopt : value->integer();
}

Integer uarfcnOf(OrderedLookup& record, const Text& key) {
  const Integer number = integerOf(record, key);
  return number && umtsChannel(*number) ? number : std::nullopt;
}

Integer arfcnOf(OrderedLookup& record, std::optional<SharedGsmBand> indicated) {
  const Integer number = integerOf(record, "arfcn"_text);
  return number && gsmChannel(*number, indicated) ? number : std::nullopt;
}

Integer pciOf(OrderedLookup& record, const Text& key) {
  return integerIn(record, key, 0, kLastPci);
}

Integer pscOf(OrderedLookup& record, const Text& key) {
  return integerIn(record, key, 0, kLastPsc);
}

Integer bsicOf(OrderedLookup& record) {
  return integerIn(record, "bsic"_text, 0, kLastBsic);
}

Number decodedLevel(const Quantity& quantity, const Value* code, double step, double offset) {
  const Number number = code == nullptr ? std::nullopt : code->number();
  if (!number) return std::nullopt;
  const double level = *number * step + offset;
  return isPossible(quantity, level) ? Number(level) : std::nullopt;
}

std::optional<Text> nameIn(OrderedLookup& record, const Text& key) {
  const Value* value = record.find(key);
  const Text* name = value == nullptr ? nullptr : value->text();
  return name == nullptr ? std::nullopt : std::optional(*name);
}

}  // namespace vesk::insight
