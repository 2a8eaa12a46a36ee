#include "insight/plmn.h"

#include <array>

namespace vesk::insight {

namespace {

constexpr std::int64_t kHighestCode = 999;

std::optional<std::int64_t> codeOf(const Value* value) {
  const std::optional<std::int64_t> code = value == nullptr ? std::nullopt : value->integer();
  return code && *code >= 0 && *code <= kHighestCode ? code : std::nullopt;
}

}  // namespace

std::optional<std::string> plmnText(const Value* mcc, const Value* mnc, const Value* mncDigits) {
  const std::optional<std::int64_t> country = codeOf(mcc);
  const std::optional<std::int64_t> network = codeOf(mnc);
  if (!country || !network) return std::nullopt;
  return codeText(*country, 3) + "-" + codeText(*network, mncDigitsOf(mncDigits));
}

std::optional<std::string> plmnText(std::span<const std::uint8_t> encoded) {
  constexpr std::size_t kSize = 3;
  constexpr unsigned kNoThirdDigit = 0xF;
  if (encoded.size() != kSize) return std::nullopt;
  const auto low = [&](std::size_t index) { return encoded[index] & 0xFU; };
  const auto high = [&](std::size_t index) { return encoded[index] >> 4U & 0xFU; };
  const std::array digits{low(0), high(0), low(1), low(2), high(2), high(1)};
  const std::size_t count = digits.back() == kNoThirdDigit ? digits.size() - 1 : digits.size();
  std::string out;
  for (std::size_t index = 0; index < count; ++index) {
    if (digits[index] > 9) return std::nullopt;
    if (index == 3) out += '-';
    out += static_cast<char>('0' + digits[index]);
  }
  return out;
}

std::optional<std::string> encodedPlmnText(const Dictionary& record) {
  const Value* encoded = record.find("encoded_plmn");
  const Data* data = encoded == nullptr ? nullptr : encoded->data();
  return data == nullptr ? std::nullopt : plmnText(data->bytes());
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
