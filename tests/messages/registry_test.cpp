#include <gtest/gtest.h>

#include "messages/registry/metric_classes.h"
#include "messages/registry/metric_utility.h"
#include "support/bytes.h"
#include "support/recorded_log.h"
#include "values/text_form.h"

namespace vesk {
namespace {

TEST(MetricRegistry, KnowsTheMetricsByTheirTagWhoeverAsks) {
  const RecordedLog log;
  std::size_t known = 0;
  for (std::uint64_t tag = 0; tag <= 0x10000; ++tag) {
    const bool isValid = KBBMetricUtility::isValidMetricIdTag(tag, "NbrEutra");
    known += isValid ? 1 : 0;
    // The failure of a radio link is known, and has no class.
    EXPECT_EQ(isValid && tag != 0x4E25, findMetricClass(0x3C0000 + static_cast<std::int64_t>(tag)) != nullptr) << tag;
  }
  EXPECT_EQ(known, 31U);
  EXPECT_EQ(log.lines(), std::vector<std::string>(known, "valid metricId tag"));
  EXPECT_EQ(findMetricClass(0x3CD301)->name, "KCellularLteServingCellMeasurement");
  for (const std::int64_t otherForm : {0x4E04L, 0x3D4E04L, 0x1003C4E04L, -0x3C4E04L})
    EXPECT_EQ(findMetricClass(otherForm), nullptr) << otherForm;
}

TEST(MetricRegistry, DecodesAPayloadIntoItsFields) {
  const MetricClass* metric = findMetricClass(0x3C4E04);
  EXPECT_EQ(textOf(*metric->decode(bytesOf("10 03"))), "{state: KLTE_RRC_STATE_CONNECTED}");
  EXPECT_EQ(metric->decode(bytesOf("10")), std::nullopt);
}

}  // namespace
}  // namespace vesk
