#include "intake/value_conversions.h"

#include <array>
#include <optional>

#include "intake/date_format.h"

namespace vesk {

namespace {

/// LTE bandwidth codes, which are the indexes, to MHz.
constexpr std::array dlbwlookup{1.4F, 3.0F, 5.0F, 10.0F, 15.0F, 20.0F};

/// Replaces the value by `compute` of the form in which `as` gives it, when it has that form.
template <class Number, class Compute>
void replace(Dictionary& record, const Text& key, std::optional<Number> (Value::*as)() const, Compute compute) {
  Value* present = record.findForChange(key);
  if (present == nullptr) return;
  if (const std::optional<Number> number = (present->*as)()) *present = compute(*number);
}

void subtract(Dictionary& record, const Text& key, std::int64_t offset) {
  replace(record, key, &Value::integer, [offset](std::int64_t number) { return number - offset; });
}

void halveAndSubtract(Dictionary& record, const Text& key, float offset) {
  replace(record, key, &Value::exactFloat, [offset](float number) { return number * 0.5F - offset; });
}

}  // namespace

void formatTimestamp(Dictionary& record, DateFormat& dates) {
  Value* timestamp = record.findForChange("timestamp"_text);
  if (timestamp == nullptr) return;
  if (const std::optional<double> milliseconds = timestamp->number())
    *timestamp = Text::copy(dates.write(*milliseconds));
}

void convertFields(Dictionary& record, std::span<const FieldConversion> conversions) {
  for (const auto& [key, convert] : conversions)
    convert(record, key);
}

void convertRscp(Dictionary& record, const Text& key) {
  subtract(record, key, 116);
}
void convertEcNo(Dictionary& record, const Text& key) {
  halveAndSubtract(record, key, 24.5F);
}
void convertRxLev(Dictionary& record, const Text& key) {
  subtract(record, key, 110);
}
void convertRsrp(Dictionary& record, const Text& key) {
  subtract(record, key, 140);
}
void convertRsrq(Dictionary& record, const Text& key) {
  halveAndSubtract(record, key, 19.5F);
}
void convertSinr(Dictionary& record, const Text& key) {
  halveAndSubtract(record, key, 0.0F);
}

void convertCentiInteger(Dictionary& record, const Text& key) {
  replace(record, key, &Value::integer, [](std::int64_t number) { return number / 100; });
}

void convertCentiFloat(Dictionary& record, const Text& key) {
  replace(record, key, &Value::exactFloat, [](float number) { return number / 100.0F; });
}

void convertBandwidthCode(Dictionary& record, const Text& key) {
  Value* present = record.findForChange(key);
  const std::optional<std::int32_t> code = present == nullptr ? std::nullopt : present->integer32();
  if (!code) return;
  if (*code < 0 || static_cast<std::size_t>(*code) >= dlbwlookup.size()) {
    record.erase(key);
  } else {
    *present = dlbwlookup[static_cast<std::size_t>(*code)];
  }
}

void convertHalf(Dictionary& record, const Text& key) {
  replace(record, key, &Value::integer32, [](std::int32_t number) { return number / 2; });
}

}  // namespace vesk
