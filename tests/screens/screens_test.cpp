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
    } else {
      field = record;
    }
  });
  visitLatestRecords(intake->stores, [](std::string_view name, LatestRecord& record) {
    record = Record{{Text::copy(name), ""_text}};
  });
  std::string all;
  for (const Text& area : VeskViewItems::shared().launchViewItemNames) {
    for (const Text& category : VeskViewItems::shared().categoriesOf(area.view())) {
      all += std::string(category.view()) + ": " + shown(*open(area.view(), category.view())) + ' ';
      appendUpperHex(all, static_cast<std::uint64_t>(sourceOf(area.view(), category.view()).metric.value_or(0)));
      all += '\n';
    }
  }
  EXPECT_EQ(all,
            "IMSI: [-] Come back later=Come back later 0\nIMEISV: [-] Come back later=Come back later 0\n"
            "SIM Files: [SIM Content 0] simContents=24 3C0013\nNAS: [-] myLTEEMMContextDict= 3CD50C\n"
            "RRC State: [-] myLTERRCStateDict= 3C4E04\nServing Cell Info: [-] myLTESCellInfoDict= 3C40C2\n"
            "Serving Cell Meas: [-] RsrpRsrqSinr=3 3C4F6A\nTx Power: [TxPowerInfo 0] TxPower=4 3CD302\n"
            "Sel Resel Parameters: [-] SelReselCellInfo=1 3CD30E\n"
            "EUTRA Neighbor Info: [EUTRA Neighbor 0] EutraNbrs=2 3CD30E\nC-DRX: [-] myLTECDRXConfigDict= 3C4E18\n"
            "LTE Neighbor Cell Meas: [LTE Neighbor 0] EutraNbrsMeas=5 3CD30F\n"
            "UMTS Neighbor Cell Meas: [UMTS Neighbor 0] UtraNbrsMeas=6 3CD310\n"
            "GSM Neighbor Cell Meas: [GSM Neighbor 0] GeraNbrsMeas=7 3CD310\n"
            "CA Status: [Component Carrier 0] CAStatusList=8 3CD313\nActive Bearers: [PDP 0] activeBearer=23 3CD50D\n"
            "NAS GMM: [-] myGMMContextDict= 3CD50B\nNAS MM: [-] myMMContextDict= 3CD50A\n"
            "RRC State: [-] myUMTSRRCStateDict= 3CD112\nRRC Configuration: [-] myUMTSRRCConfigDict= 3CD113\n"
            "Serving Cell Info: [-] myUMTSCellInfoDict= 3C300C\nServing Cell Meas: [RxInfo 0] rXInfo=11 3CD102\n"
            "Tx Power: [TxPowerInfo 0] TxPower=12 3CD103\nSel Resel Parameters: [-] SelReselCellInfo=13 3CD104\n"
            "EUTRA Neighbor Info: [EUTRA Neighbor 0] eUtraNbrs=14 3CD104\n"
            "UTRA Neighbor Info: [UTRA Neighbor 0] utraNbrs=15 3CD104\n"
            "GSM Neighbor Info: [GSM Neighbor 0] geraNbrs=16 3CD104\n"
            "LTE Neighbor Cell Meas: [LTE Neighbor 0] eUtraNbrMeas=17 3CD105\n"
            "UMTS Neighbor Cell Meas: [UMTS Neighbor 0] utraNbrMeas=18 3CD105\n"
            "GSM Neighbor Cell Meas: [GSM Neighbor 0] geraNbrMeas=19 3CD105\n"
            "Active Bearers: [PDP 0] activeBearer=23 3CD50D\nNAS GMM: [-] myGMMContextDict= 3CD50B\n"
            "NAS MM: [-] myMMContextDict= 3CD50A\nServing Cell Info: [-] myGSMScellInfoDict= 3C2E0C\n"
            "Idle Config: [-] myGSMIdleConfigInfoDict= 3CD001\n"
            "Idle Serv Cell Meas: [-] myGSMIdleScellMeasDict= 3CD002\n"
            "Connected Serv Cell Meas: [-] myGSMConnRfMeasDict= 3CD003\n"
            "GSM GPRS Config: [-] myGSMGPRSConfigDict= 3CD00C\n"
            "LTE Neighbor Cell Meas: [LTE Neighbor 0] eUtraNbrMeas=20 3CD009\n"
            "UMTS Neighbor Cell Meas: [UMTS Neighbor 0] utraNbrMeas=21 3CD009\n"
            "GSM Neighbor Cell Meas: [GSM Neighbor 0] geraNbrMeas=22 3CD009\n"
            "Active Bearers: [PDP 0] activeBearer=23 3CD50D\n");
}

TEST_F(Screens, AListIsFilledOnceItHasAnElement) {
  const CategorySource& power = sourceOf("LTE", "Tx Power");
  EXPECT_FALSE(isListFilled(power, intake->stores));
  intake->stores.myLTE.TxPower.clear();
  EXPECT_FALSE(isListFilled(power, intake->stores));
  intake->stores.myLTE.TxPower.append(Record{{"chan"_text, 3}});
  EXPECT_TRUE(isListFilled(power, intake->stores));
  EXPECT_TRUE(isListFilled(sourceOf("LTE", "NAS"), intake->stores));
}

TEST_F(Screens, ShowPlaceholdersBeforeAnyEvent) {
  for (const CategorySource& source : categorySources())
    EXPECT_NE(shown(*open(source.area, source.category)), "");
  EXPECT_EQ(output.lines(), std::vector<std::string>{"You are screwed"}) << "said for the serving cell of LTE alone";
  EXPECT_EQ(shown(*open("LTE", "Serving Cell Info")), "[-] -=-");
  EXPECT_EQ(shown(*open("LTE", "Tx Power")), "[TxPowerInfo 0] Waiting for Update=Waiting for Update");
  EXPECT_EQ(shown(*open("LTE", "Tx Powers")), "[-] Come back later=Come back later");
  intake->stores.myLTE.RsrpRsrqSinr.clear();
  EXPECT_EQ(shown(*open("LTE", "Serving Cell Meas")), "[-]");
  intake->stores.myLTE.RsrpRsrqSinr.append({{"rsrp0"_text, -95}});
  intake->stores.myLTE.RsrpRsrqSinr.append({{"rsrp0"_text, -96}});
  EXPECT_EQ(shown(*open("LTE", "Serving Cell Meas")), "[-] rsrp0=-95");
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
  TableViewCell cell("any"_text, CellStyle::Basic, CellAccessory::None);
  cell.setMainText("UMTS"_text);
  launch.prepareForTransition({"t", launch, first}, nullptr);
  launch.prepareForTransition({"t", launch, first}, &launch);
  launch.prepareForTransition({"t", launch, *second}, &cell);
  EXPECT_FALSE(first.seguedThroughRow.has_value() || second->seguedThroughRow.has_value());
  launch.prepareForTransition({"t", launch, first}, &cell);
  EXPECT_EQ(first.seguedThroughRow, std::optional("UMTS"_text));

  first.prepareForTransition({"t", first, *second}, &launch);
  EXPECT_FALSE(second->firstSelection.has_value());
  cell.setMainText("Tx Power"_text);
  first.prepareForTransition({"t", first, *second}, &cell);
  EXPECT_EQ(second->firstSelection, std::optional("UMTS"_text));
  EXPECT_EQ(second->seguedThroughRow, std::optional("Tx Power"_text));
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
