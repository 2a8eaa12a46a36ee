#include "terminal/terminal.h"

#include <csignal>
#include <functional>
#include <gtest/gtest.h>
#include <sys/resource.h>
#include <sys/wait.h>

#include "support/fake_interface.h"
#include "support/manual_clock.h"
#include "support/pictures.h"
#include "support/pseudo_terminal.h"

namespace vesk {
namespace {

using namespace std::chrono_literals;

Capabilities capabilities() {
  Capabilities terminal;
  terminal.moveTo = "<%p2%d,%p1%d>";
  terminal.clear = "<clear>";
  terminal.enterScreen = "<enter>";
  terminal.leaveScreen = "<leave>";
  return terminal;
}

class TerminalTest : public testing::Test {
 protected:
  TerminalTest() {
    surroundings_.quit = [this] { isOver_ = true; };
    surroundings_.setInBackground = [this](bool isInBackground) { background_.push_back(isInBackground); };
  }

  void open() {
    terminal_ =
        std::make_unique<Terminal>(interface_.stack(), clock_, surroundings_, tty_.openForProgram(), capabilities());
  }
  void serveWhenReadable() {
    ASSERT_TRUE(waitUntilReadable(terminal_->descriptor()));
    terminal_->serve();
  }
  /// Runs the terminal in a process of its own until it quits; `meanwhile` is called there before each wait.
  pid_t runElsewhere(const std::function<void()>& meanwhile) {
    const pid_t child = fork();
    if (child != 0) return child;
    // A stop signal would pass a group by that nobody could continue.
    setpgid(0, 0);
    const rlimit noCoreFile{0, 0};
    setrlimit(RLIMIT_CORE, &noCoreFile);
    open();
    while (!isOver_) {
      meanwhile();
      serveWhenReadable();
    }
    terminal_.reset();
    _exit(7);
  }

  PseudoTerminal tty_{{40, 10}};
  ManualClock clock_;
  FakeInterface interface_;
  Surroundings surroundings_;
  bool isOver_ = false;
  std::vector<bool> background_;
  std::unique_ptr<Terminal> terminal_;
};

TEST_F(TerminalTest, TakesTheTerminalOverAndGivesItBack) {
  ASSERT_TRUE(tty_.isLineByLine());
  open();
  // A key that interrupts must not cut what is drawn off within a sequence.
  EXPECT_EQ(tty_.modes().c_lflag & (ICANON | ECHO | ISIG | NOFLSH), static_cast<tcflag_t>(ISIG | NOFLSH));
  const std::string drawn = tty_.readUpTo("filter");
  EXPECT_TRUE(drawn.starts_with("<enter><clear>")) << drawn;
  EXPECT_NE(drawn.find("Device Info"), std::string::npos);
  terminal_.reset();
  EXPECT_EQ(tty_.readUpTo("<leave>"), "<leave>");
  EXPECT_TRUE(tty_.isLineByLine());
}

TEST_F(TerminalTest, DrawsOnlyWhatAKeyChangedAndAllWhenResized) {
  open();
  tty_.readUpTo("filter");
  tty_.type("d");
  serveWhenReadable();
  EXPECT_EQ(tty_.readUpTo("lines").substr(0, 20), "<0,6> Diagnostics   ");
  tty_.resize({60, 12});
  raise(SIGWINCH);
  serveWhenReadable();
  const std::string drawn = tty_.readUpTo("<1,11>?");
  EXPECT_TRUE(drawn.find("<clear>") <= 1 && drawn.ends_with("?")) << drawn;
  tty_.type("q");
  serveWhenReadable();
  EXPECT_TRUE(isOver_);
}

TEST_F(TerminalTest, TakesALoneEscapeWhenItsTimeHasCome) {
  interface_.top().selectRow({0, 1});
  open();
  tty_.type("\x1b");
  serveWhenReadable();
  clock_.advance(49ms);
  terminal_->serve();
  EXPECT_EQ(interface_.stack().stack().size(), 2U);
  clock_.advance(1ms);
  terminal_->serve();
  EXPECT_EQ(interface_.stack().stack().size(), 1U);
}

TEST_F(TerminalTest, ShowsAReloadAtMostOnceAFrame) {
  FakeTableScreen& fields = interface_.showFields(0, {{std::nullopt, {FakeTableScreen::row("power", "one")}}});
  open();
  tty_.readUpTo("hold");
  const auto change = [&](std::string_view value) {
    fields.content[0].rows[0] = FakeTableScreen::row("power", value);
    fields.tableView().reloadData();
  };
  change("two");
  clock_.advance(Terminal::kFrame - 1ms);
  terminal_->serve();
  change("three");
  clock_.advance(1ms);
  serveWhenReadable();
  EXPECT_EQ(tty_.readUpTo("three"), "<0,2>•<33,2>three");
}

TEST_F(TerminalTest, GoesOnBesideATerminalThatStoppedReadingAndShowsItTheNewestLater) {
  open();
  const auto resize = [&](Size size) {
    tty_.resize(size);
    raise(SIGWINCH);
    serveWhenReadable();
  };
  // Far more pictures than the terminal has room for.
  for (int times = 0; times < 100; ++times) {
    resize({300, 100});
    resize({299, 100});
  }
  interface_.top().selectRow({0, 1});
  tty_.type("j\r");
  serveWhenReadable();
  EXPECT_EQ(interface_.stack().stack().size(), 3U);
  resize({61, 12});
  clock_.advance(Terminal::kFrame);
  std::string drawn;
  while (drawn.find("<1,11>?") == std::string::npos) {
    const std::string some = tty_.readSome();
    ASSERT_FALSE(some.empty()) << drawn;
    drawn += some;
    terminal_->serve();
  }
  EXPECT_LT(drawn.find("<clear>"), drawn.rfind("<clear>"));
  terminal_.reset();
  EXPECT_TRUE(tty_.readUpTo("<leave>").ends_with("<leave>"));
}

TEST_F(TerminalTest, QuitsWhenTheTerminalIsGone) {
  open();
  tty_ = PseudoTerminal({1, 1});
  serveWhenReadable();
  EXPECT_TRUE(isOver_);
}

TEST_F(TerminalTest, GivesTheTerminalBackHoweverTheProgramEnds) {
  const std::function<void()> ends[] = {
      [] { std::abort(); }, [] { raise(SIGSEGV); }, [] { raise(SIGTERM); }, [] { raise(SIGHUP); }, [] { std::exit(7); },
  };
  for (const auto& end : ends) {
    const pid_t child = runElsewhere(end);
    int status = 0;
    const std::string drawn = tty_.readUpTo("<leave>");
    EXPECT_TRUE(drawn.starts_with("<enter>") && drawn.ends_with("<leave>")) << drawn;
    ASSERT_EQ(waitpid(child, &status, 0), child);
    EXPECT_NE(status, 0);
    EXPECT_TRUE(tty_.isLineByLine());
  }
}

TEST_F(TerminalTest, StopsAndGoesOn) {
  const pid_t child = runElsewhere([] {});
  tty_.readUpTo("filter");
  kill(child, SIGTSTP);
  int status = 0;
  ASSERT_EQ(waitpid(child, &status, WUNTRACED), child);
  ASSERT_TRUE(WIFSTOPPED(status));
  EXPECT_EQ(tty_.readUpTo("<leave>"), "<leave>");
  EXPECT_TRUE(tty_.isLineByLine());

  kill(child, SIGCONT);
  const std::string drawn = tty_.readUpTo("filter");
  EXPECT_TRUE(drawn.starts_with("<enter><clear>")) << drawn;
  EXPECT_FALSE(tty_.isLineByLine());
  tty_.type("q");
  ASSERT_EQ(waitpid(child, &status, 0), child);
  EXPECT_EQ(WEXITSTATUS(status), 7);
}

}  // namespace
}  // namespace vesk
