#include <cstdlib>
#include <ctime>
#include <gtest/gtest.h>
#include <memory>
#include <string>
#include <vector>

#include "intake/metric_validator.h"
#include "messages/gsm/gsm.h"
#include "messages/lte/lte.h"
#include "messages/wcdma/wcdma.h"
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

namespace vesk {
namespace {

using namespace metrics;

/// Every screen shares the process's intake: each test starts with an empty one.
class Screens : public testing::Test {
 protected:
  Screens() {
    setenv("TZ", "UTC", 1);
    tzset();
    const auto fresh = MetricValidator::listeningTo(nullptr);
    for (const auto& [name, record] : kLatestRecords)
      (*intake).*record = (*fresh).*record;
    intake->myLTE = fresh->myLTE;
    intake->myUMTS = fresh->myUMTS;
    intake->myGSM = fresh->myGSM;
    intake->myCommon = fresh->myCommon;
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

TEST_F(Screens, TheMenuHasItsCategories) {
  const VeskViewItems items;
  const std::vector<std::size_t> counts{3, 13, 15, 11};
  ASSERT_EQ(items.launchViewItemNames.size(), counts.size());
  EXPECT_EQ(items.firstLevelViewItems.size(), counts.size());
  for (std::size_t area = 0; area < counts.size(); ++area) {
    EXPECT_EQ(items.categoriesOf(items.launchViewItemNames[area].view()).size(), counts[area]);
  }
  EXPECT_EQ(items.categoriesOf("GSM")[6], "GSM GPRS Config");
  EXPECT_TRUE(items.categoriesOf("gsm").empty());
}

TEST_F(Screens, EveryPairShowsItsSourceBeforeAnyEvent) {
  std::size_t pairs = 0;
  std::string kinds;
  for (const Text& area : VeskViewItems::shared().launchViewItemNames) {
    for (const Text& category : VeskViewItems::shared().categoriesOf(area.view())) {
      ++pairs;
      SCOPED_TRACE(std::string(area.view()) + " " + std::string(category.view()));
      const CategorySource& source = sourceOf(area.view(), category.view());
      const std::string text = shown(*open(area.view(), category.view()));
      switch (source.kind) {
        case SourceKind::metricRecord:
          kinds += 'D';
          EXPECT_EQ(text, "[-] -=-");
          break;
        case SourceKind::storeRecord:
          kinds += 'S';
          EXPECT_TRUE(text.starts_with("[-] timestamp= ")) << text;
          break;
        case SourceKind::storeList:
          kinds += 'L';
          EXPECT_TRUE(source.headerPrefix.ends_with(' '));
          EXPECT_EQ(text, "[" + std::string(source.headerPrefix) + "0] Waiting for Update=Waiting for Update");
          break;
        case SourceKind::firstElement:
          kinds += 'F';
          EXPECT_EQ(text, "[-] Waiting for Update=Waiting for Update");
          break;
        case SourceKind::placeholder:
          kinds += 'P';
          EXPECT_EQ(text, "[-] Come back later=Come back later");
          EXPECT_FALSE(source.metric.has_value());
          break;
      }
    }
  }
  EXPECT_EQ(pairs, 42U);
  EXPECT_EQ(kinds, "PPLDDDFLSLDLLLLLDDDDDLLSLLLLLLLDDDDDDDLLLL");
  EXPECT_EQ(output.lines(), std::vector<std::string>{"You are screwed"});
  EXPECT_EQ(shown(*open("LTE", "Tx Powers")), "[-] Come back later=Come back later");
  EXPECT_EQ(shown(*open("", "")), "[-] Come back later=Come back later");
}

TEST_F(Screens, ShowWhatTheStoresHold) {
  intake->myUMTS.TxPower.clear();
  intake->myUMTS.TxPower.append({{"pucch_tx_power"_text, -5}, {"timestamp"_text, "now"_text}});
  intake->myUMTS.TxPower.append({{"pusch_tx_power"_text, 2.5F}});
  EXPECT_EQ(shown(*open("UMTS", "Tx Power")),
            "[TxPowerInfo 0] pucch_tx_power=-5 timestamp=now[TxPowerInfo 1] pusch_tx_power=2.5");
  EXPECT_EQ(shown(*open("LTE", "Tx Power")), "[TxPowerInfo 0] Waiting for Update=Waiting for Update");

  intake->myLTE.RsrpRsrqSinr.clear();
  EXPECT_EQ(shown(*open("LTE", "Serving Cell Meas")), "[-]");
  for (const int rsrp : {-95, -96, -97})
    intake->myLTE.RsrpRsrqSinr.append({{"rsrp0"_text, rsrp}});
  EXPECT_EQ(shown(*open("LTE", "Serving Cell Meas")), "[-] rsrp0=-95");

  intake->myGSM.geraNbrMeas.clear();
  EXPECT_EQ(shown(*open("GSM", "GSM Neighbor Cell Meas")), "");

  KCellularGsmGprsConfig gprs;
  gprs.setRac(7);
  intake->validateMetric(metricEvent(K_GSM_GPRS_CONFIG, gprs));
  EXPECT_EQ(shown(*open("GSM", "GSM GPRS Config")), "[-] rac=7");
}

TEST_F(Screens, ASourceThatShrinksAfterTheCountGivesEmptyRows) {
  intake->myLTE.TxPower.clear();
  intake->myLTE.TxPower.append({{"a"_text, 1}, {"b"_text, 2}});
  intake->myLTE.TxPower.append({{"c"_text, 3}});
  const auto screen = open("LTE", "Tx Power");
  intake->myLTE.TxPower.clear();
  intake->myLTE.TxPower.append({{"a"_text, 9}});
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
