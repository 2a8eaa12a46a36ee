#include "app/bundle.h"

#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>

namespace vesk {
namespace {

TEST(Bundle, FindsAResourceInTheFirstDirectoryThatHasIt) {
  const std::filesystem::path root = testing::TempDir() + "vesk_bundle_test";
  const std::filesystem::path first = root / "first";
  const std::filesystem::path second = root / "second";
  std::filesystem::create_directories(first / "folder.deviceconfig");
  std::filesystem::create_directories(second);
  for (const auto& path : {first / "both.deviceconfig", second / "both.deviceconfig", second / "one.txt"})
    std::ofstream(path) << "content";
  const Bundle bundle({first, second});
  EXPECT_EQ(bundle.pathForResource("both", "deviceconfig"), (first / "both.deviceconfig").string());
  EXPECT_EQ(bundle.pathForResource("one", "txt"), (second / "one.txt").string());
  EXPECT_EQ(bundle.pathForResource("one", "deviceconfig"), std::nullopt);
  EXPECT_EQ(bundle.pathForResource("folder", "deviceconfig"), std::nullopt);
  std::filesystem::remove_all(root);
}

}  // namespace
}  // namespace vesk
