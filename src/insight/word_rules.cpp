#include <algorithm>
#include <array>
#include <charconv>
#include <span>
#include <string>

#include "insight/enumeration_names.h"
#include "insight/reading_rules.h"

namespace vesk::insight {

namespace {

template <std::size_t size>
Reading wordReading(const std::array<std::string_view, size>& words, std::int64_t code) {
  return {.text = std::string(words[static_cast<std::size_t>(code)])};
}

std::string withoutLeadingZeros(unsigned group) {
  std::array<char, 4> digits{};
  const auto result = std::to_chars(digits.data(), digits.data() + digits.size(), group, 16);
  return {digits.data(), result.ptr};
}

std::string version4Text(std::span<const std::uint8_t> bytes) {
  std::string out;
  for (const std::uint8_t byte : bytes) {
    if (!out.empty()) out += '.';
    out += std::to_string(byte);
  }
  return out;
}

std::string version6Text(std::span<const std::uint8_t> bytes) {
  std::string out;
  for (std::size_t index = 0; index + 1 < bytes.size(); index += 2) {
    if (index != 0) out += ':';
    out += withoutLeadingZeros(static_cast<unsigned>(bytes[index] << 8U | bytes[index + 1]));
  }
  return out;
}

struct SimFile {
  std::int64_t identifier;
  std::string_view name;
};

// clang-format off
constexpr std::array<SimFile, 34> kSimFiles{{
    {0x2F00, "DIR"}, {0x2F05, "PL"}, {0x2FE2, "ICCID"}, {0x6F05, "LI"}, {0x6F06, "ARR"}, {0x6F07, "IMSI"},
    {0x6F08, "Keys"}, {0x6F09, "KeysPS"}, {0x6F31, "HPPLMN"}, {0x6F38, "UST"}, {0x6F3A, "ADN"}, {0x6F3B, "FDN"},
    {0x6F3C, "SMS"}, {0x6F3E, "GID1"}, {0x6F3F, "GID2"}, {0x6F40, "MSISDN"}, {0x6F42, "SMSP"}, {0x6F43, "SMSS"},
    {0x6F46, "SPN"}, {0x6F56, "EST"}, {0x6F5C, "MaxSTART"}, {0x6F60, "PLMNwAcT"}, {0x6F61, "OPLMNwAcT"},
    {0x6F62, "HPLMNwAcT"}, {0x6F73, "PSLOCI"}, {0x6F78, "ACC"}, {0x6F7B, "FPLMN"}, {0x6F7E, "LOCI"}, {0x6FAD, "AD"},
    {0x6FB7, "ECC"}, {0x6FC5, "PNN"}, {0x6FC6, "OPL"}, {0x6FE3, "EPSLOCI"}, {0x6FE4, "EPSNSC"},
}};
constexpr std::array<std::string_view, 10> kTransmissionModeTexts{
    "single antenna",         "transmit diversity",  "open loop MIMO",
    "closed loop MIMO",       "multi-user MIMO",     "closed loop rank 1",
    "beamforming",            "dual layer beamforming", "up to 8 layers",
    "coordinated points"};
/// D: downlink, S: special, U: uplink.
constexpr std::array<std::string_view, 7> kTddSubframeTexts{
    "DSUUUDSUUU", "DSUUDDSUUD", "DSUDDDSUDD", "DSUUUDDDDD", "DSUUDDDDDD", "DSUDDDDDDD", "DSUUUDSUUD"};
/// Symbols of downlink, gap and uplink.
constexpr std::array<std::string_view, 10> kSpecialSubframeTexts{
    "3/10/1", "9/4/1", "10/3/1", "11/2/1", "12/1/1", "3/9/2", "9/3/2", "10/2/2", "11/1/2", "6/6/2"};
constexpr std::array<std::string_view, 8> kBitErrorTexts{
    "BER below 0.2 %", "BER 0.2 to 0.4 %", "BER 0.4 to 0.8 %", "BER 0.8 to 1.6 %",
    "BER 1.6 to 3.2 %", "BER 3.2 to 6.4 %", "BER 6.4 to 12.8 %", "BER above 12.8 %"};
constexpr std::array<std::string_view, 2> kYesTexts{"no", "yes"};
constexpr std::array<std::string_view, 2> kBarredTexts{"not barred", "barred"};
constexpr std::array<std::string_view, 2> kDrxTexts{"released", "set up"};
constexpr std::array<std::string_view, 3> kOperationModeTexts{"NMO I", "NMO II", "NMO III"};
constexpr std::array<std::string_view, 3> kControlOrderTexts{"NC0", "NC1", "NC2"};
// clang-format on

}  // namespace

std::optional<Reading> readName(const ReadingRule& /*rule*/, const Value& value, const Dictionary& /*record*/) {
  const Text* name = value.text();
  if (name == nullptr || isUnknownName(name->view())) return std::nullopt;
  std::string text = withBlanks(shortName(name->view()));
  return text == name->view() ? std::nullopt : std::optional(Reading{.text = std::move(text)});
}

std::optional<Reading> readCause(const ReadingRule& /*rule*/, const Value& value, const Dictionary& /*record*/) {
  const Text* name = value.text();
  const std::optional<std::int32_t> code = name == nullptr ? std::nullopt : causeCode(name->view());
  if (!code) return std::nullopt;
  if (*code == 0) return Reading{.text = "none", .code = 0};
  return Reading{.text = "#" + std::to_string(*code) + " " + withBlanks(shortName(name->view())), .code = code};
}

std::optional<Reading> readAddress(const ReadingRule& /*rule*/, const Value& value, const Dictionary& /*record*/) {
  constexpr std::size_t kVersion4 = 4;
  constexpr std::size_t kInterface = 8;
  constexpr std::size_t kVersion6 = 16;
  const Data* data = value.data();
  if (data == nullptr) return std::nullopt;
  const std::span<const std::uint8_t> bytes = data->bytes();
  switch (bytes.size()) {
    case kVersion4:
      return Reading{.text = version4Text(bytes)};
    case kVersion6:
      return Reading{.text = version6Text(bytes)};
    case kInterface:
      return Reading{.text = "IID " + version6Text(bytes)};
    case kInterface + kVersion4:
      return Reading{.text = "IID " + version6Text(bytes.first(kInterface)) + " " +
                             version4Text(bytes.subspan(kInterface))};
    default:
      return std::nullopt;
  }
}

std::optional<Reading> readNothing(std::int64_t /*code*/) {
  return std::nullopt;
}

std::optional<Reading> readYes(std::int64_t code) {
  return wordReading(kYesTexts, code);
}

std::optional<Reading> readBarred(std::int64_t code) {
  return wordReading(kBarredTexts, code);
}

std::optional<Reading> readDrx(std::int64_t code) {
  return wordReading(kDrxTexts, code);
}

std::optional<Reading> readTransmissionMode(std::int64_t code) {
  Reading reading{.text = "TM" + std::to_string(code) + " "};
  reading.text += kTransmissionModeTexts[static_cast<std::size_t>(code - 1)];
  return reading;
}

std::optional<Reading> readTddSubframes(std::int64_t code) {
  return wordReading(kTddSubframeTexts, code);
}

std::optional<Reading> readSpecialSubframe(std::int64_t code) {
  return wordReading(kSpecialSubframeTexts, code);
}

std::optional<Reading> readSpecialClasses(std::int64_t code) {
  constexpr int kLowestClass = 11;
  constexpr int kClasses = 5;
  std::string text;
  for (int index = 0; index < kClasses; ++index) {
    // The highest bit is the lowest class.
    if ((code >> (kClasses - 1 - index) & 1) != 0) text += std::to_string(kLowestClass + index) + " ";
  }
  return Reading{.text = text.empty() ? "none barred" : text + "barred"};
}

std::optional<Reading> readBitErrors(std::int64_t code) {
  return wordReading(kBitErrorTexts, code);
}

std::optional<Reading> readBandNumber(std::int64_t code) {
  const std::optional<std::string_view> name = bandName(code);
  return name ? std::optional(Reading{.text = withBlanks(shortName(*name))}) : std::nullopt;
}

std::optional<Reading> readSimFile(std::int64_t code) {
  const auto* found =
      std::find_if(kSimFiles.begin(), kSimFiles.end(), [=](const SimFile& file) { return file.identifier == code; });
  if (found == kSimFiles.end()) return std::nullopt;
  return Reading{.text = "EF_" + std::string(found->name)};
}

std::optional<Reading> readOperationMode(std::int64_t code) {
  return wordReading(kOperationModeTexts, code);
}

std::optional<Reading> readControlOrder(std::int64_t code) {
  return wordReading(kControlOrderTexts, code);
}

}  // namespace vesk::insight
