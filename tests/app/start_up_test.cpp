#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>

#include "app/connected_program.h"
#include "app/program/app_id_validator.h"
#include "app/program/bundle.h"
#include "app/program/root_navigation_controller.h"
#include "screens/vesk_view_controller.h"
#include "system/output_lines.h"
#include "system/system_log.h"

namespace vesk {
namespace {

/// Tells printed lines and log lines one story.
class Narrator : public OutputSink, public LogSink {
 public:
  explicit Narrator(Lines& story) : story_(story) {}
  void write(std::string_view line) override { story_.emplace_back(line); }
  void flush() override {}

 private:
  Lines& story_;
};

/// While it lives, the metric configuration is two bytes, or missing.
class Resources {
 public:
  Resources() { std::ofstream(directory_ / "ice_test_lte.deviceconfig") << "\x01\xAB"; }
  Resources(const Resources&) = delete;
  Resources& operator=(const Resources&) = delete;
  ~Resources() {
    Bundle::setMain(before_);
    std::filesystem::remove_all(directory_);
  }
  void use() { Bundle::setMain(Bundle({directory_})); }
  static void useNone() { Bundle::setMain(Bundle({})); }

 private:
  static std::filesystem::path makeDirectory() {
    std::string name = testing::TempDir() + "vesk-resources-XXXXXX";
    return mkdtemp(name.data());
  }

  const Bundle before_ = Bundle::main();
  const std::filesystem::path directory_ = makeDirectory();
};

const std::string kCleared = "kCommandClearConfiguration {kKeyAppID: 2}";
const std::string kAdded = "kCommandAddConfiguration {kKeyAppID: 2, kKeyPayload: 0x01ab, kKeyPayloadType: 0}";
const std::string kQueried =
    "kCommandQueryMetric {kKeyAppID: 2, kKeyPayloadType: 0, kKeyTriggerRef: 9999, kKeyTriggerType: 0, "
    "kKeyTriggerID: 8323091, kKeyProfileID: 0, kKeyMetricID: 0}";
const std::string kListening = "-[CorvikWrapper listen]: listening for events";

std::string clearedLog(const char* outcome) {
  return std::string("-[CorvikWrapper removeQuodraConfigForAppid:]: ") + outcome;
}
std::string addedLog(const char* outcome) {
  return std::string("-[CorvikWrapper addQuodraConfigForAppId:andProtofFilePath:]: ") + outcome;
}
const std::string kQueriedLog =
    "-[CorvikWrapper querySpecificMetric:triggerRef:triggerType:triggerID:profileID:metricID:]: error=0 msg=";

TEST(StartUp, PushesTheConfigurationAndAsksForTheSimFilesUnlessSomethingIsInTheWay) {
  struct Case {
    bool hasConfiguration;
    std::optional<corvik::Result> refusal;
    Lines story;
  };
  const Case cases[] = {
      {true,
       std::nullopt,
       {kCleared, clearedLog("error=0 msg="), "pushing metric file", kAdded, addedLog("error=0 msg="), kListening,
        "Querying SIM files", kQueried, kQueriedLog}},
      {true,
       corvik::Result{-5, "modem is off"},
       {kCleared, clearedLog("error=-5 msg=modem is off"), "pushing metric file", kAdded,
        addedLog("error=-5 msg=modem is off")}},
      {false, std::nullopt, {kCleared, clearedLog("error=0 msg="), "Metric Log File path doesnt exist"}},
  };
  Resources resources;
  for (const Case& row : cases) {
    row.hasConfiguration ? resources.use() : Resources::useNone();
    ConnectedProgram program;
    program.service.refuseAll(row.refusal);
    Lines story;
    program.service.notes = &story;
    auto output = OutputLines::setSink(std::make_unique<Narrator>(story));
    auto log = SystemLog::setSink(std::make_unique<Narrator>(story));
    const int status = program.run([&](NavigationController& root) {
      EXPECT_EQ(&program.window().rootNavigationController(), &root);
      EXPECT_NE(dynamic_cast<RootNavigationController*>(&root), nullptr);
      ASSERT_EQ(root.stack().size(), 1U);
      EXPECT_NE(dynamic_cast<VeskViewController*>(root.topViewController().get()), nullptr);
    });
    OutputLines::setSink(std::move(output));
    SystemLog::setSink(std::move(log));
    program.service.notes = nullptr;
    EXPECT_EQ(status, 0);
    EXPECT_EQ(story, row.story);
  }
}

TEST(Bundle, FindsAResourceInTheFirstDirectoryThatHasIt) {
  const std::filesystem::path root = testing::TempDir() + "vesk_bundle_test";
  const std::filesystem::path first = root / "first";
  const std::filesystem::path second = root / "second";
  std::filesystem::create_directories(first / "folder.txt");
  std::filesystem::create_directories(second);
  for (const auto& path : {first / "both.txt", second / "both.txt", second / "one.txt"})
    std::ofstream(path) << "content";
  const Bundle bundle({first, second});
  EXPECT_EQ(bundle.pathForResource("both", "txt"), (first / "both.txt").string());
  EXPECT_EQ(bundle.pathForResource("one", "txt"), (second / "one.txt").string());
  EXPECT_EQ(bundle.pathForResource("folder", "txt"), std::nullopt);
  std::filesystem::remove_all(root);
}

TEST(AppIDValidator, AcceptsOnlyTheIntegerTwo) {
  AppIDValidator validator;
  EXPECT_TRUE(validator.isForThisApplication({{"kKeyAppID"_text, 2}}));
  EXPECT_FALSE(validator.isForThisApplication({{"kKeyAppID"_text, 3}}));
  EXPECT_EQ(validator.appID(), 3);
  EXPECT_FALSE(validator.isForThisApplication({{"kKeyAppID"_text, "2"_text}}));
  EXPECT_EQ(validator.appID(), std::nullopt);
}

}  // namespace
}  // namespace vesk
