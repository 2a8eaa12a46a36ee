#include "intake/metric_validator.h"

#include <cstdlib>
#include <ctime>
#include <gtest/gtest.h>
#include <limits>
#include <set>
#include <string>
#include <vector>

#include "messages/gsm/gsm.h"
#include "messages/lte/lte.h"
#include "messages/nas/nas.h"
#include "messages/registry/metric_classes.h"
#include "messages/registry/metric_of_message.h"
#include "messages/wcdma/wcdma.h"
#include "support/bytes.h"
#include "support/metric_events.h"
#include "support/recorded_output.h"
#include "values/text_form.h"

namespace vesk {
namespace {

using namespace metrics;
using Lines = std::vector<std::string>;

/// 2025-07-18 22:12:21 UTC.
constexpr std::uint64_t kInstant = 1752876741000;

class Intake : public testing::Test {
 protected:
  Intake() {
    setenv("TZ", "UTC", 1);
    tzset();
  }

  /// Takes the metric with the fields that `fill` sets.
  template <class Message, class Fill>
  void take(Fill fill) {
    Message message;
    fill(message);
    EXPECT_TRUE(intake->validateMetric(metricEvent(kMetricId<Message>, message)));
  }

  RecordedOutput output;
  std::shared_ptr<MetricValidator> intake = MetricValidator::listeningTo(nullptr);
  Stores& stores = intake->stores;
};

template <class Element, class Fill>
std::shared_ptr<Element> made(Fill fill) {
  auto element = std::make_shared<Element>();
  fill(*element);
  return element;
}

std::string shown(const RecordList& list) {
  std::string out;
  for (const Record& record : list)
    out += (out.empty() ? "" : " ") + textOf(record);
  return out;
}

/// The lists of all stores but those that still wait, a line each.
std::string listsOf(const Stores& stores) {
  std::string out;
  visitTechnologyFields(stores, [&](std::string_view name, const auto& field) {
    if constexpr (std::is_same_v<decltype(field), const RecordList&>) {
      if (field != waitingForUpdate()) out += std::string(name) + ": " + shown(field) + "\n";
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
    // A timestamp of 1 ms, which all have as their first field.
    EXPECT_TRUE(intake->validateMetric(metricEvent(row.metric, Data::copy(bytesOf("08 01")))));
    const std::string keepsNumber =
        row.record == "myLTESelReselDict" || row.record == "myLTERsrpRsrqSinrDict" ? "1" : "";
    const bool printsFirst = !keepsNumber.empty() || row.record == "myCellularActiveBearerDict";
    const std::string shownDate = printsFirst ? "1" : "1970-01-01 00:00:00 UTC";
    EXPECT_TRUE(printed.lines().at(1).starts_with(std::string(row.text) + " {timestamp: " + shownDate))
        << printed.lines().at(1);
    visitLatestRecords(stores, [&](std::string_view name, const LatestRecord& record) {
      if (!record || !filled.insert(name).second) return;
      EXPECT_EQ(name, row.record);
      EXPECT_EQ(textOf(*record->find("timestamp")), keepsNumber.empty() ? "1970-01-01 00:00:00 UTC" : keepsNumber);
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
  take<KCellularLteCdrxConfig>([](auto& it) { it.setTimestamp(std::numeric_limits<std::uint64_t>::max()); });
  EXPECT_NE(stores.myLTECDRXConfigDict->find("timestamp")->text(), nullptr);
  take<KCellularLteCdrxConfig>([](auto& it) { it.setLongDrxCycleMs(320); });
  EXPECT_EQ(stores.myLTECDRXConfigDict, (Dictionary{{"long_drx_cycle_ms"_text, 320}}));
}

TEST_F(Intake, HalvesServingCellBandwidthsBeforeTheLine) {
  take<KCellularLteScellInfo>([](auto& it) {
    it.setDlBw(7);
    it.setUlBw(UINT32_MAX);
  });
  EXPECT_EQ(output.lines().back(), "Current Serving Cell Info is  {dl_bw: 3, ul_bw: 4294967295}");
}

TEST_F(Intake, RefreshesTheSelectionParameters) {
  take<KCellularLteSelReselCellInfo>([](auto& it) {
    it.setTimestamp(kInstant);
    it.setQRxLevMin(-62);
    it.addMultiBandInfo(1);
    it.addMultiBandInfo(7);
    it.addNbrEutra(made<NbrEutra>([](auto& cell) { cell.setDlBw(5); }));
  });
  EXPECT_EQ(*stores.myLTESelReselDict->find("multi_band_info"), Value("[1, 7]"_text));
  EXPECT_NE(output.lines().at(1).find("multi_band_info: [1, 7]"), std::string::npos);
  EXPECT_EQ(output.lines().at(2), "[1, 7]");
  EXPECT_EQ(textOf(stores.myLTE.SelReselCellInfo),
            "{timestamp: 2025-07-18 22:12:21 UTC, ims_emergency_support: , ac_barring_for_emergency: , "
            "mo_signalling_ac_barring_factor: , mo_signalling_ac_barring_time: , "
            "mo_signalling_ac_barring_for_special_ac: , mo_data_ac_barring_factor: , mo_data_ac_barring_time: , "
            "mo_data_ac_barring_for_special_ac: , QRxLevMin: -62, QQualMin: , Q_hyst: , S_non_intra_search_P: , "
            "S_non_intra_search_Q: , S_intra_search_P: , S_intra_search_Q: , Thresh_serving_lowP: , "
            "Thresh_serving_lowQ: , priority_operating_freq: , multi_band_info: [1, 7]}");
  // Without a timestamp the elements are stamped with what the parameters show: nothing, in words.
  take<KCellularLteSelReselCellInfo>([](auto& it) { it.addNbrEutra(std::make_shared<NbrEutra>()); });
  EXPECT_EQ(*stores.myLTE.SelReselCellInfo.find("QRxLevMin"), Value(""_text));
  EXPECT_EQ(listsOf(stores), "EutraNbrs: {timestamp: }\n");

  take<KCellularWcdmaSelReselCellInfo>([](auto& it) {
    it.setTimestamp(kInstant);
    it.setSQual(-3);
  });
  EXPECT_EQ(textOf(stores.myUMTS.SelReselCellInfo),
            "{timestamp: 2025-07-18 22:12:21 UTC, ims_emergency_support: , hsdpa_capable: , edch_capable: , "
            "duplex_mode: , cell_barred: , fach_meas_occ_info_present: , s_rxlev: , s_qual: -3, s_intrasearch: , "
            "s_intersearch: , s_search_rat: , s_cell_prio: , multi_band_info: []}");
}

TEST_F(Intake, LiftsListsIntoTheirStoresWithUnitsAndDates) {
  take<KCellularLteSelReselCellInfo>([](auto& it) {
    it.setTimestamp(kInstant);
    for (const std::uint32_t code : {0U, 1U, 2U, 3U, 4U, 5U, 6U, UINT32_MAX})
      it.addNbrEutra(made<NbrEutra>([&](auto& cell) { cell.setDlBw(code); }));
  });
  take<KCellularLteRsrpRsrqSinr>([](auto& it) {
    it.setTimestamp(kInstant);
    it.addInstValues(made<RsrpRsrqSinr>([](auto& sample) { sample.setSinr0(-7), sample.setSinr1(4); }));
    it.addInstValues(made<RsrpRsrqSinr>([](auto& sample) { sample.setRsrp0(-95), sample.setSinr0(16777217); }));
  });
  take<KCellularLteTxPower>(
      [](auto& it) { it.addTxPowerInfo(made<TxPowerInfo>([](auto& power) { power.setPuschTxPower(-12); })); });
  take<KCellularLteNbrEutraCellMeas>([](auto& it) {
    it.addMeasNbrEutra(made<EgwErrcNbrEutraMeas>([](auto& cell) { cell.setNbrRsrp(45), cell.setNbrRsrq(0); }));
  });
  take<KCellularLteNbrInterRatCellMeas>([](auto& it) {
    it.addMeasNbrUtra(made<EgwErrcNbrUtraMeas>([](auto& cell) { cell.setRscp(-5), cell.setEcno(49); }));
    it.addMeasNbrGeran(made<EgwErrcNbrGeranMeas>([](auto& cell) { cell.setRxlev(63); }));
  });
  take<KCellularLteCarrierAggregationStatus>([](auto& it) {
    it.addSccList(made<SecondaryComponentCarrier>([](auto& carrier) {
      carrier.setDlBandwidth(5);
      carrier.setRsrp(-785), carrier.setRsrq(-1050), carrier.setRssi(199);
    }));
    it.addSccList(made<SecondaryComponentCarrier>([](auto& carrier) { carrier.setDlBandwidth(6); }));
  });
  take<KCellularWcdmaScellMeasurement>([](auto& it) {
    it.setConnectedMode(true);
    it.addRxInfo(std::make_shared<RxInfo>());
  });
  take<KCellularWcdmaTxPower>(
      [](auto& it) { it.addTxPowerInfo(made<TxPowerInfo>([](auto& power) { power.setPuschTxPower(-13); })); });
  take<KCellularWcdmaSelReselCellInfo>([](auto& it) {
    it.setTimestamp(kInstant);
    it.addEutraPrioInfo(made<EutraFreqInfo>([](auto& cell) { cell.setEarfcn(1850); }));
    it.addUtraPrioInfo(made<UtraFreqInfo>([](auto& cell) { cell.setUarfcn(10562); }));
    it.addGsmPrioInfo(made<GsmFreqInfo>([](auto& cell) { cell.setArfcn(975); }));
  });
  take<KCellularWcdmaNbrCellMeas>([](auto& it) {
    it.addMeasUtraResult(made<UtraCellMeasResult>([](auto& cell) { cell.setRscp(16), cell.setEcno(0); }));
    it.addMeasGsmResult(made<GsmCellMeasResult>([](auto& cell) { cell.setRxlev(62); }));
    it.addMeasLteResult(made<LteCellMeasResult>([](auto& cell) { cell.setRsrp(97), cell.setRsrq(34); }));
  });
  take<KCellularGsmGrrEventMeasCr>([](auto& it) {
    it.addGsmNcellMeas(made<GsmNcellMeas>([](auto& cell) { cell.setRxlev(61); }));
    it.addUmtsNcellMeas(made<UmtsNcellMeas>([](auto& cell) { cell.setCpichRscp(30), cell.setCpichEcn0(20); }));
    it.addLteNcellMeas(made<LteNcellMeas>([](auto& cell) { cell.setRsrp(96), cell.setRsrq(33); }));
  });
  take<KCellularActivatedBearerContexts>([](auto& it) {
    it.setTimestamp(kInstant);
    it.addBearerContexts(made<BearerContext>([](auto& bearer) { bearer.setApn("internet"_text); }));
  });
  take<KCellularSimCardFiles>([](auto& it) {
    it.addEfList(made<ElementaryFile>([](auto& file) { file.setContent(Data::copy(bytesOf("98"))); }));
  });
  EXPECT_EQ(
      listsOf(stores),
      "EutraNbrs: {dl_bw: 1.4, timestamp: 2025-07-18 22:12:21 UTC} {dl_bw: 3.0, timestamp: 2025-07-18 22:12:21 UTC} "
      "{dl_bw: 5.0, timestamp: 2025-07-18 22:12:21 UTC} {dl_bw: 10.0, timestamp: 2025-07-18 22:12:21 UTC} "
      "{dl_bw: 15.0, timestamp: 2025-07-18 22:12:21 UTC} {dl_bw: 20.0, timestamp: 2025-07-18 22:12:21 UTC} "
      "{timestamp: 2025-07-18 22:12:21 UTC} {dl_bw: 4294967295, timestamp: 2025-07-18 22:12:21 UTC}\n"
      "RsrpRsrqSinr: {sinr0: -3.5, sinr1: 2.0, timestamp: 2025-07-18 22:12:21 UTC} "
      "{rsrp0: -95, sinr0: 16777217, timestamp: 2025-07-18 22:12:21 UTC}\n"
      "TxPower: {pusch_tx_power: -12}\n"
      "EutraNbrsMeas: {nbr_rsrp: -95, nbr_rsrq: -19.5}\n"
      "UtraNbrsMeas: {rscp: -121, ecno: 0.0}\n"
      "GeraNbrsMeas: {rxlev: -47}\n"
      "CAStatusList: {dl_bandwidth: 20.0, rsrp: -7, rsrq: -10.5, rssi: 1} {}\n"
      "rXInfo: {connected_mode: true}\n"
      "TxPower: {pusch_tx_power: -13}\n"
      "eUtraNbrs: {earfcn: 1850, timestamp: 2025-07-18 22:12:21 UTC}\n"
      "utraNbrs: {uarfcn: 10562, timestamp: 2025-07-18 22:12:21 UTC}\n"
      "geraNbrs: {arfcn: 975, timestamp: 2025-07-18 22:12:21 UTC}\n"
      "eUtraNbrMeas: {rsrp: -43, rsrq: -2.5}\n"
      "utraNbrMeas: {ecno: -24.5, rscp: -100}\n"
      "geraNbrMeas: {rxlev: -48}\n"
      "eUtraNbrMeas: {rsrp: -44, rsrq: -3.0}\n"
      "utraNbrMeas: {cpich_rscp: -86, cpich_ecn0: -14.5}\n"
      "geraNbrMeas: {rxlev: -49}\n"
      "activeBearer: {apn: internet, timestamp: 2025-07-18 22:12:21 UTC}\n"
      "simContents: {content: 0x98}\n");
  EXPECT_EQ(textOf(*stores.myLTECAStatusDict),
            "{scc_list: [{dl_bandwidth: 5, rsrp: -785, rsrq: -1050, rssi: 199}, {dl_bandwidth: 6}]}")
      << "the record keeps what the handset reported";

  const RecordList before = stores.myUMTS.rXInfo;
  take<KCellularWcdmaScellMeasurement>([](auto&) {});
  EXPECT_EQ(stores.myUMTS.rXInfo, before) << "no list leaves the store as it was";
  take<KCellularWcdmaScellMeasurement>([](auto& it) { it.addRxInfo(std::make_shared<RxInfo>()); });
  EXPECT_EQ(shown(stores.myUMTS.rXInfo), "{}");
  take<KCellularLteRsrpRsrqSinr>([](auto& it) { it.addInstValues(std::make_shared<RsrpRsrqSinr>()); });
  EXPECT_EQ(shown(stores.myLTE.RsrpRsrqSinr), "{}");
}

TEST_F(Intake, PutsTheEmmContextIntoWords) {
  take<KCellularEmmContext>([](auto& it) {
    it.setGuti(made<Guti>([](auto& guti) { guti.setMmec(12); }));
    it.addTaiList(made<KCellularTrackingAreaId>([](auto& area) { area.setTac(7); }));
  });
  EXPECT_EQ(*stores.myLTEEMMContextDict->find("guti"), Value("{mmec: 12}"_text));
  EXPECT_EQ(*stores.myLTEEMMContextDict->find("tai_list"), Value("[{tac: 7}]"_text));
}

}  // namespace
}  // namespace vesk
