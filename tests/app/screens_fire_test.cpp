// The program's own screens over contents that nobody would wish for.

#include <gtest/gtest.h>
#include <random>
#include <variant>

#include "app/connected_program.h"
#include "app/hostile_recording.h"
#include "recording/recording_reader.h"
#include "screens/first_level_view_controller.h"
#include "screens/second_level_view_controller.h"
#include "screens/vesk_view_controller.h"
#include "support/input.h"
#include "support/pictures.h"
#include "support/recorded_output.h"
#include "support/terminal_language.h"
#include "terminal/device/capabilities.h"
#include "terminal/device/difference.h"
#include "terminal/view/diagnostic_lines.h"
#include "toolkit/interface_layout.h"

namespace vesk {
namespace {

void shrink(Record& record) {
  if (!record.empty()) record.erase((record.end() - 1)->key);
}
void shrink(RecordList& list) {
  if (list.size() > 0) list.erase(list.size() - 1);
  if (list.size() > 0) shrink(list.mutableItems()[0]);
}
void shrink(Value& /*value*/) {}

/// Takes everything from the lists and records of the stores, one entry at a time.
void shrinkStores(Stores& stores) {
  visitTechnologyFields(stores, [](std::string_view, auto& field) { shrink(field); });
  visitLatestRecords(stores, [](std::string_view, LatestRecord& record) {
    if (record) shrink(*record);
    if (record && record->empty()) record.reset();
  });
}

/// Finds less in the stores each time that its table asks it for something.
class ShrinkingScreen : public SecondLevelViewController {
 public:
  inline static bool isShrinking = false;

  std::size_t numberOfSections() override { return shrunk().SecondLevelViewController::numberOfSections(); }
  std::optional<Text> headerTitle(std::size_t section) override {
    return shrunk().SecondLevelViewController::headerTitle(section);
  }
  std::size_t numberOfRows(std::size_t section) override {
    return shrunk().SecondLevelViewController::numberOfRows(section);
  }
  std::unique_ptr<TableViewCell> cellForRow(IndexPath at) override {
    return shrunk().SecondLevelViewController::cellForRow(at);
  }
  RowHeight rowHeight(IndexPath at) override { return shrunk().SecondLevelViewController::rowHeight(at); }

 private:
  ShrinkingScreen& shrunk() {
    if (isShrinking) shrinkStores(MetricValidator::shared()->stores);
    return *this;
  }
};

class ScreensUnderFire : public testing::Test {
 protected:
  void fillStores() {
    RecordingReader reader(fileWith(recording_), "hostile");
    for (auto step = reader.next(); const auto* event = std::get_if<RecordedEvent>(&step); step = reader.next())
      program_.raise(event->metricId, event->payload);
    program_.deliverAll();
  }

  const std::string recording_ = hostileRecording();
  ConnectedProgram program_;
  const InterfaceLayout layout_{{
      .rootStack = makeStackOf<NavigationController>,
      .firstScreen = "Launch",
      .screens = {{"Launch", makeScreenOf<VeskViewController>, "Vesk"},
                  {"FirstLevel", makeScreenOf<FirstLevelViewController>, {}},
                  {"SecondLevel", makeScreenOf<ShrinkingScreen>, {}}},
      .cells = veskInterfaceCells(),
      .transitions = {{"Launch", "showCategories", "FirstLevel"}, {"FirstLevel", "showValues", "SecondLevel"}},
  }};

 private:
  static std::vector<CellDeclaration> veskInterfaceCells() {
    const auto cells = veskInterface().cells();
    return {cells.begin(), cells.end()};
  }
};

/// Calls `use` with the table of each category, which lies on top of `stack` meanwhile.
template <class Use>
void openEachCategory(NavigationController& stack, Use use) {
  const auto top = [&stack]() -> TableViewController& {
    return dynamic_cast<TableViewController&>(*stack.topViewController());
  };
  stack.loadViewIfNeeded();
  for (std::size_t area = 0; area < top().tableView().numberOfRows(0); ++area) {
    top().selectRow({0, area});
    for (std::size_t category = 0; category < top().tableView().numberOfRows(0); ++category) {
      top().selectRow({0, category});
      use(top().tableView());
      stack.popToDepth(2);
    }
    stack.popToDepth(1);
  }
}

TEST_F(ScreensUnderFire, NothingOfAPayloadReachesTheTerminalAsAControl) {
  setenv("TERM", "xterm-256color", 1);
  std::string reason;
  const std::optional<Capabilities> terminal = readCapabilities(STDOUT_FILENO, kHasUtf8Locale, reason);
  ASSERT_TRUE(terminal.has_value()) << reason;
  DiagnosticLines lines;
  const auto output = OutputLines::setSink(std::make_unique<DiagnosticSink>(lines));
  fillStores();
  const std::shared_ptr<NavigationController> stack = layout_.makeRootStack();
  Surroundings surroundings;
  surroundings.diagnostics = &lines;
  Desk desk(*stack, {100, 40}, surroundings);
  desk.type(U"d");
  TerminalLanguage language;
  int screens = 0;
  openEachCategory(*stack, [&](TableView&) {
    ++screens;
    for (const Size size : {Size{100, 40}, {31, 17}, {300, 90}}) {
      desk.resize(size);
      for (const Key key : {Key::Home, Key::Down, Key::PageDown, Key::End, Key::Up}) {
        desk.press(key);
        desk.type(U"[");
        std::string bytes;
        appendDifference(bytes, {}, desk.grid(), *terminal);
        language.take(bytes);
        ASSERT_EQ(language.fault(), std::nullopt);
      }
    }
  });
  EXPECT_EQ(screens, 42);
  OutputLines::setSink(nullptr);
}

TEST_F(ScreensUnderFire, AStoreThatShrinksBetweenEveryCountAndCellLeavesRowsEmptyUntilItIsFilled) {
  const RecordedOutput output;
  fillStores();
  Stores& stores = MetricValidator::shared()->stores;
  const Stores filled = stores;
  const std::shared_ptr<NavigationController> stack = layout_.makeRootStack();
  constexpr std::array kKeys{Key::Down, Key::Up, Key::PageDown, Key::PageUp, Key::End, Key::Home, Key::Tab};
  std::mt19937 random(1);
  openEachCategory(*stack, [&](TableView& table) {
    Desk desk(*stack, {60, 20});
    table.reloadData();
    const std::string whole = desk.picture();
    ShrinkingScreen::isShrinking = true;
    for (int number = 0; number < 60; ++number) {
      if (number % 10 == 0) {
        stores = filled;
        table.reloadData();
      }
      if (number % 15 == 0) desk.type(number % 2 == 0 ? U"/1\r" : U"f");
      desk.press(kKeys[random() % kKeys.size()]);
      EXPECT_FALSE(desk.picture().empty());
    }
    ShrinkingScreen::isShrinking = false;
    stores = filled;
    Desk later(*stack, {60, 20});
    table.reloadData();
    EXPECT_EQ(later.picture(), whole);
  });
}

}  // namespace
}  // namespace vesk
