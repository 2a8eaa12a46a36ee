#include <gtest/gtest.h>

#include "support/fake_table_screen.h"
#include "toolkit/application.h"
#include "toolkit/interface_layout.h"
#include "toolkit/navigation_controller.h"

namespace vesk {
namespace {

std::vector<std::string> happenings;

class RootStack : public NavigationController {
 public:
  void viewDidLoad() override { happenings.emplace_back("root loaded"); }
};

class ListScreen : public FakeTableScreen {
 public:
  std::optional<Text> chosen;

  void viewDidLoad() override {
    FakeTableScreen::viewDidLoad();
    happenings.push_back("list loaded with " + std::string(chosen ? chosen->view() : "nothing"));
  }
};

class LaunchScreen : public FakeTableScreen {
 public:
  LaunchScreen() {
    identifier = "LaunchView";
    content = {{std::nullopt, {{"LTE"_text, std::nullopt}, {"GSM"_text, std::nullopt}, {}}}};
  }
  void viewDidLoad() override {
    FakeTableScreen::viewDidLoad();
    happenings.emplace_back("launch loaded");
  }
  void prepareForTransition(const Transition& transition, Responder* sender) override {
    const auto* cell = dynamic_cast<TableViewCell*>(sender);
    auto* list = dynamic_cast<ListScreen*>(&transition.destination);
    if (cell == nullptr || list == nullptr) return;
    list->chosen = cell->mainText();
    happenings.push_back("prepared " + std::string(transition.identifier));
  }
};

const InterfaceLayout& layout() {
  static const InterfaceLayout theLayout({
      .rootStack = makeStackOf<RootStack>,
      .firstScreen = "Launch",
      .screens = {{"Launch", makeScreenOf<LaunchScreen>, "Start"}, {"List", makeScreenOf<ListScreen>, ""}},
      .cells = {{"LaunchView", CellStyle::Basic, CellAccessory::Disclosure}},
      .transitions = {{"Launch", "showList", "List"}, {"List", "up", "Gone"}},
  });
  return theLayout;
}

class Navigation : public testing::Test {
 protected:
  Navigation() { happenings.clear(); }

  const std::shared_ptr<NavigationController> stack_ = layout().makeRootStack();
  LaunchScreen& launch_ = dynamic_cast<LaunchScreen&>(*stack_->stack().front());
};

TEST_F(Navigation, SelectingARowPreparesTheDestinationBeforeItLoads) {
  stack_->loadViewIfNeeded();
  happenings.clear();
  EXPECT_TRUE(launch_.selectRow({0, 1}));
  EXPECT_EQ(happenings, (std::vector<std::string>{"prepared showList", "list loaded with GSM"}));
  ASSERT_EQ(stack_->stack().size(), 2U);
  EXPECT_EQ(stack_->topViewController()->title(), "GSM"_text);
}

TEST_F(Navigation, GoesNowhereWithoutARowADeclarationOrAStack) {
  stack_->loadViewIfNeeded();
  EXPECT_FALSE(launch_.selectRow({0, 3}));
  EXPECT_FALSE(launch_.performTransition("unknown", nullptr));
  EXPECT_TRUE(launch_.selectRow({0, 2}));
  EXPECT_EQ(stack_->topViewController()->title(), std::nullopt);
  EXPECT_FALSE(stack_->topViewController()->performTransition("up", nullptr));
  EXPECT_EQ(stack_->stack().size(), 2U);
}

TEST_F(Navigation, TellsScreensThatTheyLeftAndKeepsTheFirst) {
  stack_->loadViewIfNeeded();
  for (int screen = 0; screen < 3; ++screen)
    stack_->push(std::make_shared<FakeTableScreen>());
  const auto third = std::dynamic_pointer_cast<FakeTableScreen>(stack_->stack()[2]);
  const std::shared_ptr<ViewController> fourth = stack_->pop();
  EXPECT_EQ(fourth->navigationController(), nullptr);
  EXPECT_EQ(third->departures, 0);
  stack_->popToDepth(0);
  EXPECT_EQ(third->departures, 1);
  EXPECT_EQ(stack_->stack().size(), 1U);
  EXPECT_EQ(stack_->pop(), nullptr);
  EXPECT_EQ(launch_.departures, 0);
}

class RecordingDelegate : public ApplicationDelegate {
 public:
  bool launches = true;

  bool didFinishLaunching() override {
    happenings.emplace_back("launched");
    return launches;
  }
  void willResignActive() override { happenings.emplace_back("inactive"); }
  void didEnterBackground() override { happenings.emplace_back("background"); }
  void willEnterForeground() override { happenings.emplace_back("foreground"); }
  void didBecomeActive() override { happenings.emplace_back("active"); }
  void willTerminate() override { happenings.emplace_back("terminated"); }
};

TEST(Application, LivesFromLaunchToTermination) {
  happenings.clear();
  RecordingDelegate delegate;
  Application application(layout(), delegate);
  EXPECT_EQ(application.run([&](NavigationController& root) {
    EXPECT_EQ(&root, &delegate.window()->rootNavigationController());
    happenings.emplace_back("main loop");
    application.enterBackground();
    application.enterForeground();
  }),
            0);
  EXPECT_EQ(happenings,
            (std::vector<std::string>{"launched", "root loaded", "launch loaded", "active", "main loop", "inactive",
                                      "background", "foreground", "active", "inactive", "terminated"}));
}

TEST(Application, BuildsNothingWhenTheLaunchIsRefused) {
  RecordingDelegate delegate;
  delegate.launches = false;
  EXPECT_EQ(Application(layout(), delegate).run([](NavigationController&) { FAIL(); }), 1);
  EXPECT_EQ(delegate.window(), nullptr);
}

}  // namespace
}  // namespace vesk
