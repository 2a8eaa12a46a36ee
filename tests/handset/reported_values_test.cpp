#include <gtest/gtest.h>
#include <map>
#include <string>

#include "handset/driven_events.h"

/// Whether what the handset tells is what a network could have, over an hour's drive.
namespace vesk::handset {
namespace {

using namespace metrics;

struct Range {
  double least;
  double most;
};

/// The ranges of the standards, by field, or by list and field where a name has several meanings.
const std::map<std::string, Range> kRanges = {
    // LTE
    {"phy_cell_id", {0, 503}},
    {"nbr_phys_cell_id", {0, 503}},
    {"pci", {0, 503}},
    {"physical_cell_id", {0, 503}},
    {"KCellularLteScellInfo.cell_id", {1, 0xFFFFFFF}},
    {"dl_bw", {0, 40}},
    {"nbr_eutra.dl_bw", {0, 5}},
    {"dl_bandwidth", {0, 5}},
    {"ul_bandwidth", {0, 5}},
    {"pcc_bandwidth", {5, 20}},
    {"tracking_area_code", {1, 0xFFFD}},
    {"tac", {1, 0xFFFD}},
    {"rsrp0", {-140, -44}},
    {"rsrp1", {-140, -44}},
    {"rsrq0", {-19, -3}},
    {"rsrq1", {-19, -3}},
    {"sinr0", {-40, 60}},
    {"sinr1", {-40, 60}},
    {"nbr_rsrp", {0, 97}},
    {"nbr_rsrq", {0, 34}},
    {"meas_lte_result.rsrp", {0, 97}},
    {"meas_lte_result.rsrq", {0, 34}},
    {"lte_ncell_meas.rsrp", {0, 97}},
    {"lte_ncell_meas.rsrq", {0, 34}},
    {"scc_list.rsrp", {-14000, -4400}},
    {"scc_list.rsrq", {-1950, -300}},
    {"scc_list.rssi", {-11500, -2500}},
    {"rx_info.rssi", {-115, -25}},
    {"rx_info.rsrp_range", {0, 97}},
    {"rx_info.rsrq_range", {0, 49}},
    {"snr", {-20, 30}},
    {"pucch_tx_power", {-50, 24}},
    {"pusch_tx_power", {-50, 24}},
    {"subframe_index", {0, 9}},
    {"QRxLevMin", {-70, -22}},
    {"QQualMin", {-34, -3}},
    {"S_intra_search_P", {0, 31}},
    {"Thresh_serving_lowP", {0, 31}},
    {"priority", {0, 7}},
    {"mo_data_ac_barring_factor", {0, 95}},
    {"mo_data_ac_barring_time", {4, 512}},
    {"transmission_mode", {1, 9}},
    // UMTS
    {"psc", {0, 511}},
    {"cpich_sc", {0, 511}},
    {"uarfcn", {2937, 3088}},
    {"dl_uarfcn", {2937, 3088}},
    {"rscp", {-5, 91}},
    {"cpich_rscp", {0, 91}},
    {"ecno", {0, 49}},
    {"cpich_ecn0", {0, 49}},
    {"s_qual", {-7, 24}},
    {"s_rxlev", {-10, 91}},
    {"prio", {0, 7}},
    // GSM
    {"arfcn", {1, 124}},
    {"scell_arfcn", {1, 124}},
    {"bsic", {0, 63}},
    {"ci", {0, 0xFFFF}},
    {"lac", {1, 0xFFFD}},
    {"rxlev", {0, 63}},
    {"idle_rxlev_dBm", {-110, -47}},
    {"cs_rxlev_sub", {0, 63}},
    {"cs_rxqual_sub", {0, 7}},
    {"cs_tx_pwr", {5, 33}},
    {"radio_link_timeout", {4, 64}},
    // Registration
    {"mmec", {0, 255}},
    {"mmegi", {0x8000, 0xFFFF}},
    {"rac", {0, 255}},
    {"nsapi", {5, 15}},
};

/// Looks at every number of a message and notes which ranges were of use.
class RangeCheck {
 public:
  void check(const std::string& owner, const Dictionary& fields) {
    for (const Dictionary::Entry& entry : fields)
      check(owner, std::string(entry.key.view()), entry.value);
  }
  [[nodiscard]] const std::map<std::string, std::size_t>& uses() const { return uses_; }

 private:
  void check(const std::string& owner, const std::string& key, const Value& value) {
    if (const Dictionary* fields = value.dictionary()) {
      check(key, *fields);
    } else if (const Array* elements = value.array()) {
      for (const Value& element : *elements)
        check(owner, key, element);
    } else if (const auto number = value.number()) {
      auto range = kRanges.find(owner + "." + key);
      if (range == kRanges.end()) range = kRanges.find(key);
      if (range == kRanges.end()) return;
      ++uses_[range->first];
      EXPECT_GE(*number, range->second.least) << owner << "." << key;
      EXPECT_LE(*number, range->second.most) << owner << "." << key;
    }
  }

  std::map<std::string, std::size_t> uses_;
};

std::int64_t number(const Dictionary& fields, std::string_view key) {
  const Value* value = fields.find(key);
  return value == nullptr ? -1 : value->integer().value_or(-1);
}

std::int64_t bandOf(std::int64_t earfcn) {
  if (earfcn < 600) return 1;
  if (earfcn >= 1200 && earfcn < 1950) return 3;
  return earfcn >= 2750 && earfcn < 3450 ? 7 : -1;
}

/// Every (EARFCN, band) pair of a message and its lists.
void expectBandsToFit(const Dictionary& fields) {
  const std::pair<const char*, const char*> pairs[] = {{"dl_freq", "freq_band_ind"},
                                                       {"nbr_earfcn", "freq_band_ind"},
                                                       {"earfcn", "band"},
                                                       {"earfcn", "eutra_band"},
                                                       {"dl_earfcn", "dl_rf_band"}};
  for (const auto& [channel, band] : pairs) {
    if (!fields.contains(channel) || !fields.contains(band)) continue;
    EXPECT_EQ(number(fields, band), bandOf(number(fields, channel)));
  }
  for (const Dictionary::Entry& entry : fields) {
    if (entry.value.array() == nullptr) continue;
    for (const Value& element : *entry.value.array()) {
      if (element.dictionary() != nullptr) expectBandsToFit(*element.dictionary());
    }
  }
}

TEST(ReportedValuesTest, StayWithinTheRangesOfTheStandards) {
  RangeCheck check;
  for (const HandsetEvent& event : drivenEvents(11, 3600)) {
    if (const auto fields = fieldsOf(event)) check.check(std::string(findMetricClass(event.id)->name), *fields);
  }
  // The hour must have shown each of them.
  for (const auto& [name, range] : kRanges)
    EXPECT_TRUE(check.uses().contains(name)) << name << " was never told";
}

TEST(ReportedValuesTest, QuantitiesThatBelongTogetherAgree) {
  std::int64_t pci = -1;
  std::int64_t earfcn = -1;
  std::int64_t halfMhz = -1;
  std::int64_t scramblingCode = -1;
  std::int64_t arfcn = -1;
  std::size_t checked = 0;
  for (const HandsetEvent& event : drivenEvents(5, 3600)) {
    const auto fields = fieldsOf(event);
    if (!fields) continue;
    expectBandsToFit(*fields);
    switch (event.id) {
      case kMetricId<KCellularLteScellInfo>:
        pci = number(*fields, "phy_cell_id");
        earfcn = number(*fields, "dl_freq");
        halfMhz = number(*fields, "dl_bw");
        EXPECT_EQ(number(*fields, "ul_freq"), earfcn + 18000);
        break;
      case kMetricId<KCellularLteRsrpRsrqSinr>:
        EXPECT_EQ(number(*fields->find("avg_values")->dictionary(), "phy_cell_id"), pci);
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
        }
        break;
      case kMetricId<KCellularWcdmaCellInfo>:
        scramblingCode = number(*fields, "psc");
        break;
      case kMetricId<KCellularWcdmaNbrCellMeas>:
        for (const Value& neighbour : *fields->find("meas_gsm_result")->array())
          EXPECT_GE(number(*neighbour.dictionary(), "arfcn"), 1);
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
      case kMetricId<KCellularActivatedBearerContexts>:
        EXPECT_EQ(static_cast<std::size_t>(number(*fields, "bearer_context_count")),
                  fields->find("bearer_contexts")->array()->size());
        break;
      default:
        break;
    }
  }
  EXPECT_GT(checked, 1000U);
}

}  // namespace
}  // namespace vesk::handset
