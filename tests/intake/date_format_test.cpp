#include "intake/date_format.h"

#include <cstdlib>
#include <gtest/gtest.h>
#include <limits>
#include <string>

namespace vesk {
namespace {

/// The process's time zone while it lives.
class Zone {
 public:
  explicit Zone(const char* zone) : previous_(std::getenv("TZ") == nullptr ? "" : std::getenv("TZ")) {
    setenv("TZ", zone, 1);
  }
  ~Zone() {
    if (previous_.empty()) {
      unsetenv("TZ");
    } else {
      setenv("TZ", previous_.c_str(), 1);
    }
    tzset();
  }
  Zone(const Zone&) = delete;
  Zone& operator=(const Zone&) = delete;

 private:
  std::string previous_;
};

std::string written(DateFormat& format, double milliseconds) {
  std::string text;
  format.append(text, milliseconds);
  return text;
}

TEST(DateFormat, WritesInstantsInTheProcessesZone) {
  constexpr double kHour = 3'600'000;
  constexpr double kSummer2023 = 1'679'792'400'000;  // 2023-03-26 01:00 UTC
  struct Case {
    const char* zone;
    double milliseconds;
    const char* text;
  };
  const char* paris = "CET-1CEST,M3.5.0,M10.5.0/3";
  const Case cases[] = {
      {"UTC0", 0, "1970-01-01 00:00:00 UTC"},
      {"UTC0", 1500, "1970-01-01 00:00:01 UTC"},
      {"UTC0", 1999.9999, "1970-01-01 00:00:01 UTC"},
      {"UTC0", -1, "1969-12-31 23:59:59 UTC"},
      {"UTC0", -1000, "1969-12-31 23:59:59 UTC"},
      {"UTC0", -0.5, "1969-12-31 23:59:59 UTC"},
      {"UTC0", 1'700'000'000'999, "2023-11-14 22:13:20 UTC"},
      {"UTC0", -62'135'596'800'001, "0001-12-31 23:59:59 UTC"},
      {"UTC0", 18446744073709551615.0, "584556019-04-03 14:25:52 UTC"},
      {paris, kSummer2023 - 1, "2023-03-26 01:59:59 CET"},
      {paris, kSummer2023, "2023-03-26 03:00:00 CEST"},
      {paris, kSummer2023 + kHour, "2023-03-26 04:00:00 CEST"},
      {"<+05>-5", 0, "1970-01-01 05:00:00 GMT+5"},
      {"<+0545>-5:45", 0, "1970-01-01 05:45:00 GMT+5:45"},
      {"<-0330>3:30", 0, "1969-12-31 20:30:00 GMT-3:30"},
      {"<+00>0", 0, "1970-01-01 00:00:00 GMT"},
      {"UTC0", std::numeric_limits<double>::quiet_NaN(), "no date"},
      {"UTC0", std::numeric_limits<double>::infinity(), "no date"},
      {"UTC0", -std::numeric_limits<double>::max(), "no date"},
      {"UTC0", 9e19, "no date"},
  };
  for (const Case& row : cases) {
    const Zone zone(row.zone);
    DateFormat format;
    EXPECT_EQ(written(format, row.milliseconds), row.text) << row.zone << ' ' << row.milliseconds;
  }
}

TEST(DateFormat, RemembersADayButNeverAcrossAChangeOfTheClocks) {
  // Clocks go forward at 01:00:30, in the middle of a minute.
  const Zone zone("AAA0BBB,M3.5.0/1:00:30,M10.5.0");
  constexpr double kHour = 3'600'000;
  constexpr double kMinute = 1'679'792'400'000;  // 2023-03-26 01:00 UTC
  DateFormat format;
  EXPECT_EQ(written(format, kMinute + 29'000), "2023-03-26 01:00:29 AAA");
  EXPECT_EQ(written(format, kMinute + 30'000), "2023-03-26 02:00:30 BBB");
  EXPECT_EQ(written(format, kMinute + 59'000), "2023-03-26 02:00:59 BBB");
  EXPECT_EQ(written(format, kMinute + 45'000), "2023-03-26 02:00:45 BBB");
  EXPECT_EQ(written(format, kMinute + 60'000), "2023-03-26 02:01:00 BBB");
  EXPECT_EQ(written(format, kMinute - 1), "2023-03-26 00:59:59 AAA");
  EXPECT_EQ(written(format, kMinute + 22 * kHour - 1), "2023-03-26 23:59:59 BBB");
  EXPECT_EQ(written(format, kMinute + 22 * kHour), "2023-03-27 00:00:00 BBB");
  EXPECT_EQ(written(format, kMinute + 46 * kHour), "2023-03-28 00:00:00 BBB");
  EXPECT_EQ(written(format, kMinute - 1), "2023-03-26 00:59:59 AAA");
  EXPECT_EQ(written(format, std::numeric_limits<double>::quiet_NaN()), "no date");
  EXPECT_EQ(written(format, kMinute), "2023-03-26 01:00:00 AAA");
  // And back, from 02:00 to 01:00: 25 hours, two of them of one name.
  constexpr double kAutumn = 1'698'537'600'000;  // 2023-10-29 00:00 UTC, 01:00 in the zone
  EXPECT_EQ(written(format, kAutumn), "2023-10-29 01:00:00 BBB");
  EXPECT_EQ(written(format, kAutumn + kHour - 1), "2023-10-29 01:59:59 BBB");
  EXPECT_EQ(written(format, kAutumn + kHour), "2023-10-29 01:00:00 AAA");
  EXPECT_EQ(written(format, kAutumn + 24 * kHour - 1), "2023-10-29 23:59:59 AAA");
  EXPECT_EQ(written(format, kAutumn - kHour - 1), "2023-10-28 23:59:59 BBB");
}

TEST(DateFormat, WritesALeapSecondAsTheSixtiethOfItsMinute) {
  const Zone zone("right/Europe/Berlin");
  // The last of 2016, in whose count of seconds there were 26 before it.
  constexpr double kLeapSecond = (1'483'228'800.0 + 26) * 1000;
  DateFormat format;
  if (written(format, kLeapSecond) == "2017-01-01 01:00:26 CET") GTEST_SKIP() << "a zone that knows none";
  EXPECT_EQ(written(format, kLeapSecond - 1000), "2017-01-01 00:59:59 CET");
  EXPECT_EQ(written(format, kLeapSecond), "2017-01-01 00:59:60 CET");
  EXPECT_EQ(written(format, kLeapSecond + 1000), "2017-01-01 01:00:00 CET");
  EXPECT_EQ(written(format, kLeapSecond + 3'601'000), "2017-01-01 02:00:00 CET");
}

}  // namespace
}  // namespace vesk
