#include "insight/channels.h"

#include <gtest/gtest.h>
#include <optional>

namespace vesk::insight {

namespace {

struct LteCase {
  std::int64_t earfcn;
  int band;
  int downlink;
  std::optional<int> uplink;
  Duplex duplex;
};

TEST(LteChannels, FrequenciesFromTheBandOfTheEarfcn) {
  constexpr LteCase kCases[] = {
      {0, 1, 21100, 19200, Duplex::FDD},
      {5815, 17, 7425, 7125, Duplex::FDD},
      {850, 2, 19550, 18750, Duplex::FDD},
      {2000, 4, 21150, 17150, Duplex::FDD},
      {1673, 3, 18523, 17573, Duplex::FDD},
      {6200, 20, 7960, 8370, Duplex::FDD},
      {38098, 38, 26048, 26048, Duplex::TDD},
      {37900, 38, 25850, 25850, Duplex::TDD},
      {9660, 29, 7170, std::nullopt, Duplex::SDL},
      // The downlink goes on where the uplink has ended.
      {67135, 66, 21799, 17799, Duplex::FDD},
      {67136, 66, 21800, std::nullopt, Duplex::FDD},
      {60254, 53, 24949, 24949, Duplex::TDD},
      {70645, 88, 4269, 4169, Duplex::FDD},
  };
  for (const auto& [earfcn, number, downlink, uplink, duplex] : kCases) {
    SCOPED_TRACE(earfcn);
    const LteBand* band = lteBandOfDownlink(earfcn);
    ASSERT_NE(band, nullptr);
    EXPECT_EQ(band->number, number);
    EXPECT_EQ(band->downlink.frequencyOf(earfcn), downlink);
    EXPECT_EQ(band->uplinkFrequencyOf(earfcn), uplink);
    EXPECT_EQ(band->duplex, duplex);
    EXPECT_EQ(findLteBand(number), band);
  }
}

TEST(LteChannels, NumbersOutsideOfTheBandsHaveNone) {
  for (const std::int64_t earfcn : {std::int64_t{-1}, std::int64_t{5380}, std::int64_t{10360}, std::int64_t{60255},
                                    std::int64_t{70646}, INT64_MAX, INT64_MIN})
    EXPECT_EQ(lteBandOfDownlink(earfcn), nullptr) << earfcn;
  EXPECT_EQ(lteBandOfUplink(17999), nullptr);
  EXPECT_EQ(lteBandOfUplink(0), nullptr);
  EXPECT_EQ(lteBandOfUplink(23849)->number, 17);
  EXPECT_EQ(lteBandOfUplink(38098)->number, 38);
  EXPECT_EQ(findLteBand(15), nullptr);
}

void expectChannel(const std::optional<Channel>& channel, std::string_view band, int downlink, int uplink) {
  ASSERT_TRUE(channel);
  EXPECT_EQ(channel->band, band);
  EXPECT_EQ(channel->downlink, downlink);
  EXPECT_EQ(channel->uplink, uplink);
}

TEST(UmtsChannels, FrequenciesFromTheFirstBandThatHasTheNumber) {
  expectChannel(umtsChannel(10637), "I", 21274, 19374);
  expectChannel(umtsChannel(2947), "VIII", 9294, 8844);
  expectChannel(umtsChannel(9788), "II", 19576, 18776);
  expectChannel(umtsChannel(412), "II", 19325, 18525);
  expectChannel(umtsChannel(1037), "V", 8775, 8325);
  expectChannel(umtsChannel(4400), "V", 8800, 8350);
  expectChannel(umtsChannel(4017), "XIII", 7484, 7794);
  expectChannel(umtsChannel(6067), "XXVI", 8875, 8425);
  for (const std::int64_t uarfcn : {0, 413, 1013, 3967, 10561, 10839, -1})
    EXPECT_FALSE(umtsChannel(uarfcn)) << uarfcn;
}

TEST(GsmChannels, TheIndicatedBandDecidesTheSharedNumbers) {
  const auto dcs = SharedGsmBand::dcs1800;
  const auto pcs = SharedGsmBand::pcs1900;
  expectChannel(gsmChannel(60, std::nullopt), "P-GSM 900", 9470, 9020);
  expectChannel(gsmChannel(0, pcs), "E-GSM 900", 9350, 8900);
  expectChannel(gsmChannel(1023, std::nullopt), "E-GSM 900", 9348, 8898);
  expectChannel(gsmChannel(438, std::nullopt), "GSM 750", 7472, 7772);
  expectChannel(gsmChannel(562, dcs), "DCS 1800", 18152, 17202);
  expectChannel(gsmChannel(562, pcs), "PCS 1900", 19402, 18602);
  expectChannel(gsmChannel(811, std::nullopt), "DCS 1800", 18650, 17700);
  EXPECT_FALSE(gsmChannel(811, pcs));
  EXPECT_FALSE(gsmChannel(811, std::nullopt)->otherwise);
  expectChannel(gsmChannel(562, std::nullopt), "DCS 1800", 18152, 17202);
  expectChannel(gsmChannel(562, std::nullopt)->otherwise, "PCS 1900", 19402, 18602);
  for (const std::int64_t arfcn : {-1, 125, 127, 252, 294, 437, 886, 954, 1024})
    EXPECT_FALSE(gsmChannel(arfcn, std::nullopt)) << arfcn;
}

}  // namespace

}  // namespace vesk::insight
