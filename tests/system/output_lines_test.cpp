#include "system/output_lines.h"

#include <chrono>
#include <cstdlib>
#include <fcntl.h>
#include <gtest/gtest.h>
#include <string>
#include <thread>
#include <vector>

#include "support/input.h"
#include "support/recorded_output.h"
#include "values/visible_text.h"

namespace vesk {
namespace {

std::string readSome(const FileDescriptor& descriptor) {
  char bytes[256];
  const ssize_t count = read(descriptor.get(), bytes, sizeof bytes);
  return {bytes, count < 0 ? 0 : static_cast<std::size_t>(count)};
}

TEST(OutputLines, SeparatesItemsByOneBlankAndLetsNothingActOnATerminal) {
  const RecordedOutput output;
  OutputLines::print({"Metric ID in Hex = ", "3C4E04"});
  OutputLines::print({});
  OutputLines::print({"a\x1b[2J\n\x7f", "\xC2\x9B\xC2\xA0\xE2\x82\xAC\xFF"});
  EXPECT_EQ(output.lines(), (std::vector<std::string>{"Metric ID in Hex =  3C4E04", "",
                                                      "a\\x1B[2J\\x0A\\x7F \\x9B\xC2\xA0\xE2\x82\xAC\xEF\xBF\xBD"}));
}

TEST(AppendVisible, FindsAControlCharacterAtEveryPlace) {
  for (std::size_t place = 0; place < 20; ++place) {
    for (const auto& [character, shown] :
         {std::pair{'\x1F', "\\x1F"}, {'\x7F', "\\x7F"}, {'\0', "\\x00"}, {'\xFF', "\xEF\xBF\xBD"}, {'~', "~"}}) {
      std::string text(20, 'a');
      std::string expected = text;
      text[place] = character;
      expected.replace(place, 1, shown);
      std::string out;
      appendVisible(out, text);
      EXPECT_EQ(out, expected) << place;
    }
  }
}

TEST(DescriptorSink, GathersLinesUntilFlushedWaitsForASlowReaderAndLosesNothing) {
  Pipe pipe;
  std::string sent;
  std::string received;
  std::thread reader;
  {
    DescriptorSink sink(pipe.writing.get(), "pipe");
    sink.write("one");
    fcntl(pipe.reading.get(), F_SETFL, O_NONBLOCK);
    EXPECT_EQ(readSome(pipe.reading), "");
    sink.flush();
    EXPECT_EQ(readSome(pipe.reading), "one\n");
    fcntl(pipe.reading.get(), F_SETFL, 0);
    reader = std::thread([&] {
      for (std::string some = readSome(pipe.reading); !some.empty(); some = readSome(pipe.reading))
        received += some;
    });
    for (int number = 0; number < 20000; ++number) {
      const std::string line = "line " + std::to_string(number);
      sink.write(line);
      sent += line + '\n';
    }
  }
  pipe.writing = FileDescriptor();
  reader.join();
  EXPECT_EQ(received, sent);
}

TEST(DescriptorSink, RemembersAClosedPipeAndTellsOnce) {
  Pipe pipe;
  pipe.reading = FileDescriptor();
  std::vector<std::string> reasons;
  DescriptorSink sink(pipe.writing.get(), "standard output");
  sink.setFailureHandler([&](const std::string& reason) { reasons.push_back(reason); });
  for (int times = 0; times < 2; ++times) {
    sink.write("line");
    sink.flush();
  }
  EXPECT_TRUE(sink.hasFailed());
  EXPECT_EQ(reasons, std::vector<std::string>{"standard output: Broken pipe"});
}

void writeAMegabyte(DescriptorSink& sink) {
  const std::string line(1000, 'x');
  for (int number = 0; number < 1000; ++number)
    sink.write(line);
  sink.flush();
}

TEST(DescriptorSink, DoesNotWaitForABlockedReaderOnceInterrupted) {
  Pipe pipe;
  const WakeUp interrupt;
  interrupt.signal();
  DescriptorSink sink(pipe.writing.get(), "pipe");
  sink.setInterrupt(&interrupt);
  writeAMegabyte(sink);
  EXPECT_FALSE(sink.hasFailed());
  EXPECT_FALSE(readSome(pipe.reading).empty());
}

TEST(DescriptorSink, GivesAReaderUpThatHasStoppedReadingWhenTheTimeIsOver) {
  const Pipe pipe;
  const FileDescriptor user(posix_openpt(O_RDWR | O_NOCTTY | O_CLOEXEC));
  ASSERT_EQ(grantpt(user.get()), 0);
  ASSERT_EQ(unlockpt(user.get()), 0);
  const FileDescriptor terminal(open(ptsname(user.get()), O_WRONLY | O_NOCTTY | O_CLOEXEC));
  for (const int writing : {pipe.writing.get(), terminal.get()}) {
    std::vector<std::string> reasons;
    DescriptorSink sink(writing, "reader");
    sink.setFailureHandler([&](const std::string& reason) { reasons.push_back(reason); });
    sink.setDeadline(std::chrono::steady_clock::now() - std::chrono::hours(1), std::chrono::milliseconds(0));
    sink.write("in time");
    sink.flush();
    EXPECT_FALSE(sink.hasFailed());
    writeAMegabyte(sink);
    EXPECT_EQ(reasons, std::vector<std::string>{"reader: nobody reads it"});
  }
  EXPECT_TRUE(readSome(pipe.reading).starts_with("in time\nxxx"));
}

}  // namespace
}  // namespace vesk
