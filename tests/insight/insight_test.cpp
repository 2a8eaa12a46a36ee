#include "insight/insight.h"

#include <gtest/gtest.h>

#include "insight/drive.h"
#include "insight/series.h"
#include "insight/summary_form.h"

namespace vesk::insight {
namespace {

using enum LteRrcState;
using enum SccState;

std::string heardIn(const std::vector<DriveEvent>& events) {
  std::string out;
  JsonWriter json(out);
  writeJson(json, Drive(events).insight.cellsHeard());
  json.finish();
  return out;
}

struct HeardCase {
  const char* name;
  std::vector<DriveEvent> events;
  const char* json;
};

TEST(CellsHeard, HaveRolesAgesAndDifferences) {
  for (
      const auto& [name, events, json] : std::vector<HeardCase>{
          {"serving, secondary, neighbours by level; a sample of another cell is not the serving cell's",
           {lteCell(0, 5815, 338), lteLevel(10, -96, -13, 338), lteLevel(20, -80, -5, 7),
            lteNeighbors(100, {{5815, 328, -101}, {{}, 9, -99}, {5780, 1, -157}, {{}, {}, -90}}),
            carriers(300, {{1, SCC_STATE_ACTIVATED, 2000, 62}})},
           R"([{"technology":"LTE","channel":5815,"code":338,"role":"serving","level":-96,"quality":-13,"difference":0,"age_ms":290,"served_ms_ago":0},)"
           R"({"technology":"LTE","channel":2000,"code":62,"role":"secondary","level":null,"quality":null,"difference":null,"age_ms":0,"served_ms_ago":null},)"
           R"({"technology":"LTE","channel":null,"code":9,"role":"neighbour","level":-99,"quality":null,"difference":-3,"age_ms":200,"served_ms_ago":null},)"
           R"({"technology":"LTE","channel":5815,"code":328,"role":"neighbour","level":-101,"quality":null,"difference":-5,"age_ms":200,"served_ms_ago":null},)"
           R"({"technology":"LTE","channel":5780,"code":1,"role":"neighbour","level":null,"quality":null,"difference":null,"age_ms":200,"served_ms_ago":null}])"},
          {"a cell left is a neighbour that served; one unheard for 30 s is forgotten",
           {lteCell(0, 5815, 338), lteNeighbors(1, {{5815, 5, -99}}), lteLevel(100, -96), lteCell(200, 5815, 328),
            lteNeighbors(30'001, {{5815, 338, -90}}), lteLevel(30'002, -99.0)},
           R"([{"technology":"LTE","channel":5815,"code":328,"role":"serving","level":-99,"quality":-10,"difference":0,"age_ms":0,"served_ms_ago":0},)"
           R"({"technology":"LTE","channel":5815,"code":338,"role":"neighbour","level":-90,"quality":null,"difference":9,"age_ms":1,"served_ms_ago":29802}])"},
          {"one forgotten is another when it is heard again",
           {lteCell(0, 5815, 338), lteLevel(100, -96), lteCell(200, 5815, 328), lteLevel(30'000, -99),
            lteNeighbors(32'000, {{5815, 338, -90}})},
           R"([{"technology":"LTE","channel":5815,"code":328,"role":"serving","level":-99,"quality":-10,"difference":0,"age_ms":2000,"served_ms_ago":0},)"
           R"({"technology":"LTE","channel":5815,"code":338,"role":"neighbour","level":-90,"quality":null,"difference":9,"age_ms":0,"served_ms_ago":null}])"},
          {"cell info renews the time only; nothing is compared across technologies",
           {umtsCell(0, 10637, 1), umtsLevel(10, -70, 43), umtsCell(500, 10637, 1),
            lteNeighbors(500, {{5815, 5, -99}})},
           R"([{"technology":"UMTS","channel":10637,"code":1,"role":"serving","level":-73,"quality":-3,"difference":0,"age_ms":0,"served_ms_ago":0},)"
           R"({"technology":"LTE","channel":5815,"code":5,"role":"neighbour","level":-99,"quality":null,"difference":null,"age_ms":0,"served_ms_ago":null}])"},
      })
    EXPECT_EQ(heardIn(events), json) << name;
}

TEST(CellsHeard, KeepTheStrongestOfThousands) {
  std::vector<LteNeighbor> cells;
  for (std::uint32_t index = 0; index < 5000; ++index)
    cells.push_back({index / 500 * 10, index % 500, -156 + static_cast<std::int32_t>(index % 100)});
  Drive drive({lteCell(0, 66'000, 1), lteLevel(1, -156), lteNeighbors(2, cells)});
  const auto heard = drive.insight.cellsHeard();
  EXPECT_EQ(heard.size(), 512);
  EXPECT_EQ(heard.front().role, HeardRole::serving);
  EXPECT_GE(heard.back().level, -156 + 89);
  drive.play({lteCell(3, 66'000, 2)});
  EXPECT_EQ(drive.insight.cellsHeard().front().role, HeardRole::serving) << "whatever its level will be";
}

TEST(Series, HasARowForEachReportWithAllThatIsKnown) {
  Drive drive;
  std::string rows = seriesHeader() + "\n";
  std::string lines;
  drive.insight.setStepHandler([&](const Report& report, const Step&) {
    if (report.kpis.empty()) return;
    appendSeriesRow(rows, drive.insight);
    rows += '\n';
    appendSeriesLine(lines, drive.insight);
    lines += '\n';
  });
  drive.play({lteNeighbors(0, {{5815, 1, -116}, {5815, 2, -112}}), lteCell(10, 850, 443), lteLevel(20, -125, -20),
              lteLevel(20, -125, -20), lteLevel(30, -157, -9), umtsLevel(30'010, -70, 40),
              event<KCellularGsmCsRfMeasurement>(30'020, K_GSM_CS_RF_MEAS, [](auto& message) {
                message.setCsRxlevSub(30);
                message.setCsRxqualSub(8);
                message.addCsTxPwr(40);
                message.addCsTxPwr(33);
              })});
  EXPECT_EQ(rows,
            "timestamp,technology,channel,code,lte.rsrp,lte.rsrq,lte.sinr,lte.tx_power.pusch,lte.tx_power.pucch,"
            "lte.scc.rsrp,lte.nbr.rsrp,umts.rscp,umts.ecno,umts.rssi,umts.tx_power,gsm.rxlev,gsm.rxqual,gsm.tx_power\n"
            "1516485160000,,,,,,,,,,-112,,,,,,,\n"
            "1516485160020,LTE,850,443,-125,-20,,,,,-112,,,,,,,\n"
            "1516485160020,LTE,850,443,-125,-20,,,,,-112,,,,,,,\n"
            "1516485160030,LTE,850,443,-125,-9,,,,,-112,,,,,,,\n"
            "1516485190010,UMTS,,,,,,,,,,-74.5,-4.5,-70,,,,\n"
            "1516485190020,GSM,,,,,,,,,,,,,,-80,,33\n");
  EXPECT_EQ(lines.substr(0, lines.find('\n', 40)),
            "21:52:40.000  lte.nbr.rsrp -112\n"
            "21:52:40.020  LTE PCI 443 B2 850  lte.rsrp -125  lte.rsrq -20  lte.nbr.rsrp -112");
}

TEST(Summary, TellsTheWholeDrive) {
  const auto ca = SCC_STATE_ACTIVATED;
  Drive drive({lteRrc(0, KLTE_RRC_STATE_CONNECTED), lteCell(0, 5815, 338), lteLevel(0, -96, -13), lteLevel(0, -91, -9),
               carriers(1000, {{1, ca, 2000, 62, -99}}), lteCell(2000, 5815, 328), lteCell(4000, 5815, {}, 77),
               emm(5000, RegStatus::KREG_STATUS_NO_SERVICE), lteLevel(6000, -91, -9, 1),
               lteCell(100'000, 5815, 328, 77), umtsCell(102'000, 10637, 1)});
  drive.take(metricEvent(1, Data{}));
  EXPECT_EQ(
      summaryJson(drive.insight),
      R"({"events":12,"stored":11,"undecodable":0,"ignored":1,"untimed":0,"first":1516485160000,"last":1516485262000,"counted_ms":8000,"stretches":2,)"
      R"("technologies":[{"technology":"LTE","ms":8000,"share":1}],)"
      R"("cells":[{"technology":"LTE","channel":5815,"code":328,"cell_id":77,"ms":6000,"visits":2,"level":null,"quality":null,"sinr":null},)"
      R"({"technology":"LTE","channel":5815,"code":338,"cell_id":null,"ms":2000,"visits":1,"level":{"count":2,"min":-96,"mean":-93.5,"median":-93.5,"max":-91},"quality":{"count":2,"min":-13,"mean":-11,"median":-11,"max":-9},"sinr":null},)"
      R"({"technology":"UMTS","channel":10637,"code":1,"cell_id":null,"ms":0,"visits":1,"level":null,"quality":null,"sinr":null}],)"
      R"("kpis":{"lte.rsrp":{"count":3,"min":-96,"mean":-92.66666666666667,"median":-91,"max":-91},"lte.rsrq":{"count":3,"min":-13,"mean":-10.333333333333334,"median":-9,"max":-9},"lte.scc.rsrp":{"count":1,"min":-99,"mean":-99,"median":-99,"max":-99}},)"
      R"("grades":{"lte.rsrp":{"excellent":0,"good":0,"fair":6000,"poor":0},"lte.rsrq":{"excellent":0,"good":6000,"fair":0,"poor":0}},)"
      R"("connections":{"LTE":{"attempted":0,"established":0,"failed":{},"dropped":{},"released":{},"reestablishments":{},"reestablished":0},)"
      R"("UMTS":{"attempted":0,"established":0,"failed":{},"dropped":{},"released":{},"reestablishments":{},"reestablished":0},)"
      R"("GSM":{"attempted":0,"established":0,"failed":{},"dropped":{},"released":{},"reestablishments":{},"reestablished":0}},)"
      R"("mobility":{"LTE":{"handovers":1,"reselections":0,"reestablishments":0,"unknown":0,"pingpongs":0},"UMTS":{"handovers":0,"reselections":0,"reestablishments":0,"unknown":0,"pingpongs":0},"GSM":{"handovers":0,"reselections":0,"reestablishments":0,"unknown":0,"pingpongs":0}},)"
      R"("carrier_aggregation":{"configured_ms":5000,"activated_ms":5000,"share":0.625},"tx_power":{},)"
      R"("registration":{"emm":1,"mm":0,"gmm":0,"rejects":{"EMM":{},"MM":{},"GMM":{}}},"bearers":{"up":0,"down":0,"active":[]},)"
      R"("no_service":{"count":1,"ms":1000},"gaps":[{"from":1516485166000,"to":1516485260000,"jump_ms":94000}],)"
      R"("kinds":{"gap":1,"technology":3,"cell":3,"handover":1,"rrc":1,"emm":1,"ca-activated":1,"no-service":1}})");
}

TEST(Summary, FitsAScreenWhateverItCounts) {
  Drive drive({umtsCell(0, 10637, 500, 268'435'455)});
  for (std::int64_t at = 45'000; at <= 855'000; at += 45'000)
    drive.play({umtsLevel(at, -70, 43)});
  drive.play({umtsCell(855'000, 10638, 501), umtsLevel(900'000, -70, 43), umtsLevel(950'000, -70, 43),
              umtsLevel(1'000'000, -70, 43)});
  for (int count = 0; count < 1000; ++count)
    drive.play({lteRrc(1'000'000, KLTE_RRC_STATE_CONNECTED), lteRrc(1'000'000, KLTE_RRC_STATE_IDLE)});
  EXPECT_EQ(summaryText(drive.insight),
            "2024 of 2024 events, 2018-01-20 21:52:40 to 2018-01-20 22:09:20 UTC\n"
            "16 min 40 s counted in 1 stretch, 0 gaps\n"
            "technology  UMTS 100 %\n"
            "kpi          count     min    mean  median     max   excellent  good  fair  poor\n"
            "umts.rscp       22     -73   -73.0     -73     -73       100 %   0 %   0 %   0 %\n"
            "umts.ecno       22      -3    -3.0      -3      -3       100 %   0 %   0 %   0 %\n"
            "LTE connections: 999 attempted, 999 established, 0 failed, 0 dropped\n"
            "1000 released\n"
            "UMTS cell changes: 0 handovers, 0 reselections, 1 other, 0 ping-pongs\n"
            "cell                                  time share visits   min mean  max quality\n"
            "PSC 500 UARFCN 10637 CI 268435455 14 min 15 s 86 %    1   -73  -73  -73      -3\n"
            "PSC 501 UARFCN 10638            2 min 25 s  15 %      1   -73  -73  -73      -3");
}

/// The memory of a drive is that of its histograms, rings and bounded tables, whatever comes.
TEST(Summary, IsBoundedHoweverManyCellsAreVisited) {
  Drive drive;
  drive.insight.setStepHandler(nullptr);
  for (std::uint32_t index = 0; index < 5000; ++index)
    drive.play(
        {lteCell(std::int64_t{index} * 1000, 5815, index % 504, index), lteLevel(std::int64_t{index} * 1000, -90)});
  EXPECT_EQ(drive.insight.summary().cells().count(), 4096);
  EXPECT_EQ(drive.insight.happenings().size(), 2000);
  EXPECT_EQ(drive.insight.trend().points(Kpi::lteRsrp).size(), 3600);
  EXPECT_EQ(drive.insight.summary().mobility(Technology::lte).unknown, 4999);
}

}  // namespace
}  // namespace vesk::insight
