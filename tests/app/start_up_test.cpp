#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>

#include "app/app_id_validator.h"
#include "app/bundle.h"
#include "app/connected_program.h"
#include "app/root_navigation_controller.h"
#include "messages/nas/nas.h"
#include "screens/vesk_view_controller.h"
#include "support/metric_events.h"
#include "support/recorded_output.h"

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

TEST(StartUp, TheIntakeListensWhenItIsMadeAndIsTheDelegateEverAfter) {
  const ConnectedProgram program;
  EXPECT_EQ(program.linesOfMaking, Lines{kListening});
  EXPECT_EQ(CorvikWrapper::sharedInstance()->delegate(), program.intake);
  EXPECT_EQ(program.intake->sharedCorvikInstance(), CorvikWrapper::sharedInstance());
}

TEST(StartUp, WithoutAConfigurationTheStoresStillTakeWhatTheServiceDelivers) {
  const Resources resources;
  Resources::useNone();
  ConnectedProgram program;
  const RecordedOutput output;
  metrics::KCellularSimCardFiles files;
  const auto file = std::make_shared<metrics::ElementaryFile>();
  file->setEfId(0x6F07);
  files.addEfList(file);
  program.run([&](NavigationController&) {
    program.raise(K_SIM_FILE_INFO, encoded(files).bytes());
    program.deliverAll();
  });
  EXPECT_EQ(output.lines(),
            (Lines{"Metric Log File path doesnt exist", "Metric ID in Hex =  3C0013",
                   "Received SIM Card File Info is  {ef_list: [{ef_id: 28423}]}", "Received Valid Metric"}));
  ASSERT_EQ(program.intake->stores.myCommon.simContents.size(), 1U);
}

/// Runs in a process of its own: elsewhere the link is connected for good.
TEST(StartUpDeathTest, WithoutAServiceTheProgramRunsOn) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  const auto start = [] {
    OutputLines::setSink(std::make_unique<DescriptorSink>(STDERR_FILENO, "standard error"));
    SystemLog::setSink(makeStandardErrorSink());
    const SteadyClock clock;
    RunLoop loop(clock);
    AppDelegate delegate;
    const int status = Application(veskInterface(), delegate).run([&](NavigationController&) { loop.runDue(); });
    OutputLines::flush();
    std::_Exit(status);
  };
  EXPECT_EXIT(start(), testing::ExitedWithCode(0), "andProtofFilePath:\\]: error=1 msg=no service for the client vesk");
}

TEST(AppIDValidator, AcceptsOnlyTheIntegerTwo) {
  struct Case {
    Dictionary event;
    bool isForThisApplication;
    std::optional<std::int64_t> appID;
  };
  const Case cases[] = {
      {{{"kKeyAppID"_text, 2}}, true, 2},
      {{{"kKeyAppID"_text, 3}}, false, 3},
      {{{"kKeyAppID"_text, "2"_text}}, false, std::nullopt},
      {{{"kKeyAppID"_text, true}}, false, std::nullopt},
      {{{"kkeyappid"_text, 2}}, false, std::nullopt},
      {{}, false, std::nullopt},
  };
  AppIDValidator validator;
  for (const Case& row : cases) {
    EXPECT_EQ(validator.isForThisApplication(row.event), row.isForThisApplication) << textOf(row.event);
    EXPECT_EQ(validator.appID(), row.appID) << textOf(row.event);
  }
}

}  // namespace
}  // namespace vesk
