#include <gtest/gtest.h>
#include <set>

#include "messages/gsm/gsm.h"
#include "messages/lte/lte.h"
#include "messages/nas/nas.h"
#include "messages/wcdma/wcdma.h"
#include "support/decoded.h"

namespace vesk {
namespace {

using namespace metrics;

TEST(Message, KeepsTheValueOfAScalarThatIsAbsent) {
  EXPECT_EQ(KCellularMmContext().updateStatus(), MmUpdateStatus::STATUS_UPDATED);
  NbrEutra message;
  message.setFrameType(NbrEutra::FrameType::INVALID);
  message.setHasFrameType(false);
  EXPECT_EQ(message.frameType(), NbrEutra::FrameType::FDD) << "the first value stands for an absent one";
  message.setHasFrameType(true);
  EXPECT_EQ(message.frameType(), NbrEutra::FrameType::INVALID);

  message.setEarfcn(1850);
  message.setHasEarfcn(false);
  EXPECT_EQ(message.earfcn(), 1850U);
  EXPECT_EQ(shown(message), "{frame_type: INVALID}");
  EXPECT_EQ(writtenHex(message), "60 02");
}

TEST(Message, HoldsObjectsAndLists) {
  KCellularLteRsrpRsrqSinr message;
  EXPECT_FALSE(message.hasCallId());
  message.setCallId(Text());
  EXPECT_TRUE(message.hasCallId());
  const auto sample = std::make_shared<RsrpRsrqSinr>();
  message.setAvgValues(sample);
  EXPECT_THROW((void)message.instValuesAtIndex(0), std::out_of_range);
  message.addInstValues(sample);
  EXPECT_EQ(message.instValuesAtIndex(0), sample);
  message.clearInstValues();
  EXPECT_EQ(message.instValuesCount(), 0U);
  EXPECT_EQ(shown(message), "{call_id: , avg_values: {}}");

  KCellularLteSelReselCellInfo bands;
  const std::uint32_t values[] = {3, 7};
  bands.setMultiBandInfos(values, 2);
  bands.addMultiBandInfo(9);
  EXPECT_EQ(shown(bands), "{multi_band_info: [3, 7, 9]}");
  bands.clearMultiBandInfos();
  EXPECT_EQ(shown(bands), "{multi_band_info: []}");

  // What the sender counted is one field, what arrived is another.
  const auto bearers = decoded<KCellularActivatedBearerContexts>("10 03 1A 00");
  EXPECT_EQ(bearers->bearerContextCount(), 3U);
  EXPECT_EQ(bearers->bearerContextsCount(), 1U);
}

TEST(Message, CopyToSharesObjectsAndLeavesWhatIsAbsentHere) {
  const auto source = decoded<KCellularLteRsrpRsrqSinr>("08 07 1A 01 61 72 02 08 01 7A 02 08 02");
  const auto target = decoded<KCellularLteRsrpRsrqSinr>("08 06 30 09 72 02 20 01 7A 00 7A 00");
  source->copyTo(*target);
  EXPECT_EQ(shown(*target),
            "{timestamp: 7, call_id: a, last_x_seconds: 9, avg_values: {phy_cell_id: 1}, "
            "inst_values: [{phy_cell_id: 2}]}");
  EXPECT_EQ(target->avgValues(), source->avgValues());
  EXPECT_EQ(target->instValuesAtIndex(0), source->instValuesAtIndex(0));
  const std::string before = shown(*target);
  KCellularLteRsrpRsrqSinr().copyTo(*target);
  EXPECT_EQ(shown(*target), before);
}

TEST(Message, CopyWithZoneSharesNothing) {
  const auto source = decoded<KCellularLteRsrpRsrqSinr>("1A 01 61 72 02 08 01 7A 02 08 02");
  source->setDurationMs(4);
  source->setHasDurationMs(false);
  const auto copy = source->copyWithZone();
  EXPECT_TRUE(copy->isEqual(*source));
  EXPECT_EQ(copy->durationMs(), 4U);
  EXPECT_NE(copy->avgValues(), source->avgValues());
  EXPECT_NE(copy->instValuesAtIndex(0), source->instValuesAtIndex(0));
  copy->avgValues()->setRsrp0(-1);
  copy->instValuesAtIndex(0)->setRsrp0(-1);
  copy->addInstValues(std::make_shared<RsrpRsrqSinr>());
  EXPECT_EQ(shown(*source), "{call_id: a, avg_values: {phy_cell_id: 1}, inst_values: [{phy_cell_id: 2}]}");
}

TEST(Message, MergeFromOverwritesScalarsGrowsListsAndMergesMessages) {
  const auto target = decoded<KCellularLteRsrpRsrqSinr>("08 06 1A 01 61 30 09 72 04 08 01 20 01 7A 00");
  const auto other = decoded<KCellularLteRsrpRsrqSinr>("08 07 1A 01 62 72 04 20 02 28 03 7A 02 08 02");
  const auto ownMean = target->avgValues();
  target->mergeFrom(*other);
  EXPECT_EQ(shown(*target),
            "{timestamp: 7, call_id: b, last_x_seconds: 9, avg_values: {phy_cell_id: 1, rsrp0: 1, rsrp1: -2}, "
            "inst_values: [{}, {phy_cell_id: 2}]}");
  EXPECT_EQ(target->avgValues(), ownMean);
  EXPECT_EQ(target->instValuesAtIndex(1), other->instValuesAtIndex(0));
  KCellularLteRsrpRsrqSinr empty;
  empty.mergeFrom(*other);
  EXPECT_EQ(empty.avgValues(), other->avgValues());
  target->mergeFrom(*target);
  EXPECT_EQ(target->instValuesCount(), 4U);

  const auto bands = decoded<KCellularLteSelReselCellInfo>("12 02 03 07");
  bands->mergeFrom(*decoded<KCellularLteSelReselCellInfo>("12 01 09"));
  EXPECT_EQ(shown(*bands), "{multi_band_info: [3, 7, 9]}");
}

TEST(Message, IsEqualToOneOfItsOwnClassWithTheSameFields) {
  TxPowerInfo one;
  TxPowerInfo other;
  one.setSubframeIndex(5);
  one.setHasSubframeIndex(false);
  EXPECT_TRUE(one.isEqual(other)) << "a value that is not present does not count";
  EXPECT_EQ(one.hash(), other.hash());
  other.setSubframeIndex(0);
  EXPECT_FALSE(one.isEqual(other)) << "a present 0 is not an absent one";
  one.setSubframeIndex(1);
  EXPECT_FALSE(one.isEqual(other));

  EXPECT_FALSE(GsmCellMeasResult().isEqual(EgwErrcNbrGeranMeas())) << "another class with the same fields";

  KCellularLteTxPower never;
  KCellularLteTxPower emptied;
  emptied.addTxPowerInfo(std::make_shared<TxPowerInfo>());
  EXPECT_FALSE(never.isEqual(emptied));
  emptied.clearTxPowerInfos();
  EXPECT_FALSE(never.isEqual(emptied)) << "a list that was never made is not an empty one";
  EXPECT_FALSE(decoded<BearerContext>("1A 00")->isEqual(BearerContext()));
}

TEST(Message, HashesWhatItHolds) {
  std::set<std::uint64_t> hashes;
  const char* const payloads[] = {
      "", "1A 01 61", "1A 01 62", "72 00", "72 02 08 01", "72 02 08 02", "7A 02 08 01", "7A 02 08 01 7A 02 08 02"};
  for (const char* payload : payloads)
    hashes.insert(decoded<KCellularLteRsrpRsrqSinr>(payload)->hash());
  EXPECT_GE(hashes.size(), std::size(payloads) - 1) << "an empty message may hash as none";
}

TEST(Message, HashesAScalarByItsValueIn64Bits) {
  constexpr std::uint64_t kFactor = 2654435761;
  struct Case {
    std::shared_ptr<ProtoCodable> message;
    std::uint64_t hash;
  };
  const Case cases[] = {
      {decoded<TxPowerInfo>("18 FF FF FF FF 0F"), 0xFFFFFFFFULL * kFactor},
      {decoded<TxPowerInfo>("08 01"), std::uint64_t{0} - kFactor},
      {decoded<TxPowerInfo>("08 04 10 06"), (2 * kFactor) ^ (3 * kFactor)},
      {decoded<KCellularLteRrcState>("10 FF FF FF FF 0F"), std::uint64_t{0} - kFactor},
  };
  for (const Case& row : cases)
    EXPECT_EQ(row.message->hash(), row.hash) << row.message->description();
}

}  // namespace
}  // namespace vesk
