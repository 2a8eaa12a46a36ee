#include "intake/metric_validator.h"

#include <cstdlib>
#include <ctime>
#include <gtest/gtest.h>
#include <limits>
#include <string>
#include <vector>

#include "intake/metric_table.h"
#include "messages/gsm/gsm.h"
#include "messages/lte/lte.h"
#include "messages/nas/nas.h"
#include "messages/wcdma/wcdma.h"
#include "support/metric_events.h"
#include "support/recorded_output.h"
#include "values/text_form.h"

namespace vesk {
namespace {

using namespace metrics;
using Lines = std::vector<std::string>;

/// 2025-07-18 22:12:21 UTC.
constexpr std::uint64_t kInstant = 1752876741000;
constexpr std::string_view kDate = "2025-07-18 22:12:21 UTC";

class Intake : public testing::Test {
 protected:
  Intake() {
    setenv("TZ", "UTC", 1);
    tzset();
    intake = MetricValidator::listeningTo(nullptr);
  }

  bool take(std::int64_t id, const ProtoCodable& message) { return intake->validateMetric(metricEvent(id, message)); }

  RecordedOutput output;
  std::shared_ptr<MetricValidator> intake;
};

template <class Element>
std::shared_ptr<Element> make() {
  return std::make_shared<Element>();
}

std::string shown(const RecordList& list) {
  std::string out;
  for (const Record& record : list)
    out += textOf(record) + "\n";
  return out;
}

TEST_F(Intake, StartsWithPlaceholdersAndNoRecords) {
  const std::string waiting = "{Waiting for Update: Waiting for Update}\n";
  std::vector<std::string> names;
  const auto check = [&](std::string_view name, const auto& field) {
    names.emplace_back(name);
    if constexpr (std::is_same_v<decltype(field), const RecordList&>) {
      EXPECT_EQ(shown(field), waiting) << name;
    }
  };
  visitFields(intake->myLTE, check);
  visitFields(intake->myUMTS, check);
  visitFields(intake->myGSM, check);
  visitFields(intake->myCommon, check);
  EXPECT_EQ(names.size(), 10U + 9U + 3U + 2U);
  EXPECT_EQ(intake->myLTE.IMSI, Value("Come Back Later"_text));
  EXPECT_EQ(intake->myLTE.SelReselCellInfo.size(), 20U);
  EXPECT_EQ(intake->myUMTS.SelReselCellInfo.size(), 14U);
  for (const auto& [key, value] : intake->myUMTS.SelReselCellInfo)
    EXPECT_EQ(value, Value(""_text)) << key.view();
  for (const auto& [name, record] : kLatestRecords)
    EXPECT_FALSE(((*intake).*record).has_value()) << name;
}

TEST_F(Intake, PrintsTheIdentifierTheRecordAndThatItWasValid) {
  KCellularLteRrcState message;
  message.setTimestamp(0);
  message.setState(LteRrcState::KLTE_RRC_STATE_CONNECTED);
  intake->metricsDidUpdate(metricEvent(K_LTE_RRC_STATE, message));
  intake->eventsDidUpdate(Dictionary{{"kKeyMetricID"_text, K_LTE_RRC_STATE}});
  intake->metricsDidUpdate(std::nullopt);
  EXPECT_EQ(output.lines(), (Lines{
                                "Metric ID in Hex =  3C4E04",
                                "Current RRC state is  {timestamp: 1970-01-01 00:00:00 UTC, "
                                "state: KLTE_RRC_STATE_CONNECTED}",
                                "Received Valid Metric",
                                "I dont care for events",
                                "I dont care for this Metric",
                            }));
}

TEST_F(Intake, PassesOverWhatItCannotTake) {
  struct Row {
    std::string_view what;
    Dictionary event;
    Lines printed;
  };
  const Data damaged = Data::copy(std::vector<std::uint8_t>{0x08});
  const std::vector<Row> rows{
      {"known but not handled",
       metricEvent(K_LTE_RLF, Data()),
       {"Metric ID in Hex =  3C4E25", "I dont care for this Metric"}},
      {"known, with a class, but not handled",
       metricEvent(K_LTE_SCELL_MEAS, KCellularLteServingCellMeasurement()),
       {"Metric ID in Hex =  3CD301", "I dont care for this Metric"}},
      {"between the known ones",
       metricEvent(K_LTE_RRC_STATE + 1, Data()),
       {"Metric ID in Hex =  3C4E05", "I dont care for this Metric"}},
      {"one digit", metricEvent(7, Data()), {"Metric ID in Hex =   7", "I dont care for this Metric"}},
      {"negative", metricEvent(-1, Data()), {"Metric ID in Hex =  FFFFFFFFFFFFFFFF", "I dont care for this Metric"}},
      {"no identifier", {{"kKeyPayload"_text, Data()}}, {"I dont care for this Metric"}},
      {"identifier of another type", {{"kKeyMetricID"_text, "3952132"_text}}, {"I dont care for this Metric"}},
      {"a boolean is no identifier", {{"kKeyMetricID"_text, true}}, {"I dont care for this Metric"}},
      {"undecodable",
       metricEvent(K_LTE_RRC_STATE, damaged),
       {"Metric ID in Hex =  3C4E04", "I dont care for this Metric"}},
  };
  for (const Row& row : rows) {
    SCOPED_TRACE(row.what);
    const RecordedOutput printed;
    EXPECT_FALSE(intake->validateMetric(row.event));
    EXPECT_EQ(printed.lines(), row.printed);
  }
  for (const auto& [name, record] : kLatestRecords)
    EXPECT_FALSE(((*intake).*record).has_value()) << name;
}

TEST_F(Intake, AnEventWithoutBytesIsAnEmptyMessage) {
  EXPECT_TRUE(intake->validateMetric({{"kKeyMetricID"_text, K_GSM_CS_RF_MEAS}}));
  EXPECT_EQ(intake->myGSMConnRfMeasDict, (Dictionary{{"cs_tx_pwr"_text, Array{}}}));
  EXPECT_TRUE(intake->validateMetric({{"kKeyMetricID"_text, K_LTE_RRC_STATE}, {"kKeyPayload"_text, "text"_text}}));
  EXPECT_EQ(intake->myLTERRCStateDict, Dictionary{});
}

TEST_F(Intake, StoresEveryHandledMetricInItsOwnRecord) {
  std::size_t handled = 0;
  for (std::int64_t id = 0x3C0000; id <= 0x3CFFFF; ++id) {
    const HandledMetric* metric = findHandledMetric(id);
    if (metric == nullptr) continue;
    ++handled;
    ASSERT_FALSE(((*intake).*(metric->record)).has_value()) << "two metrics share a record: " << id;
    EXPECT_TRUE(intake->validateMetric(metricEvent(id, Data())));
    ASSERT_TRUE(((*intake).*(metric->record)).has_value()) << id;
  }
  EXPECT_EQ(handled, 29U);
  EXPECT_FALSE(intake->myLTESCellMeasDict.has_value());
}

TEST_F(Intake, ANewRecordReplacesTheOldOneWhole) {
  KCellularLteCdrxConfig first;
  first.setOnDurationMs(10);
  first.setTimestamp(kInstant);
  KCellularLteCdrxConfig second;
  second.setLongDrxCycleMs(320);
  take(K_LTE_CDRX_CONFIG, first);
  take(K_LTE_CDRX_CONFIG, second);
  EXPECT_EQ(intake->myLTECDRXConfigDict, (Dictionary{{"long_drx_cycle_ms"_text, 320}}));
}

TEST_F(Intake, FormatsAnyTimestamp) {
  KCellularGsmIdleConfig message;
  for (const auto& [milliseconds, date] : std::vector<std::pair<std::uint64_t, std::string_view>>{
           {1500, "1970-01-01 00:00:01 UTC"}, {kInstant + 999, kDate}}) {
    message.setTimestamp(milliseconds);
    take(K_GSM_IDLE_CONFIG, message);
    EXPECT_EQ(*intake->myGSMIdleConfigInfoDict->find("timestamp"), Value(Text::copy(date)));
  }
  message.setTimestamp(std::numeric_limits<std::uint64_t>::max());
  take(K_GSM_IDLE_CONFIG, message);
  EXPECT_NE(intake->myGSMIdleConfigInfoDict->find("timestamp")->text(), nullptr);
}

TEST_F(Intake, HalvesServingCellBandwidthsBeforeTheLine) {
  KCellularLteScellInfo message;
  message.setDlBw(7);
  message.setUlBw(UINT32_MAX);
  take(K_LTE_SCELL_INFO, message);
  EXPECT_EQ(output.lines().back(), "Current Serving Cell Info is  {dl_bw: 3, ul_bw: 4294967295}");
}

TEST_F(Intake, TakesLteSelectionParameters) {
  KCellularLteSelReselCellInfo message;
  message.setTimestamp(kInstant);
  message.setQRxLevMin(-62);
  for (const std::uint32_t band : {1U, 3U, 7U})
    message.addMultiBandInfo(band);
  for (const std::uint32_t code : {0U, 5U, 6U, UINT32_MAX}) {
    auto neighbor = make<NbrEutra>();
    neighbor->setDlBw(code);
    message.addNbrEutra(neighbor);
  }
  take(K_LTE_SEL_RESEL_INFO, message);

  EXPECT_EQ(*intake->myLTESelReselDict->find("timestamp"), Value(kInstant));
  EXPECT_EQ(*intake->myLTESelReselDict->find("multi_band_info"), Value("[1, 3, 7]"_text));
  const Record& parameters = intake->myLTE.SelReselCellInfo;
  EXPECT_EQ(parameters.size(), 20U);
  EXPECT_EQ(*parameters.find("timestamp"), Value(Text::copy(kDate)));
  EXPECT_EQ(*parameters.find("QRxLevMin"), Value(-62));
  EXPECT_EQ(*parameters.find("Q_hyst"), Value(""_text));
  EXPECT_EQ(*parameters.find("multi_band_info"), Value("[1, 3, 7]"_text));
  EXPECT_EQ(shown(intake->myLTE.EutraNbrs),
            "{dl_bw: 1.4, timestamp: 2025-07-18 22:12:21 UTC}\n"
            "{dl_bw: 20.0, timestamp: 2025-07-18 22:12:21 UTC}\n"
            "{timestamp: 2025-07-18 22:12:21 UTC}\n"
            "{dl_bw: 4294967295, timestamp: 2025-07-18 22:12:21 UTC}\n");
  ASSERT_EQ(output.lines().size(), 3U);
  EXPECT_NE(output.lines()[1].find("multi_band_info: [1, 3, 7]"), std::string::npos);
  EXPECT_EQ(output.lines()[2], "[1, 3, 7]");

  // Without a timestamp the elements are stamped with what the parameters show: nothing, in words.
  KCellularLteSelReselCellInfo bare;
  bare.addNbrEutra(make<NbrEutra>());
  take(K_LTE_SEL_RESEL_INFO, bare);
  EXPECT_EQ(*parameters.find("timestamp"), Value(""_text));
  EXPECT_EQ(*parameters.find("QRxLevMin"), Value(""_text));
  EXPECT_EQ(*parameters.find("multi_band_info"), Value("[]"_text));
  EXPECT_EQ(shown(intake->myLTE.EutraNbrs), "{timestamp: }\n");
}

TEST_F(Intake, TakesUmtsSelectionParameters) {
  KCellularWcdmaSelReselCellInfo message;
  message.setTimestamp(kInstant);
  message.setSQual(-3);
  auto lte = make<EutraFreqInfo>();
  lte->setEarfcn(1850);
  message.addEutraPrioInfo(lte);
  message.addGsmPrioInfo(make<GsmFreqInfo>());
  message.addGsmPrioInfo(make<GsmFreqInfo>());
  take(K_UMTS_SEL_RESEL_INFO, message);
  EXPECT_EQ(textOf(intake->myUMTS.SelReselCellInfo),
            "{timestamp: 2025-07-18 22:12:21 UTC, ims_emergency_support: , hsdpa_capable: , edch_capable: , "
            "duplex_mode: , cell_barred: , fach_meas_occ_info_present: , s_rxlev: , s_qual: -3, s_intrasearch: , "
            "s_intersearch: , s_search_rat: , s_cell_prio: , multi_band_info: []}");
  EXPECT_EQ(shown(intake->myUMTS.eUtraNbrs), "{earfcn: 1850, timestamp: 2025-07-18 22:12:21 UTC}\n");
  EXPECT_EQ(intake->myUMTS.geraNbrs.size(), 2U);
  EXPECT_EQ(intake->myUMTS.utraNbrs, waitingForUpdate());
}

TEST_F(Intake, TakesSamplesWithTheirOwnUnitsAndTimestamps) {
  KCellularLteRsrpRsrqSinr message;
  message.setTimestamp(kInstant);
  for (const std::int32_t sinr : {-7, 16777217}) {
    auto sample = make<RsrpRsrqSinr>();
    sample->setRsrp0(-95);
    sample->setSinr0(sinr);
    message.addInstValues(sample);
  }
  take(K_LTE_RSRP_RSRQ_SINR, message);
  EXPECT_EQ(*intake->myLTERsrpRsrqSinrDict->find("timestamp"), Value(kInstant));
  EXPECT_EQ(shown(intake->myLTE.RsrpRsrqSinr),
            "{rsrp0: -95, sinr0: -3.5, timestamp: 2025-07-18 22:12:21 UTC}\n"
            "{rsrp0: -95, sinr0: 16777217, timestamp: 2025-07-18 22:12:21 UTC}\n");

  message.setHasTimestamp(false);
  take(K_LTE_RSRP_RSRQ_SINR, message);
  EXPECT_FALSE(intake->myLTE.RsrpRsrqSinr[0].contains("timestamp"));
}

TEST_F(Intake, ConvertsCarriersInTheStoreAndNotInTheRecord) {
  KCellularLteCarrierAggregationStatus message;
  auto carrier = make<SecondaryComponentCarrier>();
  carrier->setRsrp(-785);
  carrier->setRsrq(-1050);
  carrier->setRssi(199);
  carrier->setDlBandwidth(5);
  message.addSccList(carrier);
  auto other = make<SecondaryComponentCarrier>();
  other->setDlBandwidth(6);
  message.addSccList(other);
  take(K_LTE_CA_STATUS, message);
  EXPECT_EQ(shown(intake->myLTE.CAStatusList), "{dl_bandwidth: 20.0, rsrp: -7, rsrq: -10.5, rssi: 1}\n{}\n");
  EXPECT_EQ(textOf(*intake->myLTECAStatusDict),
            "{scc_list: [{dl_bandwidth: 5, rsrp: -785, rsrq: -1050, rssi: 199}, {dl_bandwidth: 6}]}");
}

TEST_F(Intake, ConvertsNeighborsOfEveryTechnology) {
  KCellularLteNbrEutraCellMeas lte;
  auto lteNeighbor = make<EgwErrcNbrEutraMeas>();
  lteNeighbor->setNbrRsrp(45);
  lteNeighbor->setNbrRsrq(0);
  lte.addMeasNbrEutra(lteNeighbor);
  take(K_LTE_INTRARAT_MEAS, lte);
  EXPECT_EQ(shown(intake->myLTE.EutraNbrsMeas), "{nbr_rsrp: -95, nbr_rsrq: -19.5}\n");

  KCellularLteNbrInterRatCellMeas interRat;
  auto utra = make<EgwErrcNbrUtraMeas>();
  utra->setRscp(-5);
  utra->setEcno(49);
  interRat.addMeasNbrUtra(utra);
  take(K_LTE_INTERRAT_MEAS, interRat);
  EXPECT_EQ(shown(intake->myLTE.UtraNbrsMeas), "{rscp: -121, ecno: 0.0}\n");
  EXPECT_EQ(intake->myLTE.GeraNbrsMeas, waitingForUpdate());

  KCellularWcdmaNbrCellMeas umts;
  auto gsm = make<GsmCellMeasResult>();
  gsm->setRxlev(63);
  umts.addMeasGsmResult(gsm);
  auto eutra = make<LteCellMeasResult>();
  eutra->setRsrp(97);
  eutra->setRsrq(34);
  umts.addMeasLteResult(eutra);
  take(K_UMTS_NCELL_MEAS, umts);
  EXPECT_EQ(shown(intake->myUMTS.geraNbrMeas), "{rxlev: -47}\n");
  EXPECT_EQ(shown(intake->myUMTS.eUtraNbrMeas), "{rsrp: -43, rsrq: -2.5}\n");

  KCellularGsmGrrEventMeasCr fromGsm;
  auto umtsNeighbor = make<UmtsNcellMeas>();
  umtsNeighbor->setCpichRscp(30);
  umtsNeighbor->setCpichEcn0(20);
  fromGsm.addUmtsNcellMeas(umtsNeighbor);
  take(K_GSM_NCELL_MEAS, fromGsm);
  EXPECT_EQ(shown(intake->myGSM.utraNbrMeas), "{cpich_rscp: -86, cpich_ecn0: -14.5}\n");
  EXPECT_EQ(intake->myGSM.geraNbrMeas, waitingForUpdate());
}

TEST_F(Intake, ServingCellMeasurementsTakeTheConnectedMode) {
  KCellularWcdmaScellMeasurement message;
  message.setTimestamp(kInstant);
  message.setConnectedMode(true);
  message.addRxInfo(make<RxInfo>());
  take(K_UMTS_SCELL_MEAS, message);
  EXPECT_EQ(shown(intake->myUMTS.rXInfo), "{timestamp: 2025-07-18 22:12:21 UTC, connected_mode: true}\n");

  KCellularWcdmaScellMeasurement withoutList;
  take(K_UMTS_SCELL_MEAS, withoutList);
  EXPECT_EQ(intake->myUMTS.rXInfo.size(), 1U) << "no list leaves the store as it was";
  EXPECT_TRUE(intake->myUMTS.rXInfo[0].contains("connected_mode"));

  KCellularWcdmaScellMeasurement bare;
  bare.addRxInfo(make<RxInfo>());
  take(K_UMTS_SCELL_MEAS, bare);
  EXPECT_EQ(shown(intake->myUMTS.rXInfo), "{}\n");
}

TEST_F(Intake, ShowsTheEmmContextInWords) {
  KCellularEmmContext message;
  message.setTimestamp(kInstant);
  auto guti = make<Guti>();
  guti->setMmec(12);
  message.setGuti(guti);
  auto area = make<KCellularTrackingAreaId>();
  area->setEncodedPlmn(Data::copy(std::vector<std::uint8_t>{0x00, 0xF1, 0x10}));
  area->setTac(7);
  message.addTaiList(area);
  take(K_LTE_EMM_CTXT, message);
  EXPECT_EQ(*intake->myLTEEMMContextDict->find("guti"), Value("{mmec: 12}"_text));
  EXPECT_EQ(*intake->myLTEEMMContextDict->find("tai_list"), Value("[{encoded_plmn: 0x00f110, tac: 7}]"_text));
  EXPECT_EQ(output.lines().back(),
            "Received EMM Context is  {timestamp: 2025-07-18 22:12:21 UTC, "
            "tai_list: [{encoded_plmn: 0x00f110, tac: 7}], guti: {mmec: 12}}");
}

TEST_F(Intake, BearersAreLoggedWithTheNumberAndStoredWithTheDate) {
  KCellularActivatedBearerContexts message;
  message.setTimestamp(kInstant);
  message.setBearerContextCount(3);
  auto bearer = make<BearerContext>();
  bearer->setApn("internet"_text);
  message.addBearerContexts(bearer);
  take(K_CELLULAR_ACTIVE_BEARER, message);
  EXPECT_EQ(output.lines().back(),
            "Received Bearer Context Info is  {timestamp: 1752876741000, bearer_context_count: 3, "
            "bearer_contexts: [{apn: internet}]}");
  EXPECT_EQ(*intake->myCellularActiveBearerDict->find("timestamp"), Value(Text::copy(kDate)));
  EXPECT_EQ(shown(intake->myCommon.activeBearer), "{apn: internet, timestamp: 2025-07-18 22:12:21 UTC}\n");
}

TEST_F(Intake, KeepsTransmitPowersAndSimFiles) {
  KCellularLteTxPower power;
  power.addTxPowerInfo(make<TxPowerInfo>());
  power.txPowerInfoAtIndex(0)->setPuschTxPower(-12);
  take(K_LTE_TX_POWER, power);
  EXPECT_EQ(shown(intake->myLTE.TxPower), "{pusch_tx_power: -12}\n");
  EXPECT_EQ(intake->myUMTS.TxPower, waitingForUpdate());

  KCellularWcdmaTxPower umtsPower;
  umtsPower.addTxPowerInfo(make<TxPowerInfo>());
  take(K_UMTS_TX_POWER, umtsPower);
  EXPECT_EQ(shown(intake->myUMTS.TxPower), "{}\n");

  KCellularSimCardFiles files;
  auto file = make<ElementaryFile>();
  file->setEfId(0x2FE2);
  file->setContent(Data::copy(std::vector<std::uint8_t>{0x98}));
  files.addEfList(file);
  take(K_SIM_FILE_INFO, files);
  EXPECT_EQ(shown(intake->myCommon.simContents), "{ef_id: 12258, content: 0x98}\n");
}

}  // namespace
}  // namespace vesk
