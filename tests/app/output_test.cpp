// Where the program's output goes when nobody, or nothing, takes it.

#include <csignal>

#include "app/vesk_program.h"
#include "support/bytes.h"

namespace vesk {
namespace {

const std::string kEvent = R"({"at": 0, "metric": "0x3C4E04", "payload": "1003"})"
                           "\n";

TEST(Output, ThatCannotBeWrittenIsToldAndEndsTheProgramWhateverItWrites) {
  const std::vector<std::string> commands[] = {
      {"decode"},   {"stores"}, {"show", "LTE", "RRC State", "-"},
      {"simulate"}, {"--help"}, {"--headless", "--log", "none", "--replay", "-"},
  };
  const FileDescriptor fullDisk(open("/dev/full", O_WRONLY | O_CLOEXEC));
  Pipe pipe;
  pipe.reading = FileDescriptor();
  for (const auto& arguments : commands) {
    for (const auto& [output, reason] :
         {std::pair(&fullDisk, "No space left on device"), {&pipe.writing, "Broken pipe"}}) {
      const FileDescriptor error = fileWith("");
      EXPECT_EQ(ChildProcess(VESK_PROGRAM, arguments, fileWith(kEvent), *output, error).waitForExit(), 1)
          << arguments[0];
      EXPECT_EQ(contentOf(error), std::string("vesk: standard output: ") + reason + '\n') << arguments[0];
    }
  }
}

TEST(Output, ThatIsNotReadAnyMoreHoldsUpNoSignal) {
  struct Case {
    /// What the lines of the recording are, and whether what they make is told on standard error.
    std::string line;
    bool isError;
    int status;
  };
  const FileDescriptor other(open("/dev/null", O_WRONLY | O_CLOEXEC));
  for (const Case& row : {Case{kEvent, false, 0}, {"bad\n", true, 1}}) {
    for (const int linesRead : {1, 3, 100}) {
      Pipe input;
      Pipe unread;
      fcntl(unread.reading.get(), F_SETPIPE_SZ, 4096);
      ChildProcess process(VESK_PROGRAM, {"--headless", "--log", "none", "--speed", "max", "--replay", "-"},
                           input.reading, row.isError ? other : unread.writing, row.isError ? unread.writing : other);
      writeAll(input.writing, repeated(1000, row.line));
      for (int line = 0; line < linesRead; ++line)
        EXPECT_FALSE(readLine(unread.reading).empty());
      EXPECT_EQ(process.endBy(SIGTERM), row.status) << row.line;
    }
  }
}

}  // namespace
}  // namespace vesk
