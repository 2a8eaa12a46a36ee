#include <gtest/gtest.h>
#include <map>

#include "diag/layout/lte_bands.h"
#include "diag/translation/log_kind.h"
#include "diag/written_packets.h"

namespace vesk::diag {

TEST(Translator, EachSimHasItsOwnState) {
  constexpr std::uint16_t kState = 0x7131;
  const std::string service = "MmContext{reg_status: KREG_STATUS_NORMAL_SERVICE";
  Translator translator;
  EXPECT_EQ(told(translator, kState, "b0=19 b1=8 b2=255", 1, 1), service + "}");
  EXPECT_EQ(told(translator, kState, "b0=0 b2=0", 2, 2), "MmContext{update_status: STATUS_UPDATED}");
  EXPECT_EQ(told(translator, kState, "b0=0 b2=1", 3, 1), service + ", update_status: STATUS_NOT_UPDATED}");
  // However many SIMs a broken capture names, only so many are remembered.
  for (std::uint32_t sim = 3; sim < 3 + kMostSims - 1; ++sim)
    EXPECT_EQ(told(translator, kState, "b0=0 b2=255", 4, sim), "MmContext{}");
  EXPECT_EQ(told(translator, kState, "b0=0 b2=255", 5, 1), service + ", update_status: STATUS_NOT_UPDATED}");
  EXPECT_EQ(told(translator, kState, "b0=0 b2=255", 5, 2), "MmContext{}");
}

TEST(Translator, KindsAreFoundByTheirCodes) {
  std::uint16_t before = 0;
  for (const LogKind& kind : logKinds()) {
    EXPECT_LT(before, kind.code);
    EXPECT_EQ(findLogKind(kind.code), &kind);
    EXPECT_FALSE(kind.versions().empty()) << kind.name;
    before = kind.code;
  }
  EXPECT_EQ(findLogKind(0), nullptr);
  EXPECT_EQ(findLogKind(0xB194), nullptr);
  EXPECT_EQ(findLogKind(0xFFFF), nullptr);
}

TEST(Translator, APacketSaysItsVersion) {
  const Bytes body{0x83, 1};
  const auto versionOfCode = [&body](std::uint16_t code) { return versionOf({code, 0, 1, body}); };
  EXPECT_EQ(versionOfCode(0xB193), 0x83);
  EXPECT_EQ(versionOfCode(0x4005), 2);
  EXPECT_EQ(versionOfCode(0x5134), std::nullopt);
  EXPECT_EQ(versionOfCode(0xB0E5), 0x83) << "of a kind that is not read";
  EXPECT_EQ(versionOf({0xB193, 0, 1, {}}), std::nullopt);
}

TEST(Translator, ABandIsAsWideAsItsEarfcns) {
  const std::map<std::uint32_t, std::uint32_t> bands{{0, 1},      {599, 1},    {600, 2},    {4749, 10},
                                                     {4949, 11},  {5010, 12},  {10359, 32}, {36000, 33},
                                                     {56739, 48}, {65536, 65}, {68935, 71}};
  for (const auto& [earfcn, band] : bands)
    EXPECT_EQ(lteBandOf(earfcn), band);
  for (const std::uint32_t earfcn : {4950U, 5009U, 10360U, 35999U, 56740U, 65535U, 68936U, ~0U})
    EXPECT_EQ(lteBandOf(earfcn), std::nullopt) << earfcn;
}

}  // namespace vesk::diag
