#include "intake/date_format.h"

#include <cstdlib>
#include <gtest/gtest.h>
#include <limits>
#include <string>

namespace vesk {
namespace {

/// The time zone of the process while it lives.
class Zone {
 public:
  explicit Zone(const char* zone) { setenv("TZ", zone, 1); }
  ~Zone() {
    unsetenv("TZ");
    tzset();
  }
  Zone(const Zone&) = delete;
  Zone& operator=(const Zone&) = delete;
};

constexpr double kHour = 3'600'000;
constexpr double kSummer = 1'679'792'400'000;  // 2023-03-26 01:00 UTC

TEST(DateFormat, WritesInstantsInTheZoneOfTheProcess) {
  struct Case {
    const char* zone;
    double milliseconds;
    const char* text;
  };
  const char* paris = "CET-1CEST,M3.5.0,M10.5.0/3";
  const Case cases[] = {
      {"UTC0", 1999.9999, "1970-01-01 00:00:01 UTC"},
      {"UTC0", -0.5, "1969-12-31 23:59:59 UTC"},
      {"UTC0", -1000, "1969-12-31 23:59:59 UTC"},
      {"UTC0", -62'135'596'800'001, "0001-12-31 23:59:59 UTC"},
      {"UTC0", 18446744073709551615.0, "584556019-04-03 14:25:52 UTC"},
      {paris, kSummer - 1, "2023-03-26 01:59:59 CET"},
      {paris, kSummer, "2023-03-26 03:00:00 CEST"},
      {"<+0545>-5:45", 0, "1970-01-01 05:45:00 GMT+5:45"},
      {"<-0330>3:30", 0, "1969-12-31 20:30:00 GMT-3:30"},
      {"<+00>0", 0, "1970-01-01 00:00:00 GMT"},
      {"UTC0", std::numeric_limits<double>::quiet_NaN(), "no date"},
      {"UTC0", -std::numeric_limits<double>::max(), "no date"},
      {"UTC0", 9e19, "no date"},
  };
  for (const Case& row : cases) {
    const Zone zone(row.zone);
    DateFormat format;
    EXPECT_EQ(format.write(row.milliseconds), row.text) << row.zone << ' ' << row.milliseconds;
  }
}

TEST(DateFormat, RemembersAQuarterOfAnHourButNeverAcrossAChangeOfTheClocks) {
  // Clocks go forward at 01:00:30, in the middle of a minute, and back at 02:00.
  const Zone zone("AAA0BBB,M3.5.0/1:00:30,M10.5.0");
  constexpr double kAutumn = 1'698'537'600'000;  // 2023-10-29 00:00 UTC, 01:00 in the zone
  DateFormat format;
  EXPECT_EQ(format.write(kSummer + 29'000), "2023-03-26 01:00:29 AAA");
  EXPECT_EQ(format.write(kSummer + 30'000), "2023-03-26 02:00:30 BBB");
  EXPECT_EQ(format.write(kSummer + 45'000), "2023-03-26 02:00:45 BBB");
  EXPECT_EQ(format.write(kSummer - 1), "2023-03-26 00:59:59 AAA");
  EXPECT_EQ(format.write(std::numeric_limits<double>::quiet_NaN()), "no date");
  EXPECT_EQ(format.write(kSummer - 900'000), "2023-03-26 00:45:00 AAA");
  EXPECT_EQ(format.write(kSummer - 900'001), "2023-03-26 00:44:59 AAA");
  EXPECT_EQ(format.write(kSummer + 22 * kHour), "2023-03-27 00:00:00 BBB");
  EXPECT_EQ(format.write(kSummer + 22 * kHour + 754'000), "2023-03-27 00:12:34 BBB");
  EXPECT_EQ(format.write(kAutumn + kHour - 1), "2023-10-29 01:59:59 BBB");
  EXPECT_EQ(format.write(kAutumn + kHour), "2023-10-29 01:00:00 AAA");
}

}  // namespace
}  // namespace vesk
