#include <gtest/gtest.h>
#include <string>

#include "handset/driven_events.h"

/// Whether what the handset tells is what a network could have, over an hour's drive.
namespace vesk::handset {
namespace {

using namespace metrics;

std::int64_t number(const Dictionary& fields, std::string_view key) {
  const Value* value = fields.find(key);
  return value == nullptr ? -1 : value->integer().value_or(-1);
}

/// The range is that of the standard.
void expectRange(const Dictionary& fields, std::string_view key, std::int64_t least, std::int64_t most) {
  const std::int64_t value = number(fields, key);
  EXPECT_TRUE(least <= value && value <= most) << key << ' ' << value;
}

TEST(ReportedValuesTest, QuantitiesThatBelongTogetherAgree) {
  std::int64_t pci = -1;
  std::int64_t earfcn = -1;
  std::int64_t halfMhz = -1;
  std::int64_t scramblingCode = -1;
  std::int64_t arfcn = -1;
  std::size_t checked = 0;
  for (const HandsetEvent& event : drivenEvents(5, 1200)) {
    const auto fields = fieldsOf(event);
    if (!fields) continue;
    switch (event.id) {
      case kMetricId<KCellularLteScellInfo>:
        pci = number(*fields, "phy_cell_id");
        earfcn = number(*fields, "dl_freq");
        halfMhz = number(*fields, "dl_bw");
        EXPECT_EQ(number(*fields, "ul_freq"), earfcn + 18000);
        expectRange(*fields, "phy_cell_id", 0, 503);
        break;
      case kMetricId<KCellularLteRsrpRsrqSinr>:
        EXPECT_EQ(number(*fields->find("avg_values")->dictionary(), "phy_cell_id"), pci);
        expectRange(*fields->find("avg_values")->dictionary(), "rsrp0", -140, -44);
        EXPECT_EQ(static_cast<std::size_t>(number(*fields, "num_samples")),
                  fields->find("inst_values")->array()->size());
        ++checked;
        break;
      case kMetricId<KCellularLteComponentCarrierInfo>:
        EXPECT_EQ(number(*fields, "pcc_earfcn"), earfcn);
        EXPECT_EQ(2 * number(*fields, "pcc_bandwidth"), halfMhz);
        EXPECT_NE(number(*fields, "scc0_earfcn"), earfcn);
        break;
      case kMetricId<KCellularLteNbrEutraCellMeas>:
        for (const Value& neighbour : *fields->find("meas_nbr_eutra")->array()) {
          EXPECT_FALSE(number(*neighbour.dictionary(), "nbr_phys_cell_id") == pci &&
                       number(*neighbour.dictionary(), "nbr_earfcn") == earfcn);
          expectRange(*neighbour.dictionary(), "nbr_rsrp", 0, 97);
          expectRange(*neighbour.dictionary(), "nbr_rsrq", 0, 34);
        }
        break;
      case kMetricId<KCellularWcdmaCellInfo>:
        scramblingCode = number(*fields, "psc");
        break;
      case kMetricId<KCellularWcdmaNbrCellMeas>:
        if (const Value* neighbours = fields->find("meas_utra_result")) {
          for (const Value& neighbour : *neighbours->array())
            EXPECT_NE(number(*neighbour.dictionary(), "psc"), scramblingCode);
        }
        break;
      case kMetricId<KCellularGsmScellInfo>:
        arfcn = number(*fields, "arfcn");
        break;
      case kMetricId<KCellularGsmIdleScellMeasurement>:
      case kMetricId<KCellularGsmCsRfMeasurement>:
        EXPECT_EQ(number(*fields, "scell_arfcn"), arfcn);
        break;
      default:
        break;
    }
  }
  EXPECT_GT(checked, 500U);
}

}  // namespace
}  // namespace vesk::handset
