#include <cstdlib>
#include <ctime>
#include <gtest/gtest.h>
#include <memory>
#include <string>
#include <vector>

#include "intake/metric_validator.h"
#include "messages/lte/lte.h"
#include "screens/detail_text.h"
#include "screens/first_level_view_controller.h"
#include "screens/second_level_view_controller.h"
#include "screens/third_level_view_controller.h"
#include "screens/vesk_view_controller.h"
#include "support/manual_clock.h"
#include "support/metric_events.h"
#include "support/recorded_output.h"
#include "system/main_queue.h"
#include "system/run_loop.h"
#include "toolkit/system_appearance.h"
#include "values/text_form.h"

namespace vesk {
namespace {

using namespace metrics;

/// Every screen shares the process's intake: each test starts with an empty one.
class Screens : public testing::Test {
 protected:
  Screens() {
    setenv("TZ", "UTC", 1);
    tzset();
    intake->stores = {};
  }

  static std::shared_ptr<SecondLevelViewController> open(std::string_view area, std::string_view category) {
    auto screen = std::make_shared<SecondLevelViewController>();
    screen->firstSelection = Text::copy(area);
    screen->seguedThroughRow = Text::copy(category);
    screen->loadViewIfNeeded();
    return screen;
  }

  /// "[header] main=detail main=detail [header] …", with - for what is absent.
  static std::string shown(TableViewController& screen) {
    TableView& table = screen.tableView();
    std::string out;
    const auto add = [&out](const std::optional<Text>& text) { out += text ? text->view() : "-"; };
    for (std::size_t section = 0; section < table.numberOfSections(); ++section) {
      out += '[';
      add(table.headerTitle(section));
      out += ']';
      for (std::size_t row = 0; row < table.numberOfRows(section); ++row) {
        const TableViewCell* cell = table.cellForRow({section, row});
        out += ' ';
        add(cell->mainText());
        out += '=';
        add(cell->detailText());
      }
    }
    return out;
  }

  ManualClock clock;
  RunLoop loop{clock};
  RecordedOutput output;
  std::shared_ptr<MetricValidator> intake = MetricValidator::shared();
};

TEST_F(Screens, EveryCategoryShowsItsSourceInTheOrderOfTheMenu) {
  int number = 0;
  visitTechnologyFields(intake->stores, [&](std::string_view name, auto& field) {
    const Record record{{Text::copy(name), ++number}};
    if constexpr (std::is_same_v<decltype(field), RecordList&>) {
      field.clear();
      field.append(record);
      field.append({});
    } else {
      field = record;
    }
  });
  visitLatestRecords(intake->stores, [](std::string_view name, LatestRecord& record) {
    record = Record{{Text::copy(name), "latest"_text}};
  });
  std::string all;
  for (const Text& area : VeskViewItems::shared().launchViewItemNames) {
    for (const Text& category : VeskViewItems::shared().categoriesOf(area.view())) {
      all += std::string(area.view()) + ", " + std::string(category.view()) + ": ";
      all += shown(*open(area.view(), category.view())) + " of ";
      appendUpperHex(all, static_cast<std::uint64_t>(sourceOf(area.view(), category.view()).metric.value_or(0)));
      all += '\n';
    }
  }
  EXPECT_EQ(all, R"(Device Info, IMSI: [-] Come back later=Come back later of 0
Device Info, IMEISV: [-] Come back later=Come back later of 0
Device Info, SIM Files: [SIM Content 0] simContents=24[SIM Content 1] of 3C0013
LTE, NAS: [-] myLTEEMMContextDict=latest of 3CD50C
LTE, RRC State: [-] myLTERRCStateDict=latest of 3C4E04
LTE, Serving Cell Info: [-] myLTESCellInfoDict=latest of 3C40C2
LTE, Serving Cell Meas: [-] RsrpRsrqSinr=3 of 3C4F6A
LTE, Tx Power: [TxPowerInfo 0] TxPower=4[TxPowerInfo 1] of 3CD302
LTE, Sel Resel Parameters: [-] SelReselCellInfo=1 of 3CD30E
LTE, EUTRA Neighbor Info: [EUTRA Neighbor 0] EutraNbrs=2[EUTRA Neighbor 1] of 3CD30E
LTE, C-DRX: [-] myLTECDRXConfigDict=latest of 3C4E18
LTE, LTE Neighbor Cell Meas: [LTE Neighbor 0] EutraNbrsMeas=5[LTE Neighbor 1] of 3CD30F
LTE, UMTS Neighbor Cell Meas: [UMTS Neighbor 0] UtraNbrsMeas=6[UMTS Neighbor 1] of 3CD310
LTE, GSM Neighbor Cell Meas: [GSM Neighbor 0] GeraNbrsMeas=7[GSM Neighbor 1] of 3CD310
LTE, CA Status: [Component Carrier 0] CAStatusList=8[Component Carrier 1] of 3CD313
LTE, Active Bearers: [PDP 0] activeBearer=23[PDP 1] of 3CD50D
UMTS, NAS GMM: [-] myGMMContextDict=latest of 3CD50B
UMTS, NAS MM: [-] myMMContextDict=latest of 3CD50A
UMTS, RRC State: [-] myUMTSRRCStateDict=latest of 3CD112
UMTS, RRC Configuration: [-] myUMTSRRCConfigDict=latest of 3CD113
UMTS, Serving Cell Info: [-] myUMTSCellInfoDict=latest of 3C300C
UMTS, Serving Cell Meas: [RxInfo 0] rXInfo=11[RxInfo 1] of 3CD102
UMTS, Tx Power: [TxPowerInfo 0] TxPower=12[TxPowerInfo 1] of 3CD103
UMTS, Sel Resel Parameters: [-] SelReselCellInfo=13 of 3CD104
UMTS, EUTRA Neighbor Info: [EUTRA Neighbor 0] eUtraNbrs=14[EUTRA Neighbor 1] of 3CD104
UMTS, UTRA Neighbor Info: [UTRA Neighbor 0] utraNbrs=15[UTRA Neighbor 1] of 3CD104
UMTS, GSM Neighbor Info: [GSM Neighbor 0] geraNbrs=16[GSM Neighbor 1] of 3CD104
UMTS, LTE Neighbor Cell Meas: [LTE Neighbor 0] eUtraNbrMeas=17[LTE Neighbor 1] of 3CD105
UMTS, UMTS Neighbor Cell Meas: [UMTS Neighbor 0] utraNbrMeas=18[UMTS Neighbor 1] of 3CD105
UMTS, GSM Neighbor Cell Meas: [GSM Neighbor 0] geraNbrMeas=19[GSM Neighbor 1] of 3CD105
UMTS, Active Bearers: [PDP 0] activeBearer=23[PDP 1] of 3CD50D
GSM, NAS GMM: [-] myGMMContextDict=latest of 3CD50B
GSM, NAS MM: [-] myMMContextDict=latest of 3CD50A
GSM, Serving Cell Info: [-] myGSMScellInfoDict=latest of 3C2E0C
GSM, Idle Config: [-] myGSMIdleConfigInfoDict=latest of 3CD001
GSM, Idle Serv Cell Meas: [-] myGSMIdleScellMeasDict=latest of 3CD002
GSM, Connected Serv Cell Meas: [-] myGSMConnRfMeasDict=latest of 3CD003
GSM, GSM GPRS Config: [-] myGSMGPRSConfigDict=latest of 3CD00C
GSM, LTE Neighbor Cell Meas: [LTE Neighbor 0] eUtraNbrMeas=20[LTE Neighbor 1] of 3CD009
GSM, UMTS Neighbor Cell Meas: [UMTS Neighbor 0] utraNbrMeas=21[UMTS Neighbor 1] of 3CD009
GSM, GSM Neighbor Cell Meas: [GSM Neighbor 0] geraNbrMeas=22[GSM Neighbor 1] of 3CD009
GSM, Active Bearers: [PDP 0] activeBearer=23[PDP 1] of 3CD50D
)");
}

TEST_F(Screens, ShowPlaceholdersBeforeAnyEvent) {
  for (const CategorySource& source : categorySources()) {
    const std::string text = shown(*open(source.area, source.category));
    EXPECT_TRUE(text == "[-] -=-" || text.find("Waiting for Update=Waiting for Update") != std::string::npos ||
                text == "[-] Come back later=Come back later" || text.starts_with("[-] timestamp= "))
        << text;
  }
  EXPECT_EQ(output.lines(), std::vector<std::string>{"You are screwed"}) << "said for the serving cell of LTE alone";
  EXPECT_EQ(shown(*open("LTE", "Serving Cell Info")), "[-] -=-");
  EXPECT_EQ(shown(*open("LTE", "Tx Power")), "[TxPowerInfo 0] Waiting for Update=Waiting for Update");
  EXPECT_EQ(shown(*open("Device Info", "IMSI")), "[-] Come back later=Come back later");
  EXPECT_EQ(shown(*open("LTE", "Tx Powers")), "[-] Come back later=Come back later");
  intake->stores.myLTE.RsrpRsrqSinr.clear();
  EXPECT_EQ(shown(*open("LTE", "Serving Cell Meas")), "[-]");
  intake->stores.myLTE.TxPower.clear();
  EXPECT_EQ(shown(*open("LTE", "Tx Power")), "");
}

TEST_F(Screens, ASourceThatShrinksAfterTheCountGivesEmptyRows) {
  intake->stores.myLTE.TxPower.clear();
  intake->stores.myLTE.TxPower.append({{"a"_text, 1}, {"b"_text, 2}});
  intake->stores.myLTE.TxPower.append({{"c"_text, 3}});
  const auto screen = open("LTE", "Tx Power");
  intake->stores.myLTE.TxPower.clear();
  intake->stores.myLTE.TxPower.append({{"a"_text, 9}});
  EXPECT_EQ(shown(*screen), "[TxPowerInfo 0] a=9 -=-[TxPowerInfo 1] -=-");
  screen->tableView().reloadData();
  EXPECT_EQ(shown(*screen), "[TxPowerInfo 0] a=9");
}

TEST_F(Screens, RefreshEveryFiveSecondsUnlessTheUserDrags) {
  const auto screen = open("LTE", "C-DRX");
  EXPECT_EQ(shown(*screen), "[-] -=-");
  KCellularLteCdrxConfig config;
  config.setOnDurationMs(10);
  intake->validateMetric(metricEvent(K_LTE_CDRX_CONFIG, config));

  const auto wait = [&](int milliseconds) {
    clock.advance(std::chrono::milliseconds(milliseconds));
    loop.runDue();
  };
  wait(4999);
  EXPECT_EQ(shown(*screen), "[-] -=-") << "what is in view stays until the next tick";
  const auto reloads = screen->tableView().reloadCount();
  wait(1);
  EXPECT_EQ(screen->tableView().reloadCount(), reloads + 1);
  EXPECT_EQ(shown(*screen), "[-] on_duration_ms=10");
  loop.setMode(RunLoopMode::tracking);
  wait(20000);
  EXPECT_EQ(screen->tableView().reloadCount(), reloads + 1);
  EXPECT_EQ(shown(*screen), "[-] on_duration_ms=10");
  loop.setMode(RunLoopMode::defaultMode);
  loop.runDue();
  EXPECT_EQ(screen->tableView().reloadCount(), reloads + 2);

  screen->didLeaveNavigationStack();
  wait(20000);
  EXPECT_EQ(screen->tableView().reloadCount(), reloads + 2);
}

TEST_F(Screens, ATickOutlivesItsScreen) {
  auto screen = open("LTE", "C-DRX");
  screen->update();
  screen.reset();
  loop.runDue();
}

TEST_F(Screens, PassTheSelectionOnlyFromACellToTheScreenItIsFor) {
  VeskViewController launch;
  FirstLevelViewController first;
  const auto second = std::make_shared<SecondLevelViewController>();
  ThirdLevelViewController other;
  TableViewCell cell("any"_text, CellStyle::Basic, CellAccessory::None);
  cell.setMainText("UMTS"_text);

  launch.prepareForTransition({"t", launch, first}, nullptr);
  launch.prepareForTransition({"t", launch, first}, &launch);
  launch.prepareForTransition({"t", launch, other}, &cell);
  EXPECT_FALSE(first.seguedThroughRow.has_value());
  EXPECT_FALSE(other.seguedThroughRow.has_value());
  launch.prepareForTransition({"t", launch, first}, &cell);
  EXPECT_EQ(first.seguedThroughRow, std::optional("UMTS"_text));

  first.prepareForTransition({"t", first, *second}, &launch);
  EXPECT_FALSE(second->firstSelection.has_value());
  cell.setMainText("Tx Power"_text);
  first.prepareForTransition({"t", first, *second}, &cell);
  EXPECT_EQ(second->firstSelection, std::optional("UMTS"_text));
  EXPECT_EQ(second->seguedThroughRow, std::optional("Tx Power"_text));
  cell.setMainText(std::nullopt);
  first.prepareForTransition({"t", first, *second}, &cell);
  EXPECT_FALSE(second->seguedThroughRow.has_value());
}

TEST_F(Screens, TheOtherScreensShowTheMenuAndNothing) {
  VeskViewController launch;
  launch.loadViewIfNeeded();
  EXPECT_EQ(shown(launch), "[-] Device Info=- LTE=- UMTS=- GSM=-");
  EXPECT_EQ(launch.tableView().footerView(), (FooterView{0, 0}));
  FirstLevelViewController first;
  first.seguedThroughRow = "Device Info"_text;
  first.loadViewIfNeeded();
  EXPECT_EQ(shown(first), "[-] IMSI=- IMEISV=- SIM Files=-");
  EXPECT_FALSE(first.tableView().footerView().has_value());
  FirstLevelViewController lost;
  lost.seguedThroughRow = "gsm"_text;
  lost.loadViewIfNeeded();
  EXPECT_EQ(shown(lost), "[-]");
  ThirdLevelViewController third;
  third.loadViewIfNeeded();
  EXPECT_EQ(shown(third), "[-] -=-");
}

TEST_F(Screens, TakeTheSystemBackgroundWhereThereIsOne) {
  const PlatformVersion present = platformVersion();
  for (const PlatformVersion version : {PlatformVersion{12, 4}, PlatformVersion{13, 0}}) {
    setPlatformVersion(version);
    ThirdLevelViewController screen;
    screen.loadViewIfNeeded();
    EXPECT_EQ(screen.backgroundColor().has_value(), version.release == 13);
  }
  setPlatformVersion(present);
}

TEST_F(Screens, NestedValuesTakeOneLineAnEntry) {
  const Value nested = Dictionary{
      {"guti"_text, Dictionary{{"mmec"_text, 12}, {"m_tmsi"_text, 7}}},
      {"list"_text, Array{Dictionary{{"a"_text, 1}, {"b"_text, Array{2, 3}}}, Dictionary{}}},
      {"empty"_text, Array{}},
  };
  EXPECT_EQ(detailTextOf(nested).view(),
            "guti:\n"
            "  mmec: 12\n"
            "  m_tmsi: 7\n"
            "list:\n"
            "  - a: 1\n"
            "    b: [2, 3]\n"
            "  - {}\n"
            "empty: []");
  EXPECT_EQ(detailTextOf(Array{1, 3, 7}).view(), "[1, 3, 7]");
  EXPECT_EQ(detailTextOf(-19.5F).view(), "-19.5");
}

}  // namespace
}  // namespace vesk
