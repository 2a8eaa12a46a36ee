#include "insight/plmn.h"

#include <array>

namespace vesk::insight {

namespace {

constexpr std::int64_t kHighestCode = 999;
constexpr std::int64_t kHighestOfTwoDigits = 99;

std::optional<std::int64_t> codeOf(const Value* value) {
  const std::optional<std::int64_t> code = value == nullptr ? std::nullopt : value->integer();
  return code && *code >= 0 && *code <= kHighestCode ? code : std::nullopt;
}

/// Absent when one is no digit.
std::optional<std::int16_t> numberOf(std::span<const unsigned> digits) {
  unsigned number = 0;
  for (const unsigned digit : digits) {
    if (digit > 9) return std::nullopt;
    number = number * 10 + digit;
  }
  return static_cast<std::int16_t>(number);
}

}  // namespace

std::optional<Plmn> plmnOf(const Value* mcc, const Value* mnc, const Value* mncDigits) {
  const std::optional<std::int64_t> country = codeOf(mcc);
  const std::optional<std::int64_t> network = codeOf(mnc);
  if (!country || !network) return std::nullopt;
  const int digits = *network > kHighestOfTwoDigits ? 3 : mncDigitsOf(mncDigits);
  return Plmn{static_cast<std::int16_t>(*country), static_cast<std::int16_t>(*network),
              static_cast<std::int8_t>(digits)};
}

std::optional<Plmn> plmnOf(std::span<const std::uint8_t> encoded) {
  constexpr std::size_t kSize = 3;
  constexpr unsigned kNoThirdDigit = 0xF;
  if (encoded.size() != kSize) return std::nullopt;
  const auto low = [&](std::size_t index) { return encoded[index] & 0xFU; };
  const auto high = [&](std::size_t index) { return encoded[index] >> 4U & 0xFU; };
  const std::array country{low(0), high(0), low(1)};
  const std::array network{low(2), high(2), high(1)};
  const std::size_t mncDigits = network.back() == kNoThirdDigit ? 2 : 3;
  const auto mcc = numberOf(country);
  const auto mnc = numberOf(std::span(network).first(mncDigits));
  if (!mcc || !mnc) return std::nullopt;
  return Plmn{*mcc, *mnc, static_cast<std::int8_t>(mncDigits)};
}

std::optional<Plmn> encodedPlmnOf(const Dictionary& record) {
  const Value* encoded = record.find("encoded_plmn"_text);
  const Data* data = encoded == nullptr ? nullptr : encoded->data();
  return data == nullptr ? std::nullopt : plmnOf(data->bytes());
}

std::string textOf(const Plmn& plmn) {
  return codeText(plmn.mcc, 3) + "-" + codeText(plmn.mnc, plmn.mncDigits);
}

std::string textOf(const AreaIdentity& area) {
  std::string text = textOf(area.plmn) + " " + std::to_string(area.code);
  if (area.routingCode) text += " " + std::to_string(*area.routingCode);
  return text;
}

int mncDigitsOf(const Value* mncDigits) {
  return mncDigits != nullptr && mncDigits->integer() == 3 ? 3 : 2;
}

std::string codeText(std::int64_t code, int digits) {
  std::string out = std::to_string(code);
  const auto width = static_cast<std::size_t>(digits);
  if (out.size() < width) out.insert(0, width - out.size(), '0');
  return out;
}

}  // namespace vesk::insight
