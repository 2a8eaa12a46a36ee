#include "intake/metric_validator.h"

#include <cstdlib>
#include <ctime>
#include <gtest/gtest.h>
#include <set>
#include <string>
#include <vector>

#include "messages/registry/metric_classes.h"
#include "support/bytes.h"
#include "support/metric_events.h"
#include "support/recorded_output.h"
#include "values/text_form.h"

namespace vesk {
namespace {

using Lines = std::vector<std::string>;

class Intake : public testing::Test {
 protected:
  Intake() {
    setenv("TZ", "UTC", 1);
    tzset();
  }

  void take(std::int64_t metric, std::string_view payload) {
    EXPECT_TRUE(intake->validateMetric(metricEvent(metric, Data::copy(bytesOf(payload)))));
  }

  RecordedOutput output;
  std::shared_ptr<MetricValidator> intake = MetricValidator::listeningTo(nullptr);
  Stores& stores = intake->stores;
};

/// The lists of all stores but those that still wait, a line each.
std::string listsOf(const Stores& stores) {
  std::string out;
  visitTechnologyFields(stores, [&](std::string_view name, const auto& field) {
    if constexpr (std::is_same_v<decltype(field), const RecordList&>) {
      if (field == waitingForUpdate()) return;
      out += std::string(name) + ":";
      for (const Record& record : field)
        out += " " + textOf(record);
      out += '\n';
    }
  });
  return out;
}

TEST_F(Intake, TakesEachMetricByItsClassIntoItsRecordUnderItsText) {
  struct Row {
    std::int64_t metric;
    std::string_view className;
    std::string_view record;
    std::string_view text;
  };
  const std::vector<Row> rows{
      {0x3C4E18, "KCellularLteCdrxConfig", "myLTECDRXConfigDict", "Current CDRX Config is "},
      {0x3C4E04, "KCellularLteRrcState", "myLTERRCStateDict", "Current RRC state is "},
      {0x3C40C2, "KCellularLteScellInfo", "myLTESCellInfoDict", "Current Serving Cell Info is "},
      {0x3CD30E, "KCellularLteSelReselCellInfo", "myLTESelReselDict", "Received LTE Cell Resel Info is "},
      {0x3CD302, "KCellularLteTxPower", "myLTETxPowerDict", "Received LTE Tx Power is "},
      {0x3C4F6A, "KCellularLteRsrpRsrqSinr", "myLTERsrpRsrqSinrDict", "Received RSRP RSRQ SINR is : "},
      {0x3CD30B, "KCellularLteComponentCarrierInfo", "myLTECompCarrDict", "Received Component Carrier info is "},
      {0x3CD313, "KCellularLteCarrierAggregationStatus", "myLTECAStatusDict", "Received CA Status Dict is "},
      {0x3CD310, "KCellularLteNbrInterRatCellMeas", "myLTEInterRatMeasDict", "Received LTE InterRat Meas Info is "},
      {0x3CD30F, "KCellularLteNbrEutraCellMeas", "myLTEIntraRatMeasDict", "Received LTE IRAT Meas is "},
      {0x3CD509, "KCellularMmCommonInfo", "myCellularMMCommonInfoDict", "Received MM Common Info Dict is : "},
      {0x3CD50D, "KCellularActivatedBearerContexts", "myCellularActiveBearerDict", "Received Bearer Context Info is "},
      {0x3CD50C, "KCellularEmmContext", "myLTEEMMContextDict", "Received EMM Context is "},
      {0x3CD50A, "KCellularMmContext", "myMMContextDict", "Received MM Context Info is "},
      {0x3CD50B, "KCellularGmmContext", "myGMMContextDict", "Received GMM Context Info is "},
      {0x3CD112, "KCellularWcdmaRrcConnectionState", "myUMTSRRCStateDict", "Received UMTS RRC Connection State is "},
      {0x3CD113, "KCellularWcdmaRrcConfiguration", "myUMTSRRCConfigDict", "Received UMTS RRC Configuration is "},
      {0x3C300C, "KCellularWcdmaCellInfo", "myUMTSCellInfoDict", "Received UMTS Serving Cell Info is "},
      {0x3CD102, "KCellularWcdmaScellMeasurement", "myUMTSCellMeasDict", "Received UMTS Serving Cell Meas is "},
      {0x3CD103, "KCellularWcdmaTxPower", "myUMTSTxPowerDict", "Received Tx Power is "},
      {0x3CD104, "KCellularWcdmaSelReselCellInfo", "myUMTSSelReselDict", "Received UMTS Cell Resel Info is "},
      {0x3CD105, "KCellularWcdmaNbrCellMeas", "myUMTSNbrMeasDict", "Received UMTS InterRat Meas Info is "},
      {0x3C2E0C, "KCellularGsmScellInfo", "myGSMScellInfoDict", "Received GSM Serving Cell Info "},
      {0x3CD001, "KCellularGsmIdleConfig", "myGSMIdleConfigInfoDict", "Received GSM Idle Config Info is "},
      {0x3CD002, "KCellularGsmIdleScellMeasurement", "myGSMIdleScellMeasDict",
       "Received GSM Idle Serving Cell Meas Info is "},
      {0x3CD003, "KCellularGsmCsRfMeasurement", "myGSMConnRfMeasDict",
       "Received GSM Connected Serving Cell Meas Info is "},
      {0x3CD009, "KCellularGsmGrrEventMeasCr", "myGSMNbrMeasDict", "Received GSM Nbr Cell Meas Info is "},
      {0x3CD00C, "KCellularGsmGprsConfig", "myGSMGPRSConfigDict", "Received GSM GPRS Config Info is "},
      {0x3C0013, "KCellularSimCardFiles", "mySIMFileInfoDict", "Received SIM Card File Info is "},
  };
  std::set<std::string_view> filled;
  for (const Row& row : rows) {
    SCOPED_TRACE(row.className);
    const MetricClass* metricClass = findMetricClass(row.metric);
    ASSERT_NE(metricClass, nullptr);
    EXPECT_EQ(metricClass->name, row.className);
    const RecordedOutput printed;
    // A timestamp of 2000 ms, which all have as their first field.
    EXPECT_TRUE(intake->validateMetric(metricEvent(row.metric, Data::copy(bytesOf("08 D0 0F")))));
    const std::string keepsNumber =
        row.record == "myLTESelReselDict" || row.record == "myLTERsrpRsrqSinrDict" ? "2000" : "";
    const bool printsFirst = !keepsNumber.empty() || row.record == "myCellularActiveBearerDict";
    const std::string shownDate = printsFirst ? "2000" : "1970-01-01 00:00:02 UTC";
    EXPECT_TRUE(printed.lines().at(1).starts_with(std::string(row.text) + " {timestamp: " + shownDate))
        << printed.lines().at(1);
    visitLatestRecords(stores, [&](std::string_view name, const LatestRecord& record) {
      if (!record || !filled.insert(name).second) return;
      EXPECT_EQ(name, row.record);
      EXPECT_EQ(textOf(*record->find("timestamp")), keepsNumber.empty() ? "1970-01-01 00:00:02 UTC" : keepsNumber);
    });
    EXPECT_TRUE(filled.contains(row.record));
  }
  EXPECT_EQ(filled.size(), rows.size());
  EXPECT_FALSE(stores.myLTESCellMeasDict.has_value());
}

TEST_F(Intake, PrintsThatAMetricWasValidAndThatNothingElseMatters) {
  intake->metricsDidUpdate(metricEvent(K_LTE_RRC_STATE, Data::copy(bytesOf("10 03"))));
  intake->eventsDidUpdate(Dictionary{{"kKeyMetricID"_text, K_LTE_RRC_STATE}});
  intake->metricsDidUpdate(std::nullopt);
  EXPECT_EQ(output.lines(), (Lines{
                                "Metric ID in Hex =  3C4E04",
                                "Current RRC state is  {state: KLTE_RRC_STATE_CONNECTED}",
                                "Received Valid Metric",
                                "I dont care for events",
                                "I dont care for this Metric",
                            }));
}

TEST_F(Intake, PassesOverWhatItCannotTake) {
  struct Row {
    std::string_view what;
    Dictionary event;
    std::string_view identifier;
  };
  const std::vector<Row> rows{
      {"known but not handled", metricEvent(K_LTE_RLF, Data()), "3C4E25"},
      {"known, with a class, but not handled", metricEvent(K_LTE_SCELL_MEAS, Data()), "3CD301"},
      {"between the known ones", metricEvent(K_LTE_RRC_STATE + 1, Data()), "3C4E05"},
      {"one digit", metricEvent(7, Data()), " 7"},
      {"negative", metricEvent(-1, Data()), "FFFFFFFFFFFFFFFF"},
      {"no identifier", {{"kKeyPayload"_text, Data()}}, ""},
      {"identifier of another type", {{"kKeyMetricID"_text, "3952132"_text}}, ""},
      {"a boolean is no identifier", {{"kKeyMetricID"_text, true}}, ""},
      {"undecodable", metricEvent(K_LTE_RRC_STATE, Data::copy(bytesOf("08"))), "3C4E04"},
  };
  for (const Row& row : rows) {
    SCOPED_TRACE(row.what);
    const RecordedOutput printed;
    EXPECT_FALSE(intake->validateMetric(row.event));
    Lines expected{"I dont care for this Metric"};
    if (!row.identifier.empty())
      expected.insert(expected.begin(), "Metric ID in Hex =  " + std::string(row.identifier));
    EXPECT_EQ(printed.lines(), expected);
  }
  EXPECT_EQ(stores, Stores{});
  EXPECT_EQ(listsOf(stores), "");
  EXPECT_EQ(stores.myLTE.IMSI, Value("Come Back Later"_text));
}

TEST_F(Intake, AnEventWithoutBytesIsAnEmptyMessage) {
  EXPECT_TRUE(intake->validateMetric({{"kKeyMetricID"_text, K_GSM_CS_RF_MEAS}}));
  EXPECT_EQ(stores.myGSMConnRfMeasDict, (Dictionary{{"cs_tx_pwr"_text, Array{}}}));
  EXPECT_TRUE(intake->validateMetric({{"kKeyMetricID"_text, K_LTE_RRC_STATE}, {"kKeyPayload"_text, "text"_text}}));
  EXPECT_EQ(stores.myLTERRCStateDict, Dictionary{});
}

TEST_F(Intake, ANewRecordReplacesTheOldOneWhole) {
  take(K_LTE_CDRX_CONFIG, "08 FF FF FF FF FF FF FF FF FF 01");
  EXPECT_NE(stores.myLTECDRXConfigDict->find("timestamp")->text(), nullptr) << "there is a date for every number";
  take(K_LTE_CDRX_CONFIG, "38 C0 02");
  EXPECT_EQ(stores.myLTECDRXConfigDict, (Dictionary{{"long_drx_cycle_ms"_text, 320}}));
}

TEST_F(Intake, ChangesRecordsInPlace) {
  take(K_LTE_SCELL_INFO, "28 07 30 FF FF FF FF 0F");
  EXPECT_EQ(output.lines().back(), "Current Serving Cell Info is  {dl_bw: 3, ul_bw: 4294967295}");
  take(K_LTE_EMM_CTXT, "2A 02 10 07 32 02 10 0C");
  EXPECT_EQ(*stores.myLTEEMMContextDict->find("guti"), Value("{mmec: 12}"_text));
  EXPECT_EQ(*stores.myLTEEMMContextDict->find("tai_list"), Value("[{tac: 7}]"_text));
}

TEST_F(Intake, RefreshesTheSelectionParameters) {
  take(K_LTE_SEL_RESEL_INFO, "08 E8 07 12 02 01 07 58 7B");
  EXPECT_EQ(*stores.myLTESelReselDict->find("multi_band_info"), Value("[1, 7]"_text));
  EXPECT_NE(output.lines().at(1).find("multi_band_info: [1, 7]"), std::string::npos);
  EXPECT_EQ(output.lines().at(2), "[1, 7]");
  EXPECT_EQ(textOf(stores.myLTE.SelReselCellInfo),
            "{timestamp: 1970-01-01 00:00:01 UTC, ims_emergency_support: , ac_barring_for_emergency: , "
            "mo_signalling_ac_barring_factor: , mo_signalling_ac_barring_time: , "
            "mo_signalling_ac_barring_for_special_ac: , mo_data_ac_barring_factor: , mo_data_ac_barring_time: , "
            "mo_data_ac_barring_for_special_ac: , QRxLevMin: -62, QQualMin: , Q_hyst: , S_non_intra_search_P: , "
            "S_non_intra_search_Q: , S_intra_search_P: , S_intra_search_Q: , Thresh_serving_lowP: , "
            "Thresh_serving_lowQ: , priority_operating_freq: , multi_band_info: [1, 7]}");
  take(K_LTE_SEL_RESEL_INFO, "");
  EXPECT_EQ(*stores.myLTE.SelReselCellInfo.find("QRxLevMin"), Value(""_text));
  take(K_UMTS_SEL_RESEL_INFO, "08 E8 07 50 05");
  EXPECT_EQ(textOf(stores.myUMTS.SelReselCellInfo),
            "{timestamp: 1970-01-01 00:00:01 UTC, ims_emergency_support: , hsdpa_capable: , edch_capable: , "
            "duplex_mode: , cell_barred: , fach_meas_occ_info_present: , s_rxlev: , s_qual: -3, s_intrasearch: , "
            "s_intersearch: , s_search_rat: , s_cell_prio: , multi_band_info: []}");
}

TEST_F(Intake, LiftsListsIntoTheirStoresWithUnitsAndDates) {
  struct Row {
    std::int64_t metric;
    std::string_view payload;
    std::string_view lists;
  };
  const std::vector<Row> rows{
      {K_LTE_SEL_RESEL_INFO, "08 E8 07 AA 01 02 30 00 AA 01 02 30 04 AA 01 02 30 06 AA 01 06 30 FF FF FF FF 0F",
       "EutraNbrs: {dl_bw: 1.4, timestamp: 1970-01-01 00:00:01 UTC} {dl_bw: 15.0, timestamp: 1970-01-01 00:00:01 UTC} "
       "{timestamp: 1970-01-01 00:00:01 UTC} {dl_bw: 4294967295, timestamp: 1970-01-01 00:00:01 UTC}\n"},
      {K_LTE_SEL_RESEL_INFO, "AA 01 00", "EutraNbrs: {timestamp: }\n"},
      {K_LTE_RSRP_RSRQ_SINR, "08 E8 07 7A 04 50 0D 58 08 7A 08 20 BD 01 50 82 80 80 10",
       "RsrpRsrqSinr: {sinr0: -3.5, sinr1: 2.0, timestamp: 1970-01-01 00:00:01 UTC} {rsrp0: -95, sinr0: 16777217, "
       "timestamp: 1970-01-01 00:00:01 UTC}\n"},
      {K_LTE_RSRP_RSRQ_SINR, "7A 00", "RsrpRsrqSinr: {}\n"},
      {K_LTE_TX_POWER, "08 E8 07 12 02 10 17", "TxPower: {pusch_tx_power: -12, timestamp: 1970-01-01 00:00:01 UTC}\n"},
      {K_LTE_INTRARAT_MEAS, "12 04 20 5A 28 00", "EutraNbrsMeas: {nbr_rsrp: -95, nbr_rsrq: -19.5}\n"},
      {K_LTE_INTERRAT_MEAS, "12 04 18 09 20 31 1A 02 18 3F",
       "UtraNbrsMeas: {rscp: -121, ecno: 0.0}\n"
       "GeraNbrsMeas: {rxlev: -47}\n"},
      {K_LTE_CA_STATUS, "12 0B 30 05 58 A1 0C 60 B3 10 70 8E 03 12 02 30 06",
       "CAStatusList: {dl_bandwidth: 20.0, rsrp: -7, rsrq: -10.5, rssi: 1} {}\n"},
      {K_UMTS_SCELL_MEAS, "10 01 1A 00", "rXInfo: {connected_mode: true}\n"},
      {K_UMTS_SCELL_MEAS, "08 E8 07 1A 00", "rXInfo: {timestamp: 1970-01-01 00:00:01 UTC}\n"},
      {K_UMTS_TX_POWER, "12 02 10 19", "TxPower: {pusch_tx_power: -13}\n"},
      {K_UMTS_SEL_RESEL_INFO, "08 E8 07 B2 01 03 08 BA 0E BA 01 03 08 C2 52 C2 01 03 08 CF 07",
       "eUtraNbrs: {earfcn: 1850, timestamp: 1970-01-01 00:00:01 UTC}\n"
       "utraNbrs: {uarfcn: 10562, timestamp: 1970-01-01 00:00:01 UTC}\n"
       "geraNbrs: {arfcn: 975, timestamp: 1970-01-01 00:00:01 UTC}\n"},
      {K_UMTS_NCELL_MEAS, "12 04 20 00 28 20 1A 02 18 3E 22 05 20 C2 01 28 44",
       "eUtraNbrMeas: {rsrp: -43, rsrq: -2.5}\n"
       "utraNbrMeas: {ecno: -24.5, rscp: -100}\n"
       "geraNbrMeas: {rxlev: -48}\n"},
      {K_GSM_NCELL_MEAS, "12 02 38 3D 1A 04 20 1E 28 14 22 04 18 60 28 21",
       "eUtraNbrMeas: {rsrp: -44, rsrq: -3.0}\n"
       "utraNbrMeas: {cpich_rscp: -86, cpich_ecn0: -14.5}\n"
       "geraNbrMeas: {rxlev: -49}\n"},
      {K_CELLULAR_ACTIVE_BEARER, "08 E8 07 1A 05 1A 03 6E 65 74",
       "activeBearer: {apn: net, timestamp: 1970-01-01 00:00:01 UTC}\n"},
      {K_SIM_FILE_INFO, "12 03 12 01 98", "simContents: {content: 0x98}\n"},
      {K_UMTS_SCELL_MEAS, "10 01", ""},
  };
  for (const Row& row : rows) {
    stores = {};
    take(row.metric, row.payload);
    EXPECT_EQ(listsOf(stores), row.lists) << row.payload;
  }
  take(K_UMTS_SCELL_MEAS, "1A 00");
  take(K_UMTS_SCELL_MEAS, "");
  EXPECT_EQ(listsOf(stores), "rXInfo: {}\n") << "no list leaves the store as it was";
  take(K_LTE_CA_STATUS, "12 02 30 05");
  EXPECT_EQ(textOf(*stores.myLTECAStatusDict), "{scc_list: [{dl_bandwidth: 5}]}") << "as the handset reported it";
}

}  // namespace
}  // namespace vesk
