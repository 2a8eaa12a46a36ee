#include "terminal/view/presenter.h"

#include <gtest/gtest.h>

#include "support/fake_interface.h"
#include "support/pictures.h"

namespace vesk {
namespace {

std::vector<FakeTableScreen::Section> numbered(int rows, std::string_view value = "") {
  FakeTableScreen::Section section{std::nullopt, {}};
  for (int index = 0; index < rows; ++index)
    section.rows.push_back(FakeTableScreen::row("row " + std::to_string(index), value));
  return {section};
}

/// At 40 by 10 the list has 7 lines, 2 to 8.
class PresenterTest : public testing::Test {
 protected:
  PresenterTest() {
    surroundings_.setTracking = [this](bool isTracking) { tracking_.push_back(isTracking); };
    surroundings_.quit = [this] { ++quits_; };
    surroundings_.setHeld = [this](bool isHeld) { held_.push_back(isHeld); };
    surroundings_.jump = [this](std::chrono::seconds distance) {
      asked_.push_back("jump " + std::to_string(distance.count()));
    };
    surroundings_.changeSpeed = [this](int step) { asked_.push_back("speed " + std::to_string(step)); };
    desk_.emplace(interface_.stack(), Size{40, 10}, surroundings_);
  }

  FakeTableScreen& showFields(std::vector<FakeTableScreen::Section> content) {
    return interface_.showFields(0, std::move(content));
  }
  /// The name in the row that is selected, and the line it is in.
  std::string selected() {
    const int line = desk_->lineOf(Role::Selected);
    if (line < 0) return "none";
    const std::string text = desk_->line(line).substr(2);
    return text.substr(0, text.find("  ")) + " in " + std::to_string(line);
  }
  [[nodiscard]] std::size_t depth() { return interface_.stack().stack().size(); }

  FakeInterface interface_;
  std::vector<bool> tracking_;
  std::vector<bool> held_;
  std::vector<std::string> asked_;
  int quits_ = 0;
  Surroundings surroundings_;
  std::optional<Desk> desk_;
};

TEST_F(PresenterTest, WalksInAndOutWithTheSelectionKept) {
  desk_->type(U"jj");
  EXPECT_EQ(selected(), "UMTS in 4");
  desk_->press(Key::Up);
  desk_->press(Key::Enter);
  EXPECT_EQ(desk_->line(0), " Vesk › LTE");
  desk_->press(Key::Down);
  desk_->press(Key::Right);
  EXPECT_EQ(desk_->line(0), " Vesk › LTE › RRC State");
  EXPECT_EQ(selected(), "none");
  desk_->type(U"lh");
  EXPECT_EQ(selected(), "RRC State in 3");
  desk_->press(Key::Backspace);
  EXPECT_EQ(selected(), "LTE in 3");
  desk_->press(Key::Escape);
  desk_->press(Key::Left);
  EXPECT_EQ(depth(), 1U);
  EXPECT_EQ(quits_, 0);
  desk_->type(U"q");
  EXPECT_EQ(quits_, 1);
}

TEST_F(PresenterTest, ScrollsByKeys) {
  showFields(numbered(30));
  struct {
    Key key;
    std::string selected;
    std::string firstLine;
  } const steps[] = {
      {Key::Up, "row 0 in 2", "  row 0"},     {Key::PageDown, "row 6 in 2", "  row 6"},
      {Key::Up, "row 5 in 2", "  row 5"},     {Key::End, "row 29 in 8", "  row 23"},
      {Key::Down, "row 29 in 8", "  row 23"}, {Key::PageUp, "row 23 in 8", "  row 17"},
      {Key::Down, "row 24 in 8", "  row 18"}, {Key::Home, "row 0 in 2", "  row 0"},
  };
  for (const auto& step : steps) {
    desk_->press(step.key);
    EXPECT_EQ(selected(), step.selected);
    EXPECT_EQ(desk_->line(2).substr(0, step.firstLine.size()), step.firstLine);
  }
  desk_->press(Key::End);
  desk_->resize({60, 15});
  EXPECT_EQ(selected(), "row 29 in 13");
  desk_->resize({20, 5});
  desk_->picture();
  desk_->resize({40, 10});
  EXPECT_EQ(selected(), "row 29 in 8");
}

TEST_F(PresenterTest, WalksThroughARowTallerThanTheScreen) {
  std::string tall = "0";
  for (int line = 1; line < 12; ++line)
    tall += "\n" + std::to_string(line);
  showFields({{std::nullopt, {FakeTableScreen::row("tall", tall), FakeTableScreen::row("next", "")}}});
  EXPECT_EQ(desk_->line(8).substr(0, 5), "    5");
  for (int step = 0; step < 6; ++step)
    desk_->press(Key::Down);
  EXPECT_EQ(desk_->line(8).substr(0, 6), "    11");
  EXPECT_EQ(desk_->lineOf(Role::Selected), 2);
  desk_->press(Key::Down);
  EXPECT_EQ(selected(), "next in 8");
}

TEST_F(PresenterTest, AsksOnlyForRowsThatComeIntoView) {
  FakeTableScreen& fields = showFields(numbered(1000));
  desk_->picture();
  EXPECT_EQ(fields.cellRequests, 7);
  desk_->press(Key::Down);
  desk_->picture();
  EXPECT_EQ(fields.cellRequests, 7);
  desk_->press(Key::PageDown);
  desk_->picture();
  // The six that come, and then all seven, so that one screen is one moment.
  EXPECT_LE(fields.cellRequests, 7 + 6 + 7 + 1);
}

TEST_F(PresenterTest, AsksAgainForRowsThatComeIntoViewAgainAndForThoseBesideThem) {
  FakeTableScreen& fields = showFields(numbered(30, "then"));
  EXPECT_NE(desk_->picture().find("then"), std::string::npos);
  fields.content = numbered(30, "new");
  desk_->press(Key::End);
  desk_->picture();
  desk_->press(Key::Home);
  EXPECT_EQ(desk_->picture().find("then"), std::string::npos);
  fields.content = numbered(30, "now");
  desk_->press(Key::PageDown);
  EXPECT_EQ(desk_->picture().find("new"), std::string::npos);
}

TEST_F(PresenterTest, CopesWithAContentThatShrinksBeforeAndAtAReload) {
  FakeTableScreen& fields = showFields(numbered(30));
  fields.content = numbered(2);
  desk_->press(Key::End);
  EXPECT_EQ(desk_->line(8), std::string(39, ' ') + "█");
  desk_->press(Key::Enter);
  fields.tableView().reloadData();
  EXPECT_EQ(selected(), "row 1 in 3");
  fields.content.clear();
  fields.tableView().reloadData();
  EXPECT_EQ(selected(), "none");
  for (const Key key : {Key::Down, Key::Up, Key::PageDown, Key::PageUp, Key::End, Key::Home, Key::Enter})
    desk_->press(key);
  desk_->click(5, 4);
  EXPECT_EQ(desk_->line(2), "");
}

TEST_F(PresenterTest, FiltersWhileOneTypes) {
  FakeTableScreen& fields =
      showFields({{"PDP 0"_text, {FakeTableScreen::row("apn", "Internet"), FakeTableScreen::row("qci", "9")}},
                  {"PDP 1"_text, {FakeTableScreen::row("apn", "ims"), FakeTableScreen::row("interval", "5")}},
                  {"PDP 2"_text, {FakeTableScreen::row("qci", "5")}}});
  desk_->type(U"/InTQ");
  EXPECT_EQ(quits_, 0);
  desk_->press(Key::Backspace);
  EXPECT_EQ(desk_->line(2), " PDP 0");
  EXPECT_EQ(desk_->line(3), "  apn                         Internet");
  EXPECT_EQ(desk_->line(4), " PDP 1");
  EXPECT_EQ(desk_->line(5), "  interval                           5");
  EXPECT_EQ(desk_->line(6), "");
  EXPECT_EQ(desk_->line(9), " /InT▏ Enter keep  Esc clear");
  desk_->press(Key::Down);
  EXPECT_EQ(selected(), "interval in 5");
  desk_->press(Key::Enter);
  EXPECT_EQ(desk_->line(9), " /InT  ? help  Esc back  / filter");
  fields.content[0].rows[0] = FakeTableScreen::row("apn", "other");
  fields.tableView().reloadData();
  EXPECT_EQ(desk_->line(2), " PDP 1");

  desk_->press(Key::Escape);
  EXPECT_EQ(selected(), "interval in 6");
  desk_->press(Key::Tab);
  EXPECT_EQ(selected(), "qci in 8");
  desk_->press(Key::Tab);
  EXPECT_EQ(desk_->line(3).substr(0, 8), "• apn ");
  EXPECT_EQ(depth(), 3U);
  desk_->type(U"/qé");
  EXPECT_EQ(desk_->line(2), "  no row has this");
  EXPECT_EQ(quits_, 0);
  desk_->press(Key::Escape);
  desk_->press(Key::Escape);
  EXPECT_EQ(depth(), 2U);
}

TEST_F(PresenterTest, TheFilterKnowsHeadersTakesPastedTextAndLosesWordsByControl) {
  showFields({{"PDP 0"_text, {FakeTableScreen::row("apn", "a")}}, {"PDP 1"_text, {FakeTableScreen::row("qci", "5")}}});
  const auto control = [&](char32_t letter) {
    desk_->presenter().handle(KeyEvent{.character = letter, .modifiers = {.control = true}});
  };
  desk_->presenter().handle(PasteEvent{"q"});
  EXPECT_EQ(quits_, 0);
  desk_->type(U"/");
  desk_->presenter().handle(PasteEvent{"pdp\t 1\nq"});
  EXPECT_EQ(desk_->line(2), " PDP 1");
  EXPECT_EQ(desk_->line(3), "  qci                                5");
  EXPECT_EQ(desk_->line(9).substr(0, 10), " /pdp 1▏");
  control(U'w');
  EXPECT_EQ(desk_->line(9).substr(0, 9), " /pdp ▏");
  control(U'u');
  EXPECT_EQ(desk_->line(9).substr(0, 5), " /▏");
  desk_->type(U"0123456789012345678");
  EXPECT_EQ(desk_->line(9).substr(0, 30), " /…23456789012345678▏ Ente");
}

TEST_F(PresenterTest, HoldsTheWholeScreen) {
  FakeTableScreen& fields = showFields(numbered(30, "old"));
  desk_->type(U" ");
  fields.content = numbered(10, "new");
  fields.tableView().reloadData();
  desk_->press(Key::End);
  EXPECT_EQ(desk_->line(8), "  row 29                           old █");
  EXPECT_EQ(desk_->line(1), "  NAS                             HELD");

  desk_->type(U"f");
  EXPECT_EQ(desk_->line(8), "• row 9                            new █");
  EXPECT_EQ(desk_->line(1), "  NAS");

  desk_->type(U"f");
  desk_->press(Key::Escape);
  EXPECT_EQ(desk_->line(1), "  LTE                             HELD");
  EXPECT_EQ(held_, (std::vector<bool>{true, false, true}));
}

TEST_F(PresenterTest, NamesTheKeysThatDoSomething) {
  desk_->resize({120, 10});
  EXPECT_EQ(desk_->line(9), " ? help  Enter open  / filter  Space hold  q quit");
  surroundings_.isSeekable = true;
  Desk replay(interface_.stack(), {120, 10}, surroundings_);
  replay.type(U" ");
  EXPECT_EQ(replay.line(9),
            " ? help  Enter open  / filter  Space go on  q quit  < 10 s back  > 10 s forward  + faster  - slower");
}

TEST_F(PresenterTest, ShowsAnotherMomentOnceItHasComeWithSelectionAndPlaceKept) {
  FakeTableScreen& fields = showFields(numbered(30, "then"));
  desk_->press(Key::End);
  for (const bool isHeld : {false, true}) {
    if (isHeld) desk_->type(U" ");
    const std::string before = desk_->line(8);
    desk_->presenter().setOnTheWay(true);
    fields.content.clear();
    fields.tableView().reloadData();
    EXPECT_EQ(desk_->line(8), before);
    fields.content = numbered(30, isHeld ? "first" : "now");
    fields.tableView().reloadData();
    desk_->presenter().setOnTheWay(false);
    EXPECT_EQ(desk_->lineOf(Role::Selected), 8);
    EXPECT_NE(desk_->line(8).find("row 29"), std::string::npos);
    EXPECT_NE(desk_->line(8).find(isHeld ? "first" : "now"), std::string::npos);
  }
  desk_->type(U"><+-");
  EXPECT_EQ(asked_, (std::vector<std::string>{"jump 10", "jump -10", "speed 1", "speed -1"}));
}

TEST_F(PresenterTest, TellsWhatValuesMeanBesideThemWhereItFits) {
  surroundings_.reading = [](std::string_view, std::string_view category, IndexPath, std::string_view name) {
    return name == "rsrp" ? std::string(category) + ": fair" : std::string(name == "long" ? 40 : 0, 'x');
  };
  desk_.emplace(interface_.stack(), Size{80, 10}, surroundings_);
  using Screen = FakeTableScreen;
  showFields({{std::nullopt, {Screen::row("rsrp", "-96"), Screen::row("long", "1"), Screen::row("time", "2")}}});
  const std::string gap(36, ' ');
  EXPECT_EQ(desk_->line(2), "  rsrp" + gap + "-96  NAS: fair");
  EXPECT_EQ(desk_->line(3), "  long" + gap + "  1");
  EXPECT_EQ(desk_->line(4), "  time" + gap + "  2");
  desk_->type(U"u");
  EXPECT_EQ(desk_->line(2).find("fair"), std::string::npos);
  EXPECT_EQ(desk_->line(2).size(), 78U);
  desk_->type(U"u");
  desk_->resize({60, 10});
  EXPECT_EQ(desk_->line(2).find("fair"), std::string::npos);
}

TEST_F(PresenterTest, TellsACategorysHeadlineAndItsAgeInTheMenuAsFarAsItFits) {
  surroundings_.arrivals = [](std::string_view, std::string_view category) {
    return category == "NAS" ? Arrivals{} : Arrivals{std::chrono::seconds(1), 1};
  };
  surroundings_.driveMoment = [] { return DriveMoment{std::chrono::seconds(24), 1}; };
  surroundings_.headline = [](std::string_view area, std::string_view category) {
    return category == "RRC State" ? std::string("CONNECTED") : std::string(area) + std::string(13, '.');
  };
  surroundings_.technologyInstead = [](std::string_view, std::string_view category) {
    return category == "C-DRX" ? "GSM" : "";
  };
  desk_.emplace(interface_.stack(), Size{50, 14}, surroundings_);
  desk_->type(U"j");
  desk_->press(Key::Enter);
  desk_->press(Key::End);
  EXPECT_EQ(desk_->picture(), R"(
| Vesk › LTE
|  LTE
|  NAS                                          ›
|  RRC State                    CONNECTED  23 s ›
|  Serving Cell Info     LTE.............  23 s ›
|  Serving Cell Meas     LTE.............  23 s ›
|  Tx Power              LTE.............  23 s ›
|  Sel Resel Parameters  LTE.............  23 s ›
|  EUTRA Neighbor Info   LTE.............  23 s ›
|  C-DRX        LTE.............  23 s, now GSM ›
|  LTE Neighbor Cell Meas                  23 s ›
|
|
| ? help  Enter open  Esc back  / filter
)");
}

TEST_F(PresenterTest, ShowsANoticeForItsTime) {
  desk_->presenter().tell("a pipe has no way back", desk_->now() + std::chrono::seconds(5));
  EXPECT_EQ(desk_->line(9), " a pipe has no way back");
  EXPECT_EQ(desk_->presenter().nextChange(), desk_->now() + std::chrono::seconds(5));
  desk_->type(U"/");
  EXPECT_EQ(desk_->line(9).substr(0, 5), " /▏");
  desk_->press(Key::Escape);
  EXPECT_EQ(desk_->line(9), " a pipe has no way back");
  desk_->wait(std::chrono::seconds(5));
  EXPECT_EQ(desk_->line(9).substr(0, 7), " ? help");
}

TEST_F(PresenterTest, TheMouseSelectsOpensScrollsAndGoesBack) {
  desk_->click(5, 3);
  EXPECT_EQ(desk_->line(0), " Vesk › LTE");
  desk_->mouse(MouseAction::WheelDown, 5, 5);
  EXPECT_EQ(selected(), "Serving Cell Info in 2");
  desk_->mouse(MouseAction::WheelUp, 5, 5);
  EXPECT_EQ(selected(), "Serving Cell Info in 4");
  desk_->click(5, 6);
  EXPECT_EQ(desk_->line(0), " Vesk › LTE › Tx Power");
  desk_->click(9, 0);
  EXPECT_EQ(desk_->line(0), " Vesk › LTE");
  desk_->click(1, 0);
  EXPECT_EQ(depth(), 1U);
  EXPECT_TRUE(tracking_.empty());
}

TEST_F(PresenterTest, TracksWhileTheListIsDragged) {
  showFields(numbered(30));
  desk_->mouse(MouseAction::Press, 5, 7);
  EXPECT_TRUE(tracking_.empty());
  desk_->mouse(MouseAction::Drag, 5, 4);
  EXPECT_EQ(tracking_, std::vector<bool>{true});
  EXPECT_EQ(selected(), "row 3 in 2");
  desk_->mouse(MouseAction::Drag, 5, 5);
  EXPECT_EQ(selected(), "row 3 in 3");
  desk_->mouse(MouseAction::Release, 5, 5);
  EXPECT_EQ(tracking_, (std::vector<bool>{true, false}));
  EXPECT_EQ(depth(), 3U);
}

TEST_F(PresenterTest, TheScrollBarIsClickedAndDragged) {
  showFields(numbered(30));
  const std::pair<int, std::string> steps[] = {{8, "row 23"}, {5, "row 11"}, {2, "row 0"}, {20, "row 23"}};
  for (const auto& [line, first] : steps) {
    desk_->mouse(line > 8 ? MouseAction::Drag : MouseAction::Press, 39, line);
    EXPECT_EQ(desk_->line(2).substr(2, first.size() + 1), first + " ") << line;
  }
  EXPECT_EQ(tracking_, std::vector<bool>{true});
  EXPECT_EQ(depth(), 3U);
}

TEST_F(PresenterTest, StopsTrackingWhenTheReleaseIsLost) {
  showFields(numbered(30));
  const std::function<void()> interruptions[] = {
      [&] { desk_->press(Key::Down); },
      [&] { desk_->mouse(MouseAction::Press, 1, 1); },
      [&] { desk_->presenter().forgetMouse(); },
  };
  for (const auto& interruption : interruptions) {
    desk_->mouse(MouseAction::Press, 5, 7);
    desk_->mouse(MouseAction::Drag, 5, 4);
    interruption();
    EXPECT_EQ(std::exchange(tracking_, {}), (std::vector<bool>{true, false}));
  }
}

}  // namespace
}  // namespace vesk
