#include <gtest/gtest.h>

#include "support/fake_interface.h"
#include "support/pictures.h"

namespace vesk {
namespace {

constexpr std::size_t kTxPower = 4;

FakeTableScreen::Row row(std::string_view name, std::string_view value) {
  return FakeTableScreen::row(name, value);
}

std::vector<FakeTableScreen::Section> power(std::string_view power) {
  return {{"TxPowerInfo 0"_text, {row("tx_power", power), row("chan", "3"), row("漢字", "名")}},
          {"TxPowerInfo 1"_text, {row("bearers", "{id: 5,\n qci: 9}"), {}}}};
}

Surroundings replaying() {
  Surroundings surroundings;
  surroundings.sourceState = [] { return SourceState{"replaying 3:12 of 9:40"}; };
  return surroundings;
}

TEST(Picture, ShowsSectionsNamesAndValuesWrappedWhereTheyNeedIt) {
  FakeInterface interface;
  interface.showFields(kTxPower, power("-19.5"));
  Desk desk(interface.stack(), {40, 12}, replaying());
  EXPECT_EQ(desk.picture(), R"(
| … › Tx Power    replaying 3:12 of 9:40
|  Tx Power
| TxPowerInfo 0
|  tx_power                       -19.5
|  chan                               3
|  漢字                              名
| TxPowerInfo 1
|  bearers
|    {id: 5,
|     qci: 9}
|
| ? help  Esc back  / filter  Space hold
)");
}

TEST(Picture, WrapsALongValueBelowItsNameAndCutsItAtAFixedHeight) {
  FakeInterface interface;
  FakeTableScreen& fields = interface.showFields(
      kTxPower, {{std::nullopt, {row("payload", "0x0102030405060708090a0b0c0d0e0f101112131415161718"), row("b", "")}}});
  Desk desk(interface.stack());
  EXPECT_EQ(desk.line(2), "  payload");
  EXPECT_EQ(desk.line(3), "    0x0102030405060708090a0b0c0d0e0f10");
  EXPECT_EQ(desk.line(4), "    1112131415161718");
  EXPECT_EQ(desk.line(5), "  b");

  fields.height = RowHeight::standard();
  fields.tableView().reloadData();
  EXPECT_EQ(desk.line(2), "  payload  0x0102030405060708090a0b0c…");
  EXPECT_EQ(desk.line(3), "  b");

  fields.height = RowHeight::ofLines(2);
  fields.tableView().reloadData();
  EXPECT_EQ(desk.line(3), "    0x0102030405060708090a0b0c0d0e0f1…");
  EXPECT_EQ(desk.line(4), "  b");
  EXPECT_EQ(desk.line(5), "");
}

TEST(Picture, MarksValuesThatChangedAtTheLastReloadForThatReload) {
  FakeInterface interface;
  FakeTableScreen& fields = interface.showFields(kTxPower, power("1"));
  Desk desk(interface.stack(), {40, 14});
  EXPECT_EQ(desk.line(3), "  tx_power                           1");

  fields.content = power("2");
  fields.content[0].rows.insert(fields.content[0].rows.begin(), row("new", "7"));
  fields.content[0].rows.push_back(row("timestamp", "now"));
  fields.tableView().reloadData();
  EXPECT_EQ(desk.line(3), "• new                                7");
  EXPECT_EQ(desk.line(4), "• tx_power                           2");
  EXPECT_EQ(desk.line(5), "  chan                               3");
  EXPECT_EQ(desk.line(7), "  timestamp                        now");
  const Grid marked = desk.grid();
  EXPECT_EQ(marked.at(37, 4).role, Role::Changed);
  EXPECT_EQ(marked.at(37, 5).role, Role::Value);

  fields.tableView().reloadData();
  EXPECT_EQ(desk.line(4), "  tx_power                           2");
}

TEST(Picture, TellsHowOldTheRowsAreInTheDrivesTimeAndHowOftenTheMetricCame) {
  FakeInterface interface;
  FakeTableScreen& fields = interface.showFields(kTxPower, power("1"));
  std::optional<Arrivals> arrivals = Arrivals{};
  std::string asked;
  Surroundings surroundings;
  surroundings.arrivals = [&](std::string_view area, std::string_view category) {
    asked = std::string(area) + "/" + std::string(category);
    return arrivals;
  };
  DriveMoment moment{std::chrono::hours(1000), 2};
  surroundings.driveMoment = [&] { return moment; };
  Desk desk(interface.stack(), {40, 10}, surroundings);
  EXPECT_EQ(desk.line(1), "  Tx Power  never");
  arrivals = Arrivals{moment.time, 1};
  EXPECT_EQ(desk.line(1), "  Tx Power  arrived, not shown yet");
  EXPECT_EQ(asked, "LTE/Tx Power");
  EXPECT_EQ(desk.presenter().nextChange(), std::nullopt);

  using namespace std::chrono_literals;
  struct {
    std::chrono::milliseconds age;
    std::uint64_t count;
    std::string text;
    std::chrono::milliseconds next;
  } const cases[] = {
      {0s, 1, "0 s ago, once", 1s},
      {59999ms, 2, "59 s ago, 2 times", 60s},
      {60s, 14, "1 min ago, 14 times", 120s},
      {49h, 2, "2 d ago, 2 times", 72h},
  };
  for (const auto& each : cases) {
    arrivals = Arrivals{moment.time - each.age, each.count};
    fields.tableView().reloadData();
    EXPECT_EQ(desk.line(1), "  Tx Power  " + each.text);
    EXPECT_EQ(desk.presenter().nextChange(), desk.now() + Clock::Duration(each.next - each.age) / 2);
  }
  arrivals = Arrivals{moment.time, 15};
  moment = {moment.time + 24h, 0};
  EXPECT_EQ(desk.line(1), "  Tx Power  3 d ago, 2 times");
  EXPECT_EQ(desk.presenter().nextChange(), std::nullopt);
  arrivals->isWithoutList = true;
  fields.tableView().reloadData();
  EXPECT_EQ(desk.line(1), "  Tx Power  1 d ago, 15 times, without…");
  arrivals = std::nullopt;
  fields.tableView().reloadData();
  EXPECT_EQ(desk.line(1), "  Tx Power");
  asked.clear();
  interface.stack().pop();
  EXPECT_EQ(desk.line(1), "  LTE");
  EXPECT_EQ(asked, "");
}

TEST(Picture, ShowsTheDiagnosticLinesInAPaneThatKeepsItsPlace) {
  FakeInterface interface;
  DiagnosticLines lines(10);
  const auto append = [&](int first, int last) {
    for (int number = first; number <= last; ++number)
      lines.append("line " + std::to_string(number));
  };
  Surroundings surroundings;
  surroundings.diagnostics = &lines;
  Desk desk(interface.stack(), {40, 12}, surroundings);
  desk.type(U"d");
  append(1, 8);
  EXPECT_EQ(desk.line(7), " Diagnostics                    8 lines");
  EXPECT_EQ(desk.line(10), " line 8");
  desk.mouse(MouseAction::WheelUp, 5, 9);
  append(9, 10);
  EXPECT_EQ(desk.line(7), " Diagnostics              5 of 10 lines");
  EXPECT_EQ(desk.line(10), " line 5");
  append(11, 14);
  EXPECT_EQ(desk.line(8), " line 5");
  desk.type(U"]]]]");
  append(15, 15);
  EXPECT_EQ(desk.line(10), " line 15");
  lines.append("a long line of many words that goes on and on to its end");
  EXPECT_EQ(desk.line(8), " line 15");
  EXPECT_EQ(desk.line(9), " a long line of many words that goes on");
  EXPECT_EQ(desk.line(10), " and on to its end");
  desk.mouse(MouseAction::WheelUp, 5, 9);
  desk.mouse(MouseAction::WheelDown, 5, 9);
  desk.mouse(MouseAction::WheelUp, 5, 9);
  EXPECT_EQ(desk.line(10), " line 14");
  desk.type(U"d");
  EXPECT_EQ(desk.line(5).substr(0, 12), " Diagnostics");
  desk.type(U"?");
  EXPECT_EQ(desk.line(5).find("Diagnostics"), std::string::npos);
  desk.type(U"?d");
  EXPECT_EQ(desk.line(7), "");
}

TEST(Picture, ShowsTheHelpFromTheTableOfKeys) {
  FakeInterface interface;
  Desk desk(interface.stack(), {80, 32});
  desk.type(U"?");
  EXPECT_EQ(desk.line(1), "  Keys");
  EXPECT_EQ(desk.line(4), "  Esc Left h Backspace  clear the filter, go back");
  EXPECT_EQ(desk.line(6), "  Space f               hold all that shows, and the replay; intake goes on");
  EXPECT_EQ(desk.line(31), " Esc back  q quit");
  desk.resize({40, 10});
  desk.type(U"GG");
  EXPECT_EQ(desk.line(7), "                        bar: go there");
  EXPECT_EQ(desk.line(8), "  wheel, drag           scroll");
  desk.press(Key::Escape);
  EXPECT_EQ(desk.line(2), "  Device Info                        ›");
  Surroundings dated;
  dated.sourceState = [] { return SourceState{.text = "live", .date = "2026-01-02 03:04:05 UTC"}; };
  EXPECT_EQ(Desk(interface.stack(), {40, 10}, dated).line(0), " Vesk                              live");
}

TEST(Picture, SaysThatATerminalIsTooSmallAtEverySizeBelow) {
  FakeInterface interface;
  interface.showFields(kTxPower, power("1"));
  Desk desk(interface.stack());
  for (const Size size : {Size{39, 11}, {40, 9}, {9, 1}, {40, 10}, {41, 11}}) {
    desk.resize(size);
    desk.press(Key::Down);
    const bool isTooSmall = size.columns < 40 || size.lines < 10;
    EXPECT_EQ(desk.line(0) == "too small", isTooSmall) << size.columns;
  }
}

}  // namespace
}  // namespace vesk
