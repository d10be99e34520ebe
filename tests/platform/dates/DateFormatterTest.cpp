// Dates in the device's time zone.
#include <array>
#include <cstdlib>
#include <cstring>
#include <ctime>
#include <limits>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "platform/dates/DateFormatter.h"

namespace vespscope::test {
namespace {

using dates::DateFormatter;

std::string formatted(const char* zone, double seconds, const char* pattern = "yyyy-MM-dd HH:mm:ss zzz") {
  ::setenv("TZ", zone, 1);
  return DateFormatter(pattern).stringFromSeconds(seconds);
}

TEST(DateFormatter, ShowsTheEpochInTheZoneOfTheDevice) {
  EXPECT_EQ(formatted("UTC", 0), "1970-01-01 00:00:00 UTC");
  EXPECT_EQ(formatted("America/New_York", 0), "1969-12-31 19:00:00 EST");
  EXPECT_EQ(formatted("Asia/Kolkata", 0), "1970-01-01 05:30:00 IST");
}

TEST(DateFormatter, GivesSummerTimeItsOwnAbbreviation) {
  EXPECT_EQ(formatted("Europe/Berlin", 1700000000), "2023-11-14 23:13:20 CET");
  EXPECT_EQ(formatted("Europe/Berlin", 1690000000), "2023-07-22 06:26:40 CEST");
}

TEST(DateFormatter, FollowsAZoneThatChangesWhileRunning) {
  const DateFormatter formatter("HH zzz");
  ::setenv("TZ", "UTC", 1);
  EXPECT_EQ(formatter.stringFromSeconds(0), "00 UTC");
  ::setenv("TZ", "Asia/Tokyo", 1);
  EXPECT_EQ(formatter.stringFromSeconds(0), "09 JST");
}

// The same, by the C library only.
std::string byTheLibrary(std::time_t instant) {
  std::tm moment{};
  ::localtime_r(&instant, &moment);
  std::array<char, 64> text{};
  std::strftime(text.data(), text.size(), "%Y-%m-%d %H:%M:%S %Z", &moment);
  return text.data();
}

TEST(DateFormatter, FollowsTheZoneAlsoWhereItsOffsetChanges) {
  // Offsets with half hours, quarters and odd seconds, summer time of half an hour, leap seconds.
  for (const char* zone : {"UTC", "Europe/Berlin", "America/New_York", "Asia/Kolkata", "Asia/Kathmandu",
                           "Australia/Lord_Howe", "Africa/Monrovia", "Europe/Amsterdam", "right/Europe/Berlin"}) {
    ::setenv("TZ", zone, 1);
    ::tzset();
    const DateFormatter formatter("yyyy-MM-dd HH:mm:ss zzz");
    // Around changes of the offset, a leap second, Monrovia's new time and a year of local mean time.
    for (const std::time_t middle : {1698541200L, 1699167600L, 1680364800L, 1483228800L, 63593070L, -1500000000L, 0L}) {
      for (std::time_t offset = -7200; offset <= 7200; offset += 7) {
        ASSERT_EQ(formatter.stringFromSeconds(static_cast<double>(middle + offset)), byTheLibrary(middle + offset))
            << zone;
        ASSERT_EQ(formatter.stringFromSeconds(static_cast<double>(middle - offset)), byTheLibrary(middle - offset))
            << zone;
      }
    }
  }
}

TEST(DateFormatter, CutsFractionsAlsoBeforeTheEpoch) {
  EXPECT_EQ(formatted("UTC", 0.9996, "ss.SSS"), "00.999");
  EXPECT_EQ(formatted("UTC", -0.25, "yyyy HH:mm:ss.SS"), "1969 23:59:59.75");
  EXPECT_EQ(formatted("UTC", 1.5), "1970-01-01 00:00:01 UTC");
}

TEST(DateFormatter, CopiesQuotedTextAndShortFields) {
  EXPECT_EQ(formatted("UTC", 0, "d.M.yy 'at' H 'o''clock' ''"), "1.1.70 at 0 o'clock '");
}

TEST(DateFormatter, WritesDatesAsLongAsTheirPattern) {
  EXPECT_EQ(formatted("UTC", 0, "yyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyy"),
            std::string(56, '0') + "1970");
  for (std::size_t length = 40; length < 160; ++length) {
    const std::string quoted(length, 'x');
    EXPECT_EQ(formatted("UTC", 0, ("'" + quoted + "' HH").c_str()), quoted + " 00");
  }
}

TEST(DateFormatter, WritesAYearBeyondFourDigitsWhole) {
  EXPECT_EQ(formatted("UTC", 253402300800), "10000-01-01 00:00:00 UTC");
  EXPECT_EQ(formatted("UTC", 18446744073709552.0), "584556019-04-03 14:25:52 UTC");
}

TEST(DateFormatter, WritesAnInstantBeyondTheCalendarAsSeconds) {
  EXPECT_EQ(formatted("UTC", 1e19), "1e+19");
  EXPECT_EQ(formatted("UTC", -1e300), "-1e+300");
  EXPECT_EQ(formatted("UTC", 8e18), "8e+18");
  EXPECT_EQ(formatted("UTC", std::numeric_limits<double>::infinity()), "inf");
  EXPECT_EQ(formatted("UTC", std::numeric_limits<double>::quiet_NaN()), "nan");
}

TEST(DateFormatter, TakesAnUnknownPatternLetterAsAProgrammingError) {
  EXPECT_DEATH(formatted("UTC", 0, "Q"), "fatal: a date pattern has the unknown letter Q");
}

TEST(DateFormatter, ServesManyThreadsAtOnce) {
  ::setenv("TZ", "Europe/Berlin", 1);
  std::vector<std::thread> threads;
  std::vector<int> wrong(4, 0);
  for (int& mistakes : wrong) {
    threads.emplace_back([&mistakes] {
      for (int round = 0; round < 500; ++round) {
        const DateFormatter formatter("yyyy-MM-dd HH:mm:ss zzz");
        if (formatter.stringFromSeconds(1700000000) != "2023-11-14 23:13:20 CET") ++mistakes;
        if (formatter.stringFromSeconds(1690000000) != "2023-07-22 06:26:40 CEST") ++mistakes;
      }
    });
  }
  for (std::thread& thread : threads) thread.join();
  EXPECT_EQ(wrong, std::vector<int>(4, 0));
}

}  // namespace
}  // namespace vespscope::test
