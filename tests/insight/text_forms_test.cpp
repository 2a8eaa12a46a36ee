#include "insight/text_forms.h"

#include <cstdint>
#include <gtest/gtest.h>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "insight/enumeration_names.h"
#include "insight/plmn.h"

namespace vesk::insight {

namespace {

using Bytes = std::vector<std::uint8_t>;

TEST(TextForms, NumbersAreRoundedToTwoDecimalsWithoutTrailingZeros) {
  for (const auto& [number, text] : {std::pair{-96.0, "-96"},
                                     {-12.5, "-12.5"},
                                     {double{-9.85F}, "-9.85"},
                                     {100.0, "100"},
                                     {-0.001, "0"},
                                     {0.125001, "0.13"},
                                     {1e20, "100000000000000000000"}})
    EXPECT_EQ(numberText(number), text);
  EXPECT_EQ(megahertzText(7425), "742.5");
  EXPECT_EQ(megahertzText(19550), "1955.0");
}

TEST(TextForms, DurationsAreCut) {
  for (const auto& [milliseconds, text] : {std::pair{std::uint64_t{0}, "0 ms"},
                                           {999, "999 ms"},
                                           {1000, "1.0 s"},
                                           {4799, "4.7 s"},
                                           {59999, "59.9 s"},
                                           {60000, "1 min 00 s"},
                                           {723999, "12 min 03 s"},
                                           {3600000, "1 h 00 min"},
                                           {3779999, "1 h 02 min"},
                                           {86399999, "23 h 59 min"},
                                           {159000000, "1 d 20 h"}})
    EXPECT_EQ(durationText(milliseconds), text);
}

TEST(EnumerationNames, LoseTheirPrefix) {
  EXPECT_EQ(shortName("KLTE_RRC_CAUSE_EST_MO_DATA"), "EST_MO_DATA");
  EXPECT_EQ(shortName("STATUS_UPDATED"), "UPDATED");
  EXPECT_EQ(shortName("DEDICATED_STATE"), "DEDICATED_STATE");
  EXPECT_EQ(shortName("(unknown: 77)"), "(unknown: 77)");
  EXPECT_EQ(causeCode("EMM_CAUSE_NO_SUITABLE_CELLS_IN_TRACKING_AREA"), 15);
  EXPECT_EQ(causeCode("KNAS_MM_REJ_CAUSE_PROTOCOL_ERROR_UNSPECIFIED"), 111);
  EXPECT_FALSE(causeCode("(unknown: 77)"));
  EXPECT_EQ(bandName(48), "SYS_BAND_GSM_PCS_1900");
  EXPECT_FALSE(bandName(49));
  EXPECT_FALSE(bandName(INT64_MAX));
}

TEST(Plmn, ComesFromNumbersOrThreeBytes) {
  const auto text = [](const std::optional<Plmn>& plmn) { return plmn ? std::optional(textOf(*plmn)) : std::nullopt; };
  const auto ofNumbers = [&](Value mcc, Value mnc, std::optional<Value> digits) {
    return text(plmnOf(&mcc, &mnc, digits ? &*digits : nullptr));
  };
  EXPECT_EQ(ofNumbers(608, 3, std::nullopt), "608-03");
  EXPECT_EQ(ofNumbers(310, 410, 2), "310-410");
  EXPECT_EQ(ofNumbers(1, 1, 3), "001-001");
  EXPECT_FALSE(ofNumbers(1000, 1, 2));
  EXPECT_FALSE(ofNumbers(999, 1000, 3));
  EXPECT_FALSE(ofNumbers(true, 1, 2));

  for (const auto& [bytes, expected] : {std::pair{Bytes{0x64, 0xF0, 0x00}, std::optional<std::string>("460-00")},
                                        {{0x13, 0x00, 0x14}, "310-410"},
                                        {{0x64, 0xF0}, std::nullopt},
                                        {{0xF4, 0xF0, 0x00}, std::nullopt},
                                        {{0x64, 0xA0, 0x00}, std::nullopt}})
    EXPECT_EQ(text(plmnOf(bytes)), expected);
}

}  // namespace

}  // namespace vesk::insight
