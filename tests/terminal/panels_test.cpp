#include <gtest/gtest.h>

#include "insight/drive.h"
#include "support/fake_interface.h"
#include "support/pictures.h"
#include "terminal/panels/cell_table.h"
#include "terminal/panels/kpi_look.h"
#include "terminal/panels/trend_graph.h"
#include "terminal/small_drive.h"

namespace vesk {
namespace {

using namespace insight;

/// A desk whose screens know what the drive comes to.
class PanelsTest : public testing::Test {
 protected:
  void show(const std::vector<DriveEvent>& events, Size size) {
    drive_.play(events);
    surroundings_.drive = &drive_.insight;
    surroundings_.goToEvent = [this](const TimelineEvent& event) { wentTo_.push_back(event.moment.event); };
    desk_.emplace(interface_.stack(), size, surroundings_);
  }
  /// The first line with that text; empty where there is none.
  std::string lineWith(std::string_view text) {
    const Grid grid = desk_->grid();
    for (int line = 0; line < grid.size().lines; ++line) {
      std::string found = grid.textOfLine(line);
      if (found.find(text) != std::string::npos) return found;
    }
    return "";
  }
  std::string selectedLine() {
    const int line = desk_->lineOf(Role::Selected);
    return line < 0 ? "none" : desk_->line(line);
  }

  Drive drive_;
  FakeInterface interface_;
  Surroundings surroundings_;
  std::vector<std::uint64_t> wentTo_;
  std::optional<Desk> desk_;
};

TEST_F(PanelsTest, TheSmallestOverviewIsTheServingCell) {
  show(smallDrive(), {40, 10});
  desk_->type(U"o");
  EXPECT_EQ(desk_->picture(), R"(
| Vesk › Overview
|  PCI 338   eNB 191040 / 17   TAI 310-4…
|  EARFCN 5815   B17 742.5 MHz, UL 712.5…
|▸ RSRP    -88 dBm ███████░░░ good
|  RSRQ      -9 dB ███████░░░ good
|  SINR          – not reported
|  RRC CONNECTED 4.8 s   serves 15.0 s  …
|  next PCI 316 B17 5815, -112 dBm, -24 …
| 21:53:00  reestablished PCI 338 B17 58…
| ? help  Esc back  1 to 4 areas  t trend
)");
}

TEST_F(PanelsTest, AnOrdinaryOverviewHasTrendAndEvents) {
  show(smallDrive(), {80, 24});
  desk_->type(U"o");
  EXPECT_EQ(desk_->picture(), R"(
| Vesk › Overview
|┌─ SERVING  LTE ───────────────────────────────────── 2018-01-20 21:53:05 UTC ─┐
|│  PCI 338   eNB 191040 / 17   TAI 310-410 19980                               │
|│  EARFCN 5815   B17 742.5 MHz, UL 712.5 MHz                                   │
|│▸ RSRP    -88 dBm ██████████████░░░░░░ good       60 s -112…-88               │
|│  RSRQ      -9 dB ███████████████░░░░░ good       60 s -15…-9                 │
|│  SINR          – not reported                                                │
|│  RRC CONNECTED 4.8 s   serves 15.0 s   age 0.0 s                             │
|│  Srxlev +34 dB over QRxLevMin -122 dBm   measured PCI agrees                 │
|│  next PCI 316 B17 5815, -112 dBm, -24 dB                                     │
|├─ RSRP dBm, 2 min 24 s ───────────────────────────────────────────────────────┤
|│  -70                                                                         │
|│  -80                                                                        ▂│
|│  -90                                                                 ▃▃▃▃▃▃ █│
|│ -100                                                                 ██████ █│
|│ -110                                                            ▆▆▆▆▆██████ █│
|│                                                                      C    R  │
|├─ WHAT HAPPENED ──────────────────────────────────────────────────────────────┤
|│ 21:53:00.200  reestablished  PCI 338 B17 5815 CI 48906257 -> PCI 338 B17 581…│
|│ 21:52:52.000  emm            NORMAL SERVICE                                  │
|│ 21:52:50.000  handover       PCI 316 B17 5815 -> PCI 338 B17 5815, -112 dBm,…│
|│ 21:52:40.000  area           TAI 310-410 19980                               │
|└──────────────────────────────────────────────────────────────────────────────┘
| ? help  Esc back  1 to 4 areas  t trend  e events  c cells  Space hold  q quit
)");
}

TEST_F(PanelsTest, WideOverviewsAreFilled) {
  show(smallDrive(), {120, 40});
  desk_->type(U"o");
  struct {
    Size size;
    std::string titles;
  } const cases[] = {
      {{120, 40}, "1 SERVING, 1 CONNECTION, 10 RSRP dBm, 10 LAST 60 s, 18 CELLS HEARD, 27 WHAT HAPPENED, "},
      {{200, 60}, "1 SERVING, 1 CONNECTION, 10 RSRP dBm, 10 LAST 60 s, 35 CELLS HEARD, 35 WHAT HAPPENED, "},
      {{80, 50}, "1 SERVING, 10 CONNECTION, 17 RSRP dBm, 27 CELLS HEARD, 38 WHAT HAPPENED, "},
      {{60, 17}, "1 SERVING, 9 WHAT HAPPENED, "},
  };
  for (const auto& each : cases) {
    desk_->resize(each.size);
    const Grid grid = desk_->grid();
    std::string titles;
    for (int line = 1; line < each.size.lines - 1; ++line) {
      const std::string text = grid.textOfLine(line);
      EXPECT_EQ(textWidth(text), each.size.columns);
      for (const char* title : {"SERVING", "CONNECTION", "RSRP dBm", "LAST 60 s", "CELLS HEARD", "WHAT HAPPENED"})
        if (text.find(std::string("─ ") + title) != std::string::npos) {
          titles += std::to_string(line) + " " + title + ", ";
        }
    }
    EXPECT_EQ(titles, each.titles);
  }
  desk_->resize({120, 40});
  EXPECT_NE(lineWith("RRC     CONNECTED   4.8 s   REEST OTHER FAIL"), "");
  EXPECT_NE(lineWith("C cell changes           1"), "");
  EXPECT_NE(
      lineWith("▸ LTE   B17           5815  742.5   338    -88             -9 ██████████████░░░░░░   0.0 s serving"),
      "");
  EXPECT_NE(lineWith("742.5   316   -112   -24      -15 ██████░░░░░░░░░░░░░░  24.0 s served 15.0 s ago"), "");
}

TEST_F(PanelsTest, TheOverviewTellsOfTheServingCellWhatIsTrueOfIt) {
  show(smallDrive(), {120, 40});
  desk_->type(U"o");
  drive_.play({lteCell(30'000, 2000, 62, 62, {}, 10), lteLevel(30'100, -90, -9, 338)});
  EXPECT_NE(lineWith("EARFCN 2000   B4 2115.0 MHz, UL 1715.0 MHz   5 MHz wide"), "");
  EXPECT_NE(lineWith("age 0.0 s, of PCI 338"), "");
  EXPECT_EQ(lineWith("Srxlev"), "") << "what the cell before has broadcast";
  EXPECT_EQ(lineWith("agrees"), "");
  EXPECT_NE(lineWith("338    -88   +30       -9 ██████████████░░░░░░   5.1 s re-established 9.9 s ago"), "");
  drive_.play({lteCell(31'000, 2000, 63), lteNeighbors(31'100, {{2000, 62, -100}, {2000, 7, -99, 36}}),
               lteLevel(31'200, -90, -12)});
  EXPECT_NE(lineWith("0.1 s served 0.2 s ago"), "");
  EXPECT_NE(lineWith("0.1 s best quality"), "");
}

TEST_F(PanelsTest, EveryTechnologyHasAnOverview) {
  struct {
    std::vector<DriveEvent> events;
    std::vector<std::string> shown;
  } const cases[] = {
      {{}, {"no technology yet", "waiting for the first event"}},
      {{umtsCell(100'000, 10637, 145, 141'294), umtsLevel(100'100, -70, 37)},
       {"PSC 145   RNC 2 / cell 10222", "UARFCN 10637   band I 2127.4 MHz, UL 1937.4 MHz", "RSCP    -76 dBm", "good",
        "Ec/N0", "RSSI    -70 dBm"}},
      {{gsmCell(101'000, 62, 40)},
       {"BSIC 40", "ARFCN 62   P-GSM 900 947.4 MHz", "RxLev         – not reported", "RxQual        – not reported"}},
  };
  show({}, {80, 24});
  desk_->type(U"o");
  for (const auto& each : cases) {
    drive_.play(each.events);
    for (const std::string& text : each.shown)
      EXPECT_NE(lineWith(text), "") << text << desk_->picture();
  }
}

TEST_F(PanelsTest, LieOverTheTablesAndGoBackToThem) {
  show(smallDrive(), {80, 24});
  interface_.showFields(3, {{std::nullopt, {FakeTableScreen::row("x", "1"), FakeTableScreen::row("rsrq0", "-9")}}});
  desk_->press(Key::Down);
  desk_->type(U"t");
  EXPECT_EQ(desk_->line(0), " Vesk › LTE › Serving Cell Meas › Trend");
  EXPECT_EQ(desk_->line(1).substr(0, 16), "  RSRQ  lte.rsrq");
  desk_->type(U"eco");
  EXPECT_EQ(desk_->line(0), " Vesk › LTE › Serving Cell Meas › Trend › Timeline › Cells › Overview");
  desk_->type(U"e");
  desk_->click(45, 0);
  EXPECT_EQ(desk_->line(0), " Vesk › LTE › Serving Cell Meas › Trend › Cells");
  desk_->press(Key::Escape);
  desk_->press(Key::Escape);
  EXPECT_EQ(desk_->line(0), " Vesk › LTE › Serving Cell Meas");
  EXPECT_EQ(selectedLine().substr(0, 9), "  rsrq0  ");
  desk_->type(U"o3");
  EXPECT_EQ(desk_->line(0), " Vesk › UMTS");
}

TEST_F(PanelsTest, HeldPanelsStandStillWhileTheDriveGoesOn) {
  surroundings_.isSeekable = true;
  show(smallDrive(), {100, 24});
  desk_->type(U"of");
  const std::string held = desk_->picture();
  EXPECT_NE(held.find("HELD"), std::string::npos);
  EXPECT_NE(held.find("c cells  Space go on  q quit  < 10 s back"), std::string::npos);
  drive_.play({lteLevel(26'000, -70)});
  EXPECT_EQ(desk_->picture(), held);
  desk_->type(U"f");
  EXPECT_NE(lineWith("-70 dBm"), "");
}

TEST_F(PanelsTest, TheOverviewOpensTheTrendOfTheSelectedFigure) {
  show(smallDrive(), {80, 24});
  desk_->type(U"oj");
  EXPECT_NE(lineWith("▸ RSRQ      -9 dB"), "");
  desk_->type(U"t");
  EXPECT_EQ(lineWith("min"), "  -9 dB, good   min -15  mean -11  max -9  of 3");
  desk_->press(Key::Up);
  EXPECT_EQ(lineWith("min"), "  -88 dBm, good   min -112  mean -98.7  max -88  of 3");
  desk_->press(Key::PageDown);
  EXPECT_NE(lineWith("-2 min 26 s"), "");
}

TEST_F(PanelsTest, TheTimelineFiltersAndTellsAllFields) {
  show(smallDrive(), {80, 24});
  desk_->type(U"e/HANDOVER");
  EXPECT_EQ(lineWith("Timeline, ").substr(0, 23), "  Timeline, 1 of 9 even");
  desk_->press(Key::Enter);
  desk_->press(Key::Enter);
  EXPECT_EQ(lineWith("stay_ms"), "  stay_ms     10000");
  EXPECT_EQ(lineWith("  to  "), R"(  to          {"channel":5815,"code":338,"cell_id":48906257})");
  EXPECT_TRUE(wentTo_.empty());
  desk_->resize({60, 12});
  EXPECT_NE(lineWith("stay_ms"), "") << "what the row does not tell comes first";
  EXPECT_NE(selectedLine().find("handover"), std::string::npos);
  desk_->press(Key::Enter);
  EXPECT_EQ(wentTo_, std::vector<std::uint64_t>{5});
  desk_->press(Key::Escape);
  EXPECT_EQ(lineWith("stay_ms"), "");
  desk_->press(Key::Escape);
  EXPECT_EQ(lineWith("Timeline, ").substr(0, 20), "  Timeline, 9 events");
  EXPECT_EQ(desk_->line(0), " Vesk › Timeline");
}

TEST_F(PanelsTest, TheTimelineKeepsTheSelectedEventWhileOthersCome) {
  show(smallDrive(), {80, 24});
  desk_->type(U"ejj");
  const std::string selected = selectedLine();
  EXPECT_EQ(desk_->lineOf(Role::Selected), 4);
  for (int round = 0; round < 3000; ++round) {
    drive_.play({lteCell(30'000 + round, 2000, round % 2 == 0 ? 62 : 63)});
    if (round < 20) {
      EXPECT_EQ(selectedLine(), selected);
    }
  }
  // By now it is no longer kept.
  EXPECT_NE(selectedLine(), selected);
  desk_->press(Key::Home);
  drive_.play({lteCell(40'000, 2000, 64)});
  EXPECT_NE(selectedLine().find("PCI 64"), std::string::npos);
}

TEST_F(PanelsTest, CellsAreSortedByKeyAndClick) {
  show(smallDrive(), {120, 24});
  desk_->type(U"c");
  const auto codes = [&] {
    const Grid grid = desk_->grid();
    std::string out;
    for (int line = 3; line < 7; ++line) {
      for (int column = 34; column < 39; ++column)
        out += grid.at(column, line).glyph();
    }
    return out;
  };
  EXPECT_EQ(codes(), "  338  316   62    7");
  // By technology, then by band.
  desk_->type(U"ss");
  EXPECT_EQ(codes(), "  338  316   62    7");
  constexpr int kCode = 36;
  constexpr int kLevel = 44;
  for (const auto& [column, order] : {std::pair(kCode, "    7   62  316  338"),
                                      {kCode, "  338  316   62    7"},
                                      {kLevel, "  338  316   62    7"},
                                      {kLevel, "    7   62  316  338"}}) {
    desk_->click(column, 2);
    EXPECT_EQ(codes(), order);
  }
}

TEST(TrendGraph, UsesTheSignsThatTheTerminalHas) {
  Drive drive;
  for (std::int32_t second = 0; second < 6; ++second)
    drive.play({lteLevel(std::int64_t{1000} * second, -100 + second)});
  drive.play({lteLevel(6000, -97), lteLevel(6500, -99)});
  struct {
    GraphKind kind;
    Signs signs;
    std::vector<std::string> lines;
  } const cases[] = {
      {GraphKind::bars, Signs::ascii, {"  -95     ███", " -100  ███████"}},
      {GraphKind::bars, Signs::blocks, {"  -95    ▄▄██▄", " -100  ███████"}},
      {GraphKind::bars, Signs::braille, {"  -95   ▂▃▅▆█▃", " -100  ███████"}},
      {GraphKind::line, Signs::braille, {" -100     ⢀⣠⠞⢹", " -105"}},
      {GraphKind::line, Signs::blocks, {"  -95    ▄▄██▄", " -100  ███████"}},
  };
  for (const auto& each : cases) {
    Grid grid({14, 3});
    TrendGraph{Kpi::lteRsrp, each.kind, each.signs, 1000}.draw(Canvas(grid, {0, 0, 14, 3}), drive.insight);
    EXPECT_EQ(std::vector({grid.textOfLine(0), grid.textOfLine(1)}), each.lines);
  }
}

TEST(TrendGraph, ShowsAValueWhileItIsFreshAndNotBeyondABreak) {
  const Trend::Points points{{1000, 12, -90, -80, -170, 2}, {4000, 40, -100, -100, -100, 1}};
  const auto shown = [&](std::int64_t step, const std::vector<Moment>& breaks) {
    std::string out;
    for (const auto& slot : slotValues(points, {0, step, 18}, breaks))
      out += slot ? slot->mean() == -85 ? 'a' : 'b' : '.';
    return out;
  };
  EXPECT_EQ(shown(1000, {}), ".aaabbbbbbbbbb....");
  EXPECT_EQ(shown(1000, {{.event = 25, .position = 2500}, {.event = 60, .position = 6000}}), ".aa.bb............");
  // No time passes in a gap: only the event tells what came before it.
  EXPECT_EQ(shown(1000, {{.event = 12, .position = 1000}, {.event = 41, .position = 4000}}), ".aaab.............");
  EXPECT_EQ(shown(500, {}), "..aaaaaabbbbbbbbbb");
  EXPECT_EQ(valuesSince(points, 2000)->count, 1U);
  EXPECT_FALSE(valuesSince(points, 5000));
}

TEST(TrendGraph, ScalesToRoundValuesThatHoldAll) {
  for (const auto& [min, max, rows] :
       {std::tuple{-96.0, -96.0, 5}, {-140.0, -44.0, 4}, {-19.5, 2.5, 3}, {0.0, 7.0, 20}}) {
    const TrendScale scale = TrendScale::covering(min, max, rows);
    EXPECT_LT(scale.low, min);
    EXPECT_GE(scale.low + scale.step * rows, max);
  }
}

}  // namespace
}  // namespace vesk
