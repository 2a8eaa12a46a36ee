#include <gtest/gtest.h>

#include "insight/drive.h"

namespace vesk::insight {
namespace {

using enum LteRrcState;
using enum LteRrcCause;
using enum WcdmaRrcConnState;
using enum SccState;
using enum RegStatus;

constexpr LteRrcState kAttempt = KLTE_RRC_STATE_ATMPT_CONNECTION;
constexpr LteRrcState kConnected = KLTE_RRC_STATE_CONNECTED;
constexpr LteRrcState kIdle = KLTE_RRC_STATE_IDLE;

struct DriveCase {
  const char* name;
  std::vector<DriveEvent> events;
  const char* lines;
};

void expectLines(const std::vector<DriveCase>& cases) {
  for (const DriveCase& each : cases)
    EXPECT_EQ(Drive(each.events).lines(), std::string(each.lines).substr(1)) << each.name;
}

TEST(Timeline, TellsHowCellsChange) {
  expectLines({
      {"parts come bit by bit, and a handover is one of a connected phone",
       {lteCell(0, 5815, 338), lteCell(10, {}, 338, 7), lteRrc(20, kConnected), lteLevel(30, -101),
        lteCell(4420, 5815, 328, 8)},
       R"(
technology  LTE
cell  PCI 338 B17 5815
rrc  CONNECTED
handover  PCI 338 B17 5815 -> PCI 328 B17 5815, -101 dBm, after 4.4 s
)"},
      {"back within 10 s is a ping-pong, later is none; the cells look alike but for their identities",
       {lteRrc(0, kIdle), lteCell(0, 2000, 1, 7), lteCell(1000, 2000, 1, 9), lteCell(11'000, 2000, 1, 7),
        lteCell(21'001, 2000, 1, 9)},
       R"(
rrc  IDLE
technology  LTE
cell  PCI 1 B4 2000
reselection  PCI 1 B4 2000 CI 7 -> PCI 1 B4 2000 CI 9, after 1.0 s
reselection  PCI 1 B4 2000 CI 9 -> PCI 1 B4 2000 CI 7, after 10.0 s
pingpong  back to PCI 1 B4 2000 after 10.0 s
reselection  PCI 1 B4 2000 CI 7 -> PCI 1 B4 2000 CI 9, after 10.0 s
)"},
      {"of an LTE phone whose connection is unknown nothing is known; an EARFCN may lie in no band",
       {lteCell(0, 5815, 1), lteCell(10, 70'646, 2)},
       R"(
technology  LTE
cell  PCI 1 B17 5815
cell  PCI 1 B17 5815 -> PCI 2 EARFCN 70646, after 10 ms
)"},
      {"impossible parts are unknown, and an event without any says nothing",
       {lteCell(0, 0xFFFFFFFF, 504, 0x10000000), lteCell(1, {}, 503)},
       R"(
technology  LTE
cell  PCI 503
)"},
      {"on UMTS CELL_DCH decides, other states mean the phone chose, then the last measurement does",
       {umtsCell(0, 10637, 1), umtsCell(10, 10637, 2), umtsLevel(20, -70, 43, true), umtsCell(30, 10637, 3),
        umtsRrc(40, KWCDMA_RRC_CONN_STATE_CELL_FACH), umtsCell(50, 10637, 4),
        umtsRrc(60, KWCDMA_RRC_CONN_STATE_CELL_DCH), umtsCell(70, 10637, 5)},
       R"(
technology  UMTS
cell  PSC 1 UARFCN 10637
cell  PSC 1 UARFCN 10637 -> PSC 2 UARFCN 10637, after 10 ms
handover  PSC 2 UARFCN 10637 -> PSC 3 UARFCN 10637, -73 dBm, after 20 ms
rrc  CELL FACH
reselection  PSC 3 UARFCN 10637 -> PSC 4 UARFCN 10637, -73 dBm, after 20 ms
rrc  CELL DCH, after 20 ms in CELL FACH
handover  PSC 4 UARFCN 10637 -> PSC 5 UARFCN 10637, -73 dBm, after 20 ms
)"},
      {"on GSM the state before the event decides; what was known of a technology left is forgotten",
       {gsmCell(0, 60, 40, GsmDedicatedState::DEDICATED_STATE, 10),
        gsmCell(10, 61, 41, GsmDedicatedState::NON_DEDICATED_STATE, 11), lteCell(20, 5815, 338),
        gsmCell(30, 60, 40, GsmDedicatedState::NON_DEDICATED_STATE)},
       R"(
technology  GSM
cell  BSIC 40 ARFCN 60
area  LAI 460-00 10
rrc  DEDICATED STATE
handover  BSIC 40 ARFCN 60 -> BSIC 41 ARFCN 61, after 10 ms
area  LAI 460-00 10 -> 460-00 11
rrc  NON DEDICATED STATE, after 10 ms in DEDICATED STATE
technology  GSM -> LTE
cell  PCI 338 B17 5815
technology  LTE -> GSM
cell  BSIC 40 ARFCN 60
rrc  NON DEDICATED STATE
)"},
  });
}

TEST(Timeline, TellsWhatBecomesOfConnections) {
  expectLines({
      {"re-established on another cell; the level before is that of the attempt",
       {lteCell(0, 850, 443), lteRrc(0, kConnected, KLTE_RRC_CAUSE_EST_MO_DATA, kIdle), lteLevel(10, -125),
        lteRrc(20, kAttempt, KLTE_RRC_CAUSE_REEST_OTHER_FAIL), lteCell(60, 5815, 271), lteLevel(70, -104),
        lteRrc(121, kConnected, KLTE_RRC_CAUSE_REEST_OTHER_FAIL)},
       R"(
technology  LTE
cell  PCI 443 B2 850
rrc  CONNECTED, EST MO DATA
rrc  ATMPT CONNECTION, REEST OTHER FAIL, after 20 ms in CONNECTED
cell  PCI 443 B2 850 -> PCI 271 B17 5815, -125 dBm, after 60 ms
rrc  CONNECTED, REEST OTHER FAIL, after 101 ms in ATMPT CONNECTION
reestablished  PCI 443 B2 850 -> PCI 271 B17 5815, REEST OTHER FAIL, 101 ms, -125 dBm before
)"},
      {"a re-establishment that ends as a new set-up was a drop",
       {lteRrc(0, kAttempt, KLTE_RRC_CAUSE_REEST_HO_FAIL), lteRrc(10, kConnected, KLTE_RRC_CAUSE_EST_MO_DATA)},
       R"(
technology  LTE
rrc  ATMPT CONNECTION, REEST HO FAIL
rrc  CONNECTED, EST MO DATA, after 10 ms in ATMPT CONNECTION
drop  REEST HO FAIL
)"},
      {"another kind of attempt is a change, the same kind again is none",
       {lteRrc(0, kAttempt, KLTE_RRC_CAUSE_REEST_HO_FAIL), lteRrc(5, kAttempt, KLTE_RRC_CAUSE_REEST_OTHER_FAIL),
        lteRrc(10, kAttempt, KLTE_RRC_CAUSE_EST_MT_ACC), lteRrc(20, kIdle, KLTE_RRC_CAUSE_EST_FAIL_REJ)},
       R"(
technology  LTE
rrc  ATMPT CONNECTION, REEST HO FAIL
rrc  ATMPT CONNECTION, EST MT ACC, after 10 ms in ATMPT CONNECTION
drop  REEST HO FAIL
rrc  IDLE, EST FAIL REJ, after 10 ms in ATMPT CONNECTION
connection-failed  EST FAIL REJ
)"},
      {"of an attempt that was not seen the state before tells; its end without a cell has none to go back to",
       {lteRrc(0, kConnected, KLTE_RRC_CAUSE_REEST_HO_FAIL, kAttempt, 57),
        lteRrc(10, kIdle, KLTE_RRC_CAUSE_REL_CONN_FAIL_T311_EXP), lteRrc(20, kAttempt), lteRrc(30, kIdle)},
       R"(
technology  LTE
rrc  CONNECTED, REEST HO FAIL, after 57 ms in ATMPT CONNECTION
reestablished  REEST HO FAIL, 57 ms
rrc  IDLE, REL CONN FAIL T311 EXP, after 10 ms in CONNECTED
drop  REL CONN FAIL T311 EXP
rrc  ATMPT CONNECTION, after 10 ms in IDLE
rrc  IDLE, after 10 ms in ATMPT CONNECTION
connection-failed  no cause
)"},
      {"a radio link failure of UMTS is a drop whatever its cause; a release is none",
       {umtsRrc(0, KWCDMA_RRC_CONN_STATE_CELL_DCH), umtsRrc(10, KWCDMA_RRC_CONN_STATE_RADIO_LINK_FAILURE),
        umtsRrc(20, KWCDMA_RRC_CONN_STATE_CELL_DCH),
        umtsRrc(30, KWCDMA_RRC_CONN_STATE_IDLE, RrcReleaseCause::KRRC_REL_NORMAL_EVENT)},
       R"(
technology  UMTS
rrc  CELL DCH
rrc  RADIO LINK FAILURE, after 10 ms in CELL DCH
drop  no cause
rrc  CELL DCH, after 10 ms in RADIO LINK FAILURE
rrc  IDLE, NORMAL EVENT, after 10 ms in CELL DCH
)"},
      {"carriers and C-DRX end with the connection; the state is known from C-DRX, a sentinel is no duration",
       {cdrx(0, 1, 10, kConnected), carriers(0, {{2, SCC_STATE_ACTIVATED, 5815, 338}}),
        lteRrc(10, kIdle, KLTE_RRC_CAUSE_NA, {}, 0xFFFFFFFF)},
       R"(
cdrx-setup  10 ms of 320 ms
ca-activated  SCC 2 PCI 338 B17 5815, 5 MHz
rrc  IDLE, after 10 ms in CONNECTED
ca-released  SCC 2 PCI 338 B17 5815, 5 MHz
cdrx-released  off
)"},
  });
}

TEST(Timeline, TellsRegistrationsCarriersAndBearers) {
  expectLines({
      {"a reject is told until it is another or was none; no service is that of the technology in use",
       {emm(0, KREG_STATUS_NO_SERVICE, EmmCause::EMM_CAUSE_NO_SUITABLE_CELLS_IN_TRACKING_AREA),
        emm(5, KREG_STATUS_NO_SERVICE, EmmCause::EMM_CAUSE_NO_SUITABLE_CELLS_IN_TRACKING_AREA), umtsCell(10, 10637, 1),
        mm(20, KREG_STATUS_POWER_OFF_NO_SERVICE), gmm(30, KREG_STATUS_NO_SERVICE), gmm(696, KREG_STATUS_NORMAL_SERVICE),
        emm(700, KREG_STATUS_NORMAL_SERVICE, {}, EmmProc::EMM_PROC_SERV_REQ),
        emm(710, KREG_STATUS_NORMAL_SERVICE, static_cast<EmmCause>(77))},
       R"(
emm  NO SERVICE
reject  EMM #15 NO SUITABLE CELLS IN TRACKING AREA
no-service  no service
technology  UMTS
cell  PSC 1 UARFCN 10637
service  back after 10 ms
mm  POWER OFF NO SERVICE
no-service  no service
area  RAI 460-00 4566 100
gmm  NO SERVICE
gmm  NO SERVICE -> NORMAL SERVICE
service  back after 676 ms
emm  NO SERVICE -> NORMAL SERVICE, SERV REQ
reject  EMM (unknown: 77)
)"},
      {"carriers by index; without a state one only measures; a carrier on another cell is a new one",
       {carriers(0, {{1, SCC_STATE_CONFIGURED_DEACTIVATED, 5815, 338}, {{}, SCC_STATE_ACTIVATED, 5780, 1}}),
        carriers(1, {{1, {}, 5780, 1}}), carriers(2, {{1, SCC_STATE_ACTIVATED}}),
        carriers(3, {{1, SCC_STATE_ACTIVATED, 5780, 197}}), carriers(4, {{1, SCC_STATE_CONFIGURED_DEACTIVATED}}),
        carriers(5, {{1, SCC_STATE_DECONFIGURED}, {1, SCC_STATE_DECONFIGURED}})},
       R"(
ca-configured  SCC 1 PCI 338 B17 5815, 5 MHz
ca-activated  SCC 1 PCI 338 B17 5815, 5 MHz
ca-activated  SCC 1 PCI 197 B17 5780, 5 MHz
ca-deactivated  SCC 1 PCI 197 B17 5780, 5 MHz
ca-released  SCC 1 PCI 197 B17 5780, 5 MHz
)"},
      {"bearers go down before others come up; C-DRX with other parameters is set up again",
       {bearers(0, {6, 5, 6}), bearers(10, {7, 5}), bearers(20, {}), cdrx(30, 1, 10), cdrx(40, 1, 10), cdrx(50, 1),
        cdrx(60, 0), cdrx(70, 0), cdrx(80, 2)},
       R"(
bearer-up  bearer 5 internet IPv4 PDN
bearer-up  bearer 6
bearer-down  bearer 6
bearer-up  bearer 7
bearer-down  bearer 5
bearer-down  bearer 7
cdrx-setup  10 ms of 320 ms
cdrx-setup  cycle 320 ms
cdrx-released  off
)"},
  });
}

TEST(Timeline, JumpsAtAGapAndForgetsThere) {
  constexpr std::int64_t kNoTime = -kStart;
  Drive drive({
      lteCell(kNoTime, 5815, 338),
      emm(0, KREG_STATUS_NO_SERVICE),
      lteCell(0, 5815, 338, {}, 19'974),
      lteCell(kNoTime, 5815, 328, {}, 19'975),
      lteLevel(-5000, -90),
      lteLevel(60'000, -91),
      lteCell(120'001, 5815, 338, {}, 19'975),
      lteCell(115'000, 5815, 338),
      lteCell(9'999'999'999'999 - kStart + 1, 5815, 338),
  });
  EXPECT_EQ(drive.lines(), R"(emm  NO SERVICE
no-service  no service
technology  LTE
cell  PCI 338 B17 5815
area  TAI 310-410 19974
cell  PCI 338 B17 5815 -> PCI 328 B17 5815, after 0 ms
area  TAI 310-410 19974 -> 310-410 19975
gap  1 min 00 s later
technology  LTE
cell  PCI 338 B17 5815
area  TAI 310-410 19975
gap  5.0 s earlier
technology  LTE
cell  PCI 338 B17 5815
)");
  EXPECT_EQ(drive.insight.counts().untimed, 1);
  EXPECT_EQ(drive.insight.clock().counted(), 60'000);
  EXPECT_EQ(drive.insight.clock().stretches(), 3);
  EXPECT_EQ(drive.insight.now(), kStart + 115'000);
}

std::string jsonOf(const std::vector<TimelineEvent>& events) {
  std::string out;
  for (const TimelineEvent& each : events) {
    JsonWriter json(out);
    writeJson(json, each);
    json.finish();
    // What every line has is looked at once.
    const std::size_t fields = out.rfind("\"text\":");
    if (&each != &events.front()) out.erase(out.rfind("{\"timestamp\""), fields - out.rfind("{\"timestamp\""));
    out += '\n';
  }
  return out;
}

TEST(Timeline, HasAJsonFormOfEveryKind) {
  const auto rule = std::get<Rule>(parseRule("lte.rsrp<-99.5 for 1 s"));
  Drive drive(
      {lteCell(0, 850, 443), lteRrc(0, kConnected, KLTE_RRC_CAUSE_EST_MO_DATA, kAttempt), lteLevel(10, -101),
       lteCell(20, 5815, 271, 7, 19'974), lteCell(30, 850, 443), lteRrc(40, kAttempt, KLTE_RRC_CAUSE_REEST_HO_FAIL),
       lteRrc(141, kConnected, {}, kAttempt, 91), lteRrc(200, kIdle, KLTE_RRC_CAUSE_REL_T310_EXP),
       emm(210, KREG_STATUS_NO_SERVICE, EmmCause::EMM_CAUSE_CONGESTION, EmmProc::EMM_PROC_TAU),
       emm(220, KREG_STATUS_NORMAL_SERVICE), carriers(300, {{1, SCC_STATE_ACTIVATED, {}, 338}}), bearers(310, {5, 6}),
       bearers(320, {}), cdrx(330, 1, 10), lteLevel(1010, -102), emm(70'000, KREG_STATUS_NO_SERVICE)},
      {rule});
  EXPECT_EQ(jsonOf(drive.timeline),
            R"({"timestamp":1516485160000,"event":0,"kind":"technology","text":"LTE","from":null,"to":"LTE"}
"text":"PCI 443 B2 850","technology":"LTE","how":"first","from":null,"to":{"channel":850,"code":443,"cell_id":null},"level":null,"stay_ms":null}
"text":"CONNECTED, EST MO DATA","technology":"LTE","from":"ATMPT_CONNECTION","to":"CONNECTED","cause":"EST_MO_DATA","duration_ms":null}
"text":"PCI 443 B2 850 -> PCI 271 B17 5815, -101 dBm, after 20 ms","technology":"LTE","from":{"channel":850,"code":443,"cell_id":null},"to":{"channel":5815,"code":271,"cell_id":7},"level":-101,"stay_ms":20}
"text":"TAI 310-410 19974","area":"TAI","from":null,"to":"310-410 19974"}
"text":"PCI 271 B17 5815 -> PCI 443 B2 850, -101 dBm, after 10 ms","technology":"LTE","from":{"channel":5815,"code":271,"cell_id":7},"to":{"channel":850,"code":443,"cell_id":null},"level":-101,"stay_ms":10}
"text":"back to PCI 443 B2 850 after 10 ms","technology":"LTE","cell":{"channel":850,"code":443,"cell_id":null},"other":{"channel":5815,"code":271,"cell_id":7},"stay_ms":10}
"text":"ATMPT CONNECTION, REEST HO FAIL, after 40 ms in CONNECTED","technology":"LTE","from":"CONNECTED","to":"ATMPT_CONNECTION","cause":"REEST_HO_FAIL","duration_ms":40}
"text":"CONNECTED, after 91 ms in ATMPT CONNECTION","technology":"LTE","from":"ATMPT_CONNECTION","to":"CONNECTED","cause":null,"duration_ms":91}
"text":"PCI 443 B2 850 -> PCI 443 B2 850, REEST HO FAIL, 91 ms, -101 dBm before","technology":"LTE","cause":"REEST_HO_FAIL","duration_ms":91,"from":{"channel":850,"code":443,"cell_id":null},"to":{"channel":850,"code":443,"cell_id":null},"level":-101}
"text":"IDLE, REL T310 EXP, after 59 ms in CONNECTED","technology":"LTE","from":"CONNECTED","to":"IDLE","cause":"REL_T310_EXP","duration_ms":59}
"text":"REL T310 EXP, PCI 443 B2 850, -101 dBm","technology":"LTE","cause":"REL_T310_EXP","cell":{"channel":850,"code":443,"cell_id":null},"level":-101}
"text":"NO SERVICE, TAU","from":null,"to":"NO_SERVICE","procedure":"TAU"}
"text":"EMM #22 CONGESTION","registration":"EMM","cause":"CONGESTION","code":22,"procedure":"TAU"}
"text":"no service","technology":"LTE"}
"text":"NO SERVICE -> NORMAL SERVICE","from":"NO_SERVICE","to":"NORMAL_SERVICE","procedure":null}
"text":"back after 10 ms","technology":"LTE","duration_ms":10}
"text":"SCC 1 PCI 338, 5 MHz","index":1,"channel":null,"code":338,"mhz":5}
"text":"bearer 5 internet IPv4 PDN","bearer":5,"apn":"internet","type":"IPv4_PDN"}
"text":"bearer 6","bearer":6,"apn":null,"type":null}
"text":"bearer 5","bearer":5}
"text":"bearer 6","bearer":6}
"text":"10 ms of 320 ms","on_ms":10,"inactivity_ms":null,"long_ms":320,"short_ms":null}
"text":"lte.rsrp<-99.5 for 1 s: -102 since 1.0 s","rule":"lte.rsrp<-99.5 for 1 s","since":1516485160010,"value":-102}
"text":"1 min 08 s later","from":1516485161010,"jump_ms":68990}
"text":"NO SERVICE","from":null,"to":"NO_SERVICE","procedure":null}
"text":"no service","technology":null}
)");
}

}  // namespace
}  // namespace vesk::insight
