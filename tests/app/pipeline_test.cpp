// From recorded events to stores, printed lines and screens: the program itself, and its screens in this process.

#include <cstdlib>
#include <ctime>
#include <map>
#include <variant>

#include "app/connected_program.h"
#include "app/vesk_program.h"
#include "handset/handset.h"
#include "handset/recording.h"
#include "messages/gsm/gsm.h"
#include "messages/lte/lte.h"
#include "messages/nas/nas.h"
#include "recording/recording_reader.h"
#include "screens/vesk_view_items.h"
#include "support/recorded_output.h"
#include "toolkit/table_view_controller.h"

namespace vesk {
namespace {

using namespace metrics;

class Pipeline : public testing::Test {
 protected:
  Pipeline() {
    setenv("TZ", "UTC", 1);
    tzset();
  }
};

std::string rrcState(double at, std::uint64_t timestamp, LteRrcState state) {
  KCellularLteRrcState message;
  message.setTimestamp(timestamp);
  message.setState(state);
  return recorded(at, K_LTE_RRC_STATE, message);
}

const std::string kStartLines = "pushing metric file\nQuerying SIM files\n";
const std::string kConnectedLines =
    "Metric ID in Hex =  3C4E04\n"
    "Current RRC state is  {timestamp: 1970-01-01 00:00:01 UTC, state: KLTE_RRC_STATE_CONNECTED}\n"
    "Received Valid Metric\n";

std::string connected() {
  return rrcState(1, 1500, LteRrcState::KLTE_RRC_STATE_CONNECTED);
}

TEST_F(Pipeline, PrintsTheLinesOfEveryEvent) {
  KCellularLteScellInfo cell;
  cell.setDlBw(7);
  cell.setUlBw(1);
  const std::string recording = recorded(0, K_LTE_RLF, cell) + recorded(0, K_LTE_SCELL_INFO, cell) +
                                "{\"at\": 1, \"metric\": \"0x3C4E04\", \"payload\": \"08\"}\n" + connected();
  const Finished finished = vesk({"--headless", "--log", "none", "--speed", "max", "--replay", "-"}, recording);
  EXPECT_EQ(
      finished.output,
      kStartLines +
          "Metric ID in Hex =  3C4E25\nI dont care for this Metric\n"
          "Metric ID in Hex =  3C40C2\nCurrent Serving Cell Info is  {dl_bw: 3, ul_bw: 0}\nReceived Valid Metric\n"
          "Metric ID in Hex =  3C4E04\nI dont care for this Metric\n" +
          kConnectedLines);
  EXPECT_EQ(finished.error, "");
  EXPECT_EQ(finished.status, 0);
}

TEST_F(Pipeline, FillsTheStoresUpToTheLastEvent) {
  const auto carrier = std::make_shared<SecondaryComponentCarrier>();
  carrier->setRsrp(-785);
  carrier->setRsrq(-50);
  carrier->setRssi(199);
  carrier->setDlBandwidth(5);
  KCellularLteCarrierAggregationStatus aggregation;
  aggregation.addSccList(carrier);
  KCellularLteRsrpRsrqSinr levels;
  levels.setTimestamp(0xFFFFFFFFFFFFFFFF);
  levels.addInstValues(std::make_shared<RsrpRsrqSinr>());
  KCellularGsmGrrEventMeasCr neighbours;
  neighbours.addGsmNcellMeas(std::make_shared<GsmNcellMeas>());
  neighbours.gsmNcellMeasAtIndex(0)->setRxlev(63);
  const Finished finished =
      vesk({"stores"}, recorded(0, K_LTE_CA_STATUS, aggregation) + recorded(0, K_LTE_RSRP_RSRQ_SINR, levels) +
                           recorded(0, K_GSM_NCELL_MEAS, neighbours) +
                           rrcState(0, 0, LteRrcState::KLTE_RRC_STATE_IDLE) + connected());
  const char* parts[] = {
      R"({"dictionaries":{"myLTERRCStateDict":{"timestamp":"1970-01-01 00:00:01 UTC",)",
      R"("state":"KLTE_RRC_STATE_CONNECTED"},"myLTECDRXConfigDict":null,)",
      R"("CAStatusList":[{"dl_bandwidth":20.0,"rsrp":-7,"rsrq":-0.5,"rssi":1}],)",
      R"("RsrpRsrqSinr":[{"timestamp":"584556019-04-03 14:25:52 UTC"}],)",
      R"("myLTERsrpRsrqSinrDict":{"timestamp":18446744073709551615,"inst_values":[{}]},)",
      R"("GSM":{"eUtraNbrMeas":[{"Waiting for Update":"Waiting for Update"}],)",
      R"("geraNbrMeas":[{"rxlev":-47}]})",
      R"("IMSI":"Come Back Later"})",
  };
  for (const char* part : parts)
    EXPECT_NE(finished.output.find(part), std::string::npos) << part << '\n' << finished.output;
  EXPECT_EQ(finished.error, "");
  EXPECT_EQ(finished.status, 0);
}

TEST_F(Pipeline, GoesOnBehindLinesThatAreNoEventAndTellsTheUser) {
  const TemporaryFile recording("{}\nbad\n" + connected());
  const std::string told = recording.path() + ":1: \"at\": missing\n" + recording.path() + ":2: no JSON object\n";
  struct Case {
    std::vector<std::string> arguments;
    std::string output;
  };
  const Case cases[] = {
      {{"--headless", "--log", "none", "--speed", "max", "--replay", recording.path()}, kStartLines + kConnectedLines},
      {{"show", "LTE", "RRC State", recording.path(), "--json"},
       R"({"area":"LTE","category":"RRC State","sections":[{"header":null,"rows":[)"
       R"({"key":"timestamp","value":"1970-01-01 00:00:01 UTC"},{"key":"state","value":"KLTE_RRC_STATE_CONNECTED"}]}]})"
       "\n"},
      {{"show", "LTE", "RRC State", recording.path()},
       "LTE › RRC State\n  timestamp  1970-01-01 00:00:01 UTC\n  state      KLTE_RRC_STATE_CONNECTED\n"},
  };
  for (const Case& row : cases) {
    const Finished finished = vesk(row.arguments);
    EXPECT_EQ(finished.output, row.output);
    EXPECT_EQ(finished.error, told);
    EXPECT_EQ(finished.status, 1);
  }
}

TEST_F(Pipeline, ShowsWhatAnUnknownPairShowsAndTellsWhichThereAre) {
  struct Case {
    const char* area;
    const char* category;
    const char* told;
  };
  const Case cases[] = {
      {"GSM", "GPRS Config",
       "vesk: no category \"GPRS Config\" in GSM; did you mean \"GSM GPRS Config\"; there are: NAS GMM, NAS MM, "},
      {"gsm", "NAS MM", "vesk: no area \"gsm\"; did you mean \"GSM\"; there are: Device Info, LTE, UMTS, GSM\n"},
      {"\x1B[2J", "\x1B[2J", "vesk: no area \""},
  };
  for (const Case& row : cases) {
    const Finished finished = vesk({"show", row.area, row.category}, connected());
    EXPECT_TRUE(finished.error.starts_with(row.told)) << finished.error;
    EXPECT_NE(finished.output.find("\n  Come back later  Come back later\n"), std::string::npos) << finished.output;
    EXPECT_EQ((finished.output + finished.error).find('\x1B'), std::string::npos);
    EXPECT_EQ(finished.status, 2);
  }
  KCellularActivatedBearerContexts bearers;
  bearers.addBearerContexts(std::make_shared<BearerContext>());
  bearers.bearerContextsAtIndex(0)->setApn(Text::copy("\x1B[2J"));
  const Finished hostile = vesk({"show", "LTE", "Active Bearers", "-"}, recorded(0, K_CELLULAR_ACTIVE_BEARER, bearers));
  EXPECT_NE(hostile.output.find("[2J"), std::string::npos) << hostile.output;
  EXPECT_EQ(hostile.error, "");
  const Finished unfilled = vesk({"show", "LTE", "Active Bearers", "-"},
                                 recorded(0, K_CELLULAR_ACTIVE_BEARER, KCellularActivatedBearerContexts()));
  EXPECT_EQ(unfilled.error, "vesk: what fills LTE, Active Bearers came, but without this list\n");
  EXPECT_EQ(hostile.output.find('\x1B'), std::string::npos);
}

TEST_F(Pipeline, TheSameSeedDrivesTheSameWay) {
  const Finished drive = vesk({"simulate", "--seed", "4", "--seconds", "60"});
  EXPECT_EQ(vesk({"simulate", "--seed", "4", "--seconds", "60"}).output, drive.output);
  EXPECT_NE(vesk({"simulate", "--seed", "5", "--seconds", "60"}).output, drive.output);
  // No triggers, and the files of the SIM once.
  EXPECT_EQ(drive.output.find("\"0x7F"), std::string::npos);
  EXPECT_LT(drive.output.find("\"0x3C0013\""), drive.output.size() / 10);
  EXPECT_EQ(drive.output.find("\"0x3C0013\""), drive.output.rfind("\"0x3C0013\""));
}

/// What every pair of the menu shows, by the way of the rows: "[header] key=value …", with - for what is absent.
std::map<std::string, std::string> everyScreen(NavigationController& root) {
  std::map<std::string, std::string> screens;
  const auto top = [&root]() -> TableViewController& {
    return dynamic_cast<TableViewController&>(*root.topViewController());
  };
  const VeskViewItems& menu = VeskViewItems::shared();
  for (std::size_t area = 0; area < menu.launchViewItemNames.size(); ++area) {
    const std::string_view areaName = menu.launchViewItemNames[area].view();
    const auto& categories = menu.categoriesOf(areaName);
    for (std::size_t category = 0; category < categories.size(); ++category) {
      top().selectRow({0, area});
      top().selectRow({0, category});
      std::string& shown = screens[std::string(areaName) + " " + std::string(categories[category].view())];
      const auto add = [&shown](const std::optional<Text>& text) { shown += text ? text->view() : "-"; };
      TableView& table = top().tableView();
      for (std::size_t section = 0; section < table.numberOfSections(); ++section) {
        shown += '[';
        add(table.headerTitle(section));
        shown += "] ";
        for (std::size_t row = 0; row < table.numberOfRows(section); ++row) {
          const TableViewCell* cell = table.cellForRow({section, row});
          add(cell->mainText());
          shown += '=';
          add(cell->detailText());
          shown += ' ';
        }
      }
      root.popToDepth(1);
    }
  }
  return screens;
}

TEST_F(Pipeline, ADriveFillsEveryScreen) {
  handset::Handset handset(4, 0);
  std::string drive;
  handset::recordDrive(handset, 120, [&drive](std::string_view line) {
    drive += line;
    return true;
  });
  RecordingReader reader(fileWith(drive), "drive");
  const RecordedOutput output;
  ConnectedProgram program;
  program.run([&](NavigationController& root) {
    const auto before = everyScreen(root);
    for (auto step = reader.next(); const auto* event = std::get_if<RecordedEvent>(&step); step = reader.next())
      program.raise(event->metricId, event->payload);
    program.deliverAll();
    const auto after = everyScreen(root);
    EXPECT_EQ(after.size(), 42U);
    for (const auto& [pair, shown] : after) {
      if (pair == "Device Info IMSI" || pair == "Device Info IMEISV") {
        EXPECT_EQ(shown, "[-] Come back later=Come back later ") << pair;
        continue;
      }
      EXPECT_NE(shown, before.at(pair)) << pair;
      EXPECT_NE(shown.find('='), std::string::npos) << pair << " shows nothing";
      for (const char* missing : {"Waiting for Update", "-=", "=- "})
        EXPECT_EQ(shown.find(missing), std::string::npos) << pair << ": " << shown;
    }
    EXPECT_EQ(after.at("LTE Active Bearers"), after.at("GSM Active Bearers"));
    EXPECT_NE(after.at("UMTS NAS MM"), after.at("UMTS NAS GMM"));
  });
}

TEST_F(Pipeline, HeadlessEndsAfterItsTime) {
  const Finished timed = vesk({"--headless", "--log", "none", "--seconds", "0.05"});
  EXPECT_TRUE(timed.output.starts_with(kStartLines)) << timed.output;
  EXPECT_EQ(timed.status, 0);
}

}  // namespace
}  // namespace vesk
