#include "app/program/configuration.h"

#include <cstdio>
#include <fstream>
#include <gtest/gtest.h>

namespace vesk {
namespace {

class ConfigurationTest : public testing::Test {
 protected:
  std::optional<Configuration> read(const std::string& content) {
    std::ofstream(path_) << content;
    testing::internal::CaptureStderr();
    auto configuration = readConfiguration(path_);
    told_ = testing::internal::GetCapturedStderr();
    std::remove(path_.c_str());
    return configuration;
  }

  const std::string path_ = testing::TempDir() + "vesk_configuration_test.toml";
  std::string told_;
};

TEST_F(ConfigurationTest, SaysWhatIsOtherwiseThanUsual) {
  const auto configuration = read(R"(
start = "LTE/RRC State"
signs = "block"
rules = ["lte.rsrp < -110 for 10 s", "event drop"]
[colors]
bar = "bold white on 24"
section-header = "underline"
)");
  ASSERT_TRUE(configuration) << told_;
  EXPECT_EQ(configuration->start.area, "LTE");
  EXPECT_EQ(configuration->start.category, "RRC State");
  EXPECT_EQ(configuration->appearance.signs, Signs::blocks);
  EXPECT_EQ(configuration->rules.size(), 2U);
  const Palette palette = withLooksOf(configuration->appearance, Palette{}, 16);
  EXPECT_EQ(palette[static_cast<std::size_t>(Role::Bar)], (Look{.foreground = 7, .isBold = true}));
  EXPECT_EQ(palette[static_cast<std::size_t>(Role::SectionHeader)], Look{.isUnderlined = true});

  EXPECT_EQ(read("start = 'overview'")->start.action, Action::Overview);
  EXPECT_TRUE(read(""));
  EXPECT_TRUE(readConfiguration(path_ + ".none"));
}

TEST_F(ConfigurationTest, TellsEachMistakeWithItsLine) {
  const std::pair<const char*, const char*> cases[] = {
      {"signs = 3", ":1: signs: expected \"braille\""},
      {"\nsings = 'ascii'", ":2: unknown key sings: expected start"},
      {"start = 'LTE/RRC Stat'", ":1: start: expected \"menu\""},
      {"rules = ['event drop',\n 'event drip', 7]", ":2: rule \"event drip\", column 7: expected a kind"},
      {"rules = 'event drop'", ":1: rules: expected a list"},
      {"[colors]\nbar = 'white on whitish'", ":2: bar: expected words"},
      {"[colors]\nbra = 'white'", ":2: unknown key colors.bra: expected plain, faint"},
      {"colors = 1", ":1: colors: expected a table"},
      {"start = ", ":1: "},
  };
  for (const auto& [content, expected] : cases) {
    EXPECT_FALSE(read(content));
    EXPECT_EQ(told_.find("vesk: " + path_ + expected), 0U) << told_;
  }
}

}  // namespace
}  // namespace vesk
