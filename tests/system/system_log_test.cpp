#include "system/system_log.h"

#include <cstdio>
#include <fcntl.h>
#include <fstream>
#include <gtest/gtest.h>
#include <sstream>
#include <string>
#include <sys/stat.h>
#include <unistd.h>

#include "support/input.h"
#include "support/recorded_log.h"

namespace vesk {
namespace {

/// Of a pipe that does not block.
std::string readAllThereIs(const FileDescriptor& reading) {
  std::string bytes;
  char some[4096];
  for (ssize_t count = 0; (count = read(reading.get(), some, sizeof some)) > 0;)
    bytes.append(some, static_cast<std::size_t>(count));
  return bytes;
}

TEST(SystemLog, WritesWhatThePresentSinkIsToldAndNothingWithoutOne) {
  ASSERT_FALSE(SystemLog::isOpen());
  SystemLog::write("lost %d", 1);
  {
    const RecordedLog log;
    EXPECT_TRUE(SystemLog::isOpen());
    SystemLog::write("%s: error=%d msg=%s", "-[Link listen]", -3, std::string(2000, 'm').c_str());
    ASSERT_EQ(log.lines().size(), 1U);
    EXPECT_EQ(log.lines()[0], "-[Link listen]: error=-3 msg=" + std::string(2000, 'm'));
  }
  EXPECT_FALSE(SystemLog::isOpen());
}

TEST(SystemLog, AppendsToAFileLineByLine) {
  const std::string path = testing::TempDir() + "vesk_system_log_test.log";
  std::remove(path.c_str());
  for (const char* line : {"first", "second"}) {
    SystemLog::setSink(makeFileSink(path));
    SystemLog::write("%s", line);
    SystemLog::setSink(nullptr);
  }
  std::stringstream content;
  content << std::ifstream(path).rdbuf();
  EXPECT_EQ(content.str(), "first\nsecond\n");
  EXPECT_EQ(makeFileSink("/no/such/folder/vesk.log"), nullptr);

  // A link is another's to lay where others may write.
  const std::string folder = testing::TempDir() + "vesk_system_log_test.folder";
  const std::string link = folder + "/vesk.log";
  mkdir(folder.c_str(), 0700);
  std::remove(link.c_str());
  ASSERT_EQ(symlink(path.c_str(), link.c_str()), 0);
  for (const mode_t mode : {0700U, 0720U, 0702U}) {
    ASSERT_EQ(chmod(folder.c_str(), mode), 0);
    EXPECT_EQ(makeFileSink(link) != nullptr, mode == 0700U);
  }
}

TEST(SystemLog, GoesOnBesideAReaderThatStoppedReadingAndTellsItLaterWhatItMissed) {
  constexpr int kLines = 200;
  for (const std::size_t length : {1000U, 10000U}) {
    const Pipe pipe;
    fcntl(pipe.reading.get(), F_SETFL, O_NONBLOCK);
    const auto sink = makeFileSink("/proc/self/fd/" + std::to_string(pipe.writing.get()), std::chrono::milliseconds(0));
    ASSERT_NE(sink, nullptr);
    const std::string line(length, 'x');
    for (int number = 0; number < kLines; ++number)
      sink->write(line);
    std::string read = readAllThereIs(pipe.reading);
    const auto whole = static_cast<int>(read.size() / (length + 1));
    EXPECT_GT(whole, 0);
    sink->write("again");
    sink->write("and again");
    std::string expected;
    for (int number = 0; number < whole; ++number)
      expected += line + '\n';
    if (const std::size_t rest = read.size() % (length + 1); rest > 0) expected += line.substr(0, rest) + '\n';
    expected += std::to_string(kLines - whole) + " lines were dropped here\nagain\nand again\n";
    EXPECT_EQ(read + readAllThereIs(pipe.reading), expected);
  }
}

}  // namespace
}  // namespace vesk
