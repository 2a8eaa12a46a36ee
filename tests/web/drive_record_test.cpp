#include "web/drive_record.h"

#include <gtest/gtest.h>

#include "insight/drive.h"
#include "web/drive_json.h"
#include "web/prometheus_text.h"

namespace vesk::web {
namespace {

using namespace insight;
using enum LteRrcState;
using enum LteRrcCause;

/// A drive and the record of it.
class RecordedDrive {
 public:
  explicit RecordedDrive(const std::vector<DriveEvent>& events, const RecordLimits& limits = kWholeDrive)
      : record(limits) {
    drive.insight.setStepHandler(
        [this](const insight::Report& report, const Step& step) { record.take(drive.insight, report, step); });
    drive.play(events);
  }

  [[nodiscard]] std::string json() const {
    std::string out;
    appendDriveJson(out, record, drive.insight);
    return out;
  }

  Drive drive;
  DriveRecord record;
};

std::vector<DriveEvent> levels(std::int64_t count) {
  std::vector<DriveEvent> events{lteCell(0, 5815, 338)};
  for (std::int64_t at = 0; at < count; ++at)
    events.push_back(lteLevel(at * 100, at == count / 2 ? -140 : -90 - static_cast<int>(at % 7), -10));
  return events;
}

TEST(DriveRecord, KeepsEveryExtremeInABoundedNumberOfPoints) {
  const RecordedDrive drive(levels(5000), {.points = 64, .changes = 64, .eventsOfKind = 100, .whole = 2000});
  const auto course = drive.record.course(Kpi::lteRsrp);
  EXPECT_LE(course.size(), 64U + 20U);
  EXPECT_GT(course.size(), 16U + 20U);
  EXPECT_EQ(course[course.size() - 20].position, 498'000) << "the latest stay as they are";
  double least = 0;
  std::int64_t leastAt = 0;
  for (std::size_t at = 0; at < course.size(); ++at) {
    EXPECT_TRUE(at == 0 || course[at - 1].position < course[at].position);
    if (course[at].least < least) leastAt = course[at].leastAt;
    least = std::min(least, course[at].least);
  }
  EXPECT_EQ(least, -140);
  EXPECT_EQ(leastAt, 250'000);
}

TEST(DriveRecord, KeepsTheLastEventsOfEachKindInTheirOrder) {
  std::vector<DriveEvent> events{lteRrc(0, KLTE_RRC_STATE_IDLE)};
  for (std::uint32_t at = 1; at <= 40; ++at)
    events.push_back(lteCell(std::int64_t{at} * 1000, 5815, at));
  const RecordedDrive drive(events, {.points = 4096, .changes = 64, .eventsOfKind = 10});
  std::string kinds;
  for (const DriveRecord::Event* each : drive.record.events())
    kinds += std::string(nameOf(each->event.kind)) + " ";
  std::string expected = "rrc technology cell ";
  for (int count = 0; count < 10; ++count)
    expected += "reselection ";
  EXPECT_EQ(kinds, expected);
}

TEST(DriveRecord, RunsOverCountedTimeAndMarksWhatHappened) {
  const RecordedDrive drive({lteCell(0, 850, 443), lteRrc(0, KLTE_RRC_STATE_CONNECTED), lteLevel(500, -125, -20),
                             lteRrc(1000, KLTE_RRC_STATE_ATMPT_CONNECTION, KLTE_RRC_CAUSE_REEST_OTHER_FAIL),
                             lteCell(1100, 5815, 271), lteRrc(1200, KLTE_RRC_STATE_CONNECTED),
                             lteRrc(1300, KLTE_RRC_STATE_IDLE, KLTE_RRC_CAUSE_REL_T310_EXP),
                             lteCell(100'000'000, 850, 7)});
  const std::string json = drive.json();
  for (const char* part :
       {R"("stretches":[0,1516485160000,1300,1516585160000],"time_error":0)",
        R"("series":{"lte.rsrp":[500,-125],"lte.rsrq":[500,-20]})",
        R"("cells":["PCI 443 B2 850","PCI 271 B17 5815","PCI 7 B2 850"],"serving":[0,0,1100,1,1300,2])",
        R"("marks":{"change":[1100],"reestablished":[1200],"drop":[1300],"technology":[0,1300]})",
        R"([1300,1516585160000,"gap","1 d 3 h later"])"})
    EXPECT_NE(json.find(part), std::string::npos) << part << " is not in\n" << json;
}

TEST(DriveRecord, KeepsTimesRightInABoundedNumberOfStretches) {
  std::vector<DriveEvent> events;
  events.reserve(3000);
  std::int64_t time = 0;
  for (int at = 0; at < 3000; ++at)
    events.push_back(lteLevel(time += at % 3 == 0 ? 70'000 + at * 10 : 1000, -90, -10));
  const RecordedDrive whole(events);
  EXPECT_EQ(whole.record.stretches().begins().size(), 1000U);
  EXPECT_EQ(whole.record.stretches().error(), 0);
  const RecordedDrive drive(events, {.points = 4096, .changes = 64, .eventsOfKind = 100, .stretches = 64});
  const auto& kept = drive.record.stretches().begins();
  EXPECT_LE(kept.size(), 64U);
  EXPECT_GT(kept.size(), 16U);
  const std::int64_t error = drive.record.stretches().error();
  EXPECT_LT(error, time / 16);
  std::size_t at = 0;
  std::int64_t before = 0;
  for (const StretchBegin& each : whole.record.stretches().begins()) {
    while (at + 1 < kept.size() && kept[at + 1].position <= each.position)
      ++at;
    const std::int64_t told = each.position + kept[at].shift();
    EXPECT_LE(std::abs(told - each.time), error) << each.position;
    EXPECT_GE(told, std::exchange(before, told));
  }
}

TEST(DriveRecord, TellsNewsAloneAfterItWasCleared) {
  RecordedDrive drive({lteCell(0, 850, 443), lteLevel(500, -125, -20)});
  drive.record.clear();
  EXPECT_TRUE(drive.record.isEmpty());
  drive.drive.play({lteLevel(900, -100, -10), lteCell(1000, 5815, 271)});
  EXPECT_FALSE(drive.record.isEmpty());
  std::string json;
  appendNewsJson(json, drive.record, drive.drive.insight);
  for (const char* part :
       {R"({"stretches":[],"time_error":0,"series":{"lte.rsrp":[900,-100],"lte.rsrq":[900,-10]})",
        R"("cells":["PCI 271 B17 5815"],"serving":[1000,1],"serving_width":1)", R"("events":[[1000,)"})
    EXPECT_NE(json.find(part), std::string::npos) << part << " is not in\n" << json;
  EXPECT_NE(drive.json().find(R"({"kpis":[{"name":"lte.rsrp")"), std::string::npos);
}

TEST(PrometheusText, TellsKnownKpisWithTheirCellAndCountsWhatHappened) {
  const RecordedDrive drive({lteCell(0, 850, 443, 49929738), lteRrc(0, KLTE_RRC_STATE_CONNECTED),
                             lteLevel(500, -125, -20), lteRrc(1300, KLTE_RRC_STATE_IDLE, KLTE_RRC_CAUSE_REL_T310_EXP)});
  const std::string text = prometheusText(drive.drive.insight, std::chrono::milliseconds(1500), 3);
  for (const char* line :
       {R"(# TYPE vesk_lte_rsrp_dbm gauge
vesk_lte_rsrp_dbm{technology="LTE",channel="850",code="443",cell_id="49929738"} -125
)",
        "\nvesk_metric_events_total{fate=\"stored\"} 4\n", "\nvesk_timeline_events_total{kind=\"drop\"} 1\n",
        "\nvesk_connections_dropped_total{technology=\"LTE\"} 1\n",
        "\nvesk_connections_dropped_total{technology=\"UMTS\"} 0\n",
        "\nvesk_connections_dropped_by_cause_total{technology=\"LTE\",cause=\"REL_T310_EXP\"} 1\n",
        "\nvesk_quiet_seconds 1.5\n", "\nvesk_counted_seconds_total{technology=\"LTE\"} 1.3\n", "\nvesk_visitors 3\n"})
    EXPECT_NE(text.find(line), std::string::npos) << line << " is not in\n" << text;
  EXPECT_EQ(text.find("umts_rscp"), std::string::npos) << "what is unknown has no sample";
  const std::string quiet = prometheusText(drive.drive.insight, std::chrono::milliseconds(30'001), 3);
  EXPECT_EQ(quiet.find("lte_rsrp"), std::string::npos) << "what was said long ago has no sample";
  EXPECT_NE(quiet.find("\nvesk_quiet_seconds 30"), std::string::npos);
}

}  // namespace
}  // namespace vesk::web
