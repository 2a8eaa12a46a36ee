#include <gtest/gtest.h>

#include "messages/registry/metric_classes.h"
#include "messages/registry/metric_utility.h"
#include "support/bytes.h"
#include "support/recorded_log.h"
#include "values/text_form.h"

namespace vesk {
namespace {

struct Metric {
  std::int64_t id;
  /// Empty where no class decodes the metric.
  std::string_view className;
};

constexpr Metric kMetrics[] = {
    {19, "KCellularSimCardFiles"},
    {11788, "KCellularGsmScellInfo"},
    {12300, "KCellularWcdmaCellInfo"},
    {16578, "KCellularLteScellInfo"},
    {19972, "KCellularLteRrcState"},
    {19992, "KCellularLteCdrxConfig"},
    {20005, ""},
    {20330, "KCellularLteRsrpRsrqSinr"},
    {53249, "KCellularGsmIdleConfig"},
    {53250, "KCellularGsmIdleScellMeasurement"},
    {53251, "KCellularGsmCsRfMeasurement"},
    {53257, "KCellularGsmGrrEventMeasCr"},
    {53260, "KCellularGsmGprsConfig"},
    {53506, "KCellularWcdmaScellMeasurement"},
    {53507, "KCellularWcdmaTxPower"},
    {53508, "KCellularWcdmaSelReselCellInfo"},
    {53509, "KCellularWcdmaNbrCellMeas"},
    {53522, "KCellularWcdmaRrcConnectionState"},
    {53523, "KCellularWcdmaRrcConfiguration"},
    {54017, "KCellularLteServingCellMeasurement"},
    {54018, "KCellularLteTxPower"},
    {54027, "KCellularLteComponentCarrierInfo"},
    {54030, "KCellularLteSelReselCellInfo"},
    {54031, "KCellularLteNbrEutraCellMeas"},
    {54032, "KCellularLteNbrInterRatCellMeas"},
    {54035, "KCellularLteCarrierAggregationStatus"},
    {54537, "KCellularMmCommonInfo"},
    {54538, "KCellularMmContext"},
    {54539, "KCellularGmmContext"},
    {54540, "KCellularEmmContext"},
    {54541, "KCellularActivatedBearerContexts"},
};

TEST(MetricRegistry, KnowsTheMetricsAndTheirClasses) {
  const RecordedLog log;
  const Metric* next = kMetrics;
  for (std::int64_t id = 0; id <= 0x10000; ++id) {
    const bool isMetric = next != std::end(kMetrics) && next->id == id;
    ASSERT_EQ(KBBMetricUtility::isValidMetricIdTag(static_cast<std::uint64_t>(id), "NbrEutra"), isMetric) << id;
    const MetricClass* found = findMetricClass(0x3C0000 + id);
    ASSERT_EQ(found == nullptr ? "" : found->name, isMetric ? next->className : "") << id;
    if (isMetric) ++next;
  }
  EXPECT_EQ(log.lines(), std::vector<std::string>(std::size(kMetrics), "valid metricId tag"));
}

TEST(MetricRegistry, HasNoClassForAnIdentifierInAnotherForm) {
  for (const std::int64_t id : {0x4E04L, 0x3D4E04L, 0x1003C4E04L, -0x3C4E04L})
    EXPECT_EQ(findMetricClass(id), nullptr) << id;
}

TEST(MetricRegistry, DecodesAPayloadIntoItsFields) {
  const MetricClass* metric = findMetricClass(0x3C4E04);
  EXPECT_EQ(textOf(*metric->decode(bytesOf("10 03"))), "{state: KLTE_RRC_STATE_CONNECTED}");
  EXPECT_EQ(textOf(*metric->decode({})), "{}");
  EXPECT_EQ(metric->decode(bytesOf("10")), std::nullopt);
}

}  // namespace
}  // namespace vesk
