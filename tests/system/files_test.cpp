#include <fstream>
#include <gtest/gtest.h>
#include <string>

#include "system/file.h"

namespace vesk {
namespace {

TEST(ReadFile, GivesTheWholeContentOrNothing) {
  const std::string path = testing::TempDir() + "vesk_files_test.bin";
  const std::string content(200'001, '\0');
  std::ofstream(path, std::ios::binary) << content;
  const std::optional<Data> data = readFile(path);
  ASSERT_TRUE(data);
  EXPECT_EQ(data->bytes().size(), content.size());
  std::ofstream(path, std::ios::trunc).close();
  EXPECT_EQ(readFile(path), Data());
  EXPECT_EQ(readFile(testing::TempDir()), std::nullopt);
  EXPECT_EQ(readFile(path + ".missing"), std::nullopt);
}

}  // namespace
}  // namespace vesk
