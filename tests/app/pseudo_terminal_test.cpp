// The program with its screens, as a user at a terminal meets it.

#include "support/pseudo_terminal.h"

#include <algorithm>
#include <csignal>
#include <cstdlib>
#include <functional>

#include "app/vesk_program.h"
#include "messages/lte/lte.h"
#include "messages/registry/metric_identifiers.h"

namespace vesk {
namespace {

constexpr const char* kDown = "\x1b[B";
constexpr const char* kAlternateScreen = "\x1b[?1049h";
constexpr const char* kScreenAsBefore = "\x1b[?1049l";
constexpr const char* kCursorShown = "\x1b[?25h";

std::string levels() {
  const auto level = std::make_shared<metrics::RsrpRsrqSinr>();
  level->setSinr0(23);
  metrics::KCellularLteRsrpRsrqSinr message;
  message.addInstValues(level);
  return recorded(0, K_LTE_RSRP_RSRQ_SINR, message);
}

bool areAlike(const termios& one, const termios& other) {
  return one.c_iflag == other.c_iflag && one.c_oflag == other.c_oflag && one.c_cflag == other.c_cflag &&
         one.c_lflag == other.c_lflag && std::equal(std::begin(one.c_cc), std::end(one.c_cc), other.c_cc);
}

TEST(AtATerminal, TheUserWalksToAValueAndBackAndLeavesTheTerminalAsItWas) {
  setenv("TERM", "xterm", 1);
  const TemporaryFile recording(levels());
  const std::function<int(PseudoTerminal&, ChildProcess&)> ends[] = {
      [](PseudoTerminal& terminal, ChildProcess& process) {
        terminal.type("q");
        return process.waitForExit();
      },
      [](PseudoTerminal&, ChildProcess& process) { return process.endBy(SIGTERM); },
  };
  for (const auto& end : ends) {
    PseudoTerminal terminal({100, 24});
    const termios before = terminal.modes();
    ChildProcess process(VESK_PROGRAM, {"--log", "none", "--speed", "max", "--replay", recording.path()},
                         terminal.openForProgram());
    const std::string launch = terminal.readUpTo("quit");
    EXPECT_TRUE(launch.starts_with(kAlternateScreen)) << launch;
    EXPECT_EQ(launch.find("pushing metric file"), std::string::npos) << "printed over the screens";
    terminal.type("d");
    ASSERT_TRUE(terminal.readUpTo("Valid").ends_with("Valid")) << "the recorded event is not in the stores";
    ASSERT_FALSE(areAlike(terminal.modes(), before));

    terminal.type(std::string("dd") + kDown + "\r");
    ASSERT_TRUE(terminal.readUpTo("Bearers").ends_with("Bearers"));
    terminal.type(std::string(kDown) + kDown + kDown + "\r");
    const std::string values = terminal.readUpTo("11.5");
    EXPECT_TRUE(values.ends_with("11.5")) << values;
    terminal.type("\x1b");
    ASSERT_TRUE(terminal.readUpTo("Bearers").ends_with("Bearers"));

    EXPECT_EQ(end(terminal, process), 0);
    const std::string left = terminal.readUpTo(kScreenAsBefore);
    EXPECT_TRUE(left.ends_with(kScreenAsBefore)) << left;
    EXPECT_NE(left.find(kCursorShown), std::string::npos) << left;
    EXPECT_TRUE(areAlike(terminal.modes(), before));
  }
}

TEST(AtATerminal, AnUnknownTerminalIsShownTheScreensOfAUsualOne) {
  setenv("TERM", "nobody-knows-it", 1);
  PseudoTerminal terminal({100, 24});
  ChildProcess process(VESK_PROGRAM, {"--log", "none"}, terminal.openForProgram());
  const std::string launch = terminal.readUpTo("quit");
  EXPECT_TRUE(launch.starts_with("vesk: the terminal \"nobody-knows-it\" is not known")) << launch;
  EXPECT_EQ(launch.find('\n'), launch.find(kAlternateScreen) - 1) << launch;
  terminal.type("q");
  EXPECT_EQ(process.waitForExit(), 0);
}

TEST(AtATerminal, WithoutScreensTheLinesArePrintedFromTheFirstOn) {
  setenv("TERM", "dumb", 1);
  const TemporaryFile recording(levels());
  PseudoTerminal terminal({100, 24});
  ChildProcess process(VESK_PROGRAM, {"--log", "none", "--speed", "max", "--replay", recording.path()},
                       terminal.openForProgram());
  const std::string lines = terminal.readUpTo("Received Valid Metric\r\n");
  EXPECT_TRUE(lines.starts_with("vesk: ")) << lines;
  EXPECT_NE(lines.find("; running without screens\r\npushing metric file\r\nQuerying SIM files\r\nMetric ID in Hex"),
            std::string::npos)
      << lines;
  EXPECT_EQ(process.waitForExit(), 0);
}

}  // namespace
}  // namespace vesk
