#include "handset/handset.h"

#include <gtest/gtest.h>
#include <map>
#include <set>
#include <string>

#include "handset/driven_events.h"
#include "handset/recording.h"

namespace vesk::handset {
namespace {

std::string recordingOf(std::uint64_t seed, std::uint64_t startMs, double seconds) {
  Handset handset(seed, startMs);
  std::string lines;
  recordDrive(handset, seconds, [&lines](std::string_view line) {
    lines += line;
    return true;
  });
  return lines;
}

TEST(HandsetTest, TheSeedAndTheStartMakeTheDrive) {
  const std::string drive = recordingOf(7, kStartMs, 120);
  EXPECT_EQ(recordingOf(7, kStartMs, 120), drive);
  EXPECT_NE(recordingOf(8, kStartMs, 120), drive);
  EXPECT_NE(recordingOf(7, kStartMs + 1, 120), drive);
}

TEST(HandsetTest, TellsEveryKindWithinTheFirstMinute) {
  std::set<std::int64_t> expected{K_LTE_RLF};
  for (std::int64_t id = 0x3C0000; id <= 0x3CFFFF; ++id) {
    if (findMetricClass(id) != nullptr) expected.insert(id);
  }
  for (std::uint64_t seed = 0; seed < 10; ++seed) {
    std::set<std::int64_t> told;
    // These two come now and then, and when asked for.
    told.insert({K_LTE_RLF, kMetricId<metrics::KCellularSimCardFiles>});
    std::size_t triggers = 0;
    for (const HandsetEvent& event : drivenEvents(seed, 60)) {
      if (event.kind == HandsetEvent::Kind::metric) {
        told.insert(event.id);
      } else {
        ++triggers;
      }
    }
    EXPECT_EQ(told, expected) << "seed " << seed;
    EXPECT_GT(triggers, 0U) << "seed " << seed;
  }
}

TEST(HandsetTest, EveryMetricIsReadBackWithItsClassAndStampedWithItsTime) {
  std::int64_t lastMs = 0;
  bool hasFailed = false;
  for (const HandsetEvent& event : drivenEvents(3, 1200)) {
    ASSERT_GE(event.atMs, lastMs);
    lastMs = event.atMs;
    hasFailed |= event.id == K_LTE_RLF;
    if (findMetricClass(event.id) == nullptr) continue;
    const auto fields = fieldsOf(event);
    ASSERT_TRUE(fields) << event.id;
    ASSERT_EQ(fields->find("timestamp")->integer(), static_cast<std::int64_t>(kStartMs) + event.atMs) << event.id;
  }
  EXPECT_TRUE(hasFailed);
}

TEST(HandsetTest, GoesDownThroughTheTechnologiesAndComesBack) {
  const std::map<std::int64_t, std::string> technologies = {
      {kMetricId<metrics::KCellularLteScellInfo>, "LTE"},
      {kMetricId<metrics::KCellularWcdmaCellInfo>, "UMTS"},
      {kMetricId<metrics::KCellularGsmScellInfo>, "GSM"},
  };
  for (std::uint64_t seed = 0; seed < 10; ++seed) {
    std::vector<std::string> visited;
    for (const HandsetEvent& event : drivenEvents(seed, 100)) {
      const auto found = technologies.find(event.id);
      if (found == technologies.end()) continue;
      if (visited.empty() || visited.back() != found->second) visited.push_back(found->second);
    }
    EXPECT_EQ(visited, (std::vector<std::string>{"LTE", "UMTS", "GSM", "UMTS", "LTE"})) << "seed " << seed;
  }
}

TEST(HandsetTest, ARecordingHoldsTheSimFilesOnceAndNoTriggers) {
  const std::string lines = recordingOf(1, kStartMs, 60);
  const std::size_t found = lines.find("\"0x3C0013\"");
  ASSERT_NE(found, std::string::npos);
  EXPECT_LT(found, lines.size() / 10);
  EXPECT_EQ(lines.find("\"0x3C0013\"", found + 1), std::string::npos);
  EXPECT_EQ(lines.find("\"0x7F"), std::string::npos);
}

}  // namespace
}  // namespace vesk::handset
