#include "platform/system_log.h"

#include <cstdio>
#include <fstream>
#include <gtest/gtest.h>
#include <sstream>

#include "support/recorded_log.h"

namespace vesk {
namespace {

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
}

}  // namespace
}  // namespace vesk
