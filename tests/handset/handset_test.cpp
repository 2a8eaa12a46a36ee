#include "handset/handset.h"

#include <gtest/gtest.h>
#include <map>
#include <set>
#include <string>

#include "handset/driven_events.h"

namespace vesk::handset {
namespace {

TEST(HandsetTest, TellsEveryKindWithinTheFirstMinute) {
  std::set<std::int64_t> expected{K_LTE_RLF};
  for (std::int64_t id = 0x3C0000; id <= 0x3CFFFF; ++id) {
    if (findMetricClass(id) != nullptr) expected.insert(id);
  }
  for (std::uint64_t seed = 0; seed < 3; ++seed) {
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

}  // namespace
}  // namespace vesk::handset
