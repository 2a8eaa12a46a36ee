#include "insight/rules.h"

#include <gtest/gtest.h>

#include "insight/drive.h"

namespace vesk::insight {
namespace {

TEST(Rules, AreRefusedWithThePlaceAndWhatWasExpected) {
  const std::string subjects =
      "event, or one of lte.rsrp, lte.rsrq, lte.sinr, lte.tx_power.pusch, lte.tx_power.pucch, lte.scc.rsrp, "
      "lte.nbr.rsrp, umts.rscp, umts.ecno, umts.rssi, umts.tx_power, gsm.rxlev, gsm.rxqual, gsm.tx_power";
  const std::string kinds = "a kind of event, such as handover or no-service";
  struct Case {
    const char* rule;
    std::size_t column;
    std::string expected;
    const char* got;
  };
  for (const auto& [rule, column, expected, got] : std::vector<Case>{
           {"", 1, subjects, "nothing"},
           {"  lte.rsr < 3", 3, subjects, "lte.rsr"},
           {"lte.rsrp", 9, "<, <=, >, >=, == or !=", "nothing"},
           {"lte.rsrp = -110", 10, "<, <=, >, >=, == or !=", "="},
           {"lte.rsrp <> -110", 11, "a number", ">"},
           {"lte.rsrp < 1e3", 13, "for, or the end", "e3"},
           {"lte.rsrp < .5", 12, "a number", ".5"},
           {"lte.rsrp < 5.", 12, "a number", "5."},
           {"lte.rsrp < - 5", 12, "a number", "-"},
           {"lte.rsrp < -110for 10 s", 16, "for, or the end", "for"},
           {"lte.rsrp < -110 for10 s", 17, "for, or the end", "for10"},
           {"lte.rsrp < -110 for s", 21, "a number", "s"},
           {"lte.rsrp < -110 for 10", 23, "ms, s or min", "nothing"},
           {"lte.rsrp < -110 for 10 h", 24, "ms, s or min", "h"},
           {"lte.rsrp < -110 for 10 s now", 26, "for, or the end", "now"},
           {"event", 6, kinds, "nothing"},
           {"event alert", 7, kinds, "alert"},
           {"event drop, service", 11, "the end", ","},
       }) {
    const auto parsed = parseRule(rule);
    const auto* error = std::get_if<RuleError>(&parsed);
    ASSERT_NE(error, nullptr) << rule;
    EXPECT_EQ(error->column, column) << rule;
    EXPECT_EQ(error->reason, "expected " + expected + ", got " + got) << rule;
  }
}

std::string alertsOf(const char* rule, const std::vector<DriveEvent>& events) {
  const Drive drive(events, {std::get<Rule>(parseRule(rule))});
  std::string out;
  for (const TimelineEvent& each : drive.timeline)
    if (each.kind == EventKind::alert) out += std::to_string(each.moment.time - kStart) + " " + textOf(each) + "\n";
  return out;
}

TEST(Rules, FireOnceWhileTheyHold) {
  const std::vector<DriveEvent> levels{
      lteLevel(0, -111),      lteLevel(10'000, -112),  lteLevel(10'001, -113), lteLevel(11'000, -110),
      lteLevel(12'000, -111), lteLevel(22'000, -115),  bearers(52'000, {5}),   bearers(52'001, {}),
      lteLevel(53'000, -120), lteLevel(200'000, -111),
  };
  struct Case {
    const char* rule;
    const char* alerts;
  };
  for (const auto& [rule, alerts] : std::vector<Case>{
           {"lte.rsrp < -110 for 10s",
            "10000 lte.rsrp < -110 for 10s: -112 since 10.0 s\n22000 lte.rsrp < -110 for 10s: -115 since 10.0 s\n"},
           // At 52001 the value is no longer known.
           {"lte.rsrp<=-115 \t for 0.5 min", "52000 lte.rsrp<=-115 \t for 0.5 min: -115 since 30.0 s\n"},
           // A gap starts anew.
           {"lte.rsrp!=-110 for 147000 ms", ""},
           {"lte.rsrp == +40.0", ""},
           {"lte.rsrp >= -110", "11000 lte.rsrp >= -110: -110 since 0 ms\n"},
           {"event bearer-up", "52000 event bearer-up\n"},
           {"event gap", "200000 event gap\n"},
       })
    EXPECT_EQ(alertsOf(rule, levels), alerts) << rule;
}

}  // namespace
}  // namespace vesk::insight
