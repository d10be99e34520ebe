#include <array>
#include <cstdlib>
#include <cstring>
#include <ctime>
#include <filesystem>
#include <fstream>
#include <limits>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "platform/application/System.h"
#include "platform/application/Timer.h"

namespace vespscope::application {
namespace {

std::string formatted(const char* zone, double seconds, const char* pattern = "yyyy-MM-dd HH:mm:ss zzz") {
  ::setenv("TZ", zone, 1);
  return DateFormatter(pattern).stringFromSeconds(seconds);
}

TEST(Dates, TheEpochIsShownInTheZoneOfTheDevice) {
  EXPECT_EQ(formatted("UTC", 0), "1970-01-01 00:00:00 UTC");
  EXPECT_EQ(formatted("America/New_York", 0), "1969-12-31 19:00:00 EST");
  EXPECT_EQ(formatted("Asia/Kolkata", 0), "1970-01-01 05:30:00 IST");
}

TEST(Dates, SummerTimeHasItsOwnAbbreviation) {
  EXPECT_EQ(formatted("Europe/Berlin", 1700000000), "2023-11-14 23:13:20 CET");
  EXPECT_EQ(formatted("Europe/Berlin", 1690000000), "2023-07-22 06:26:40 CEST");
}

TEST(Dates, AZoneThatChangesWhileRunningIsFollowed) {
  const DateFormatter formatter("HH zzz");
  ::setenv("TZ", "UTC", 1);
  EXPECT_EQ(formatter.stringFromSeconds(0), "00 UTC");
  ::setenv("TZ", "Asia/Tokyo", 1);
  EXPECT_EQ(formatter.stringFromSeconds(0), "09 JST");
}

// The same by the library alone.
std::string byTheLibrary(std::time_t instant) {
  std::tm moment{};
  ::localtime_r(&instant, &moment);
  std::array<char, 64> text{};
  std::strftime(text.data(), text.size(), "%Y-%m-%d %H:%M:%S %Z", &moment);
  return text.data();
}

TEST(Dates, AreThoseOfTheZoneAtEachInstantAlsoWhereItsOffsetChanges) {
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

TEST(Dates, FractionsAreCutAlsoBeforeTheEpoch) {
  EXPECT_EQ(formatted("UTC", 0.9996, "ss.SSS"), "00.999");
  EXPECT_EQ(formatted("UTC", -0.25, "yyyy HH:mm:ss.SS"), "1969 23:59:59.75");
  EXPECT_EQ(formatted("UTC", 1.5), "1970-01-01 00:00:01 UTC");
}

TEST(Dates, QuotedTextAndShortFieldsAreCopied) {
  EXPECT_EQ(formatted("UTC", 0, "d.M.yy 'at' H 'o''clock' ''"), "1.1.70 at 0 o'clock '");
}

TEST(Dates, AreAsLongAsTheirPattern) {
  EXPECT_EQ(formatted("UTC", 0, "yyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyyy"),
            std::string(56, '0') + "1970");
  for (std::size_t length = 40; length < 160; ++length) {
    const std::string quoted(length, 'x');
    EXPECT_EQ(formatted("UTC", 0, ("'" + quoted + "' HH").c_str()), quoted + " 00");
  }
}

TEST(Dates, AYearBeyondFourDigitsIsWrittenWhole) {
  EXPECT_EQ(formatted("UTC", 253402300800), "10000-01-01 00:00:00 UTC");
  EXPECT_EQ(formatted("UTC", 18446744073709552.0), "584556019-04-03 14:25:52 UTC");
}

TEST(Dates, AnInstantBeyondTheCalendarGivesItsSeconds) {
  EXPECT_EQ(formatted("UTC", 1e19), "1e+19");
  EXPECT_EQ(formatted("UTC", -1e300), "-1e+300");
  EXPECT_EQ(formatted("UTC", 8e18), "8e+18");
  EXPECT_EQ(formatted("UTC", std::numeric_limits<double>::infinity()), "inf");
  EXPECT_EQ(formatted("UTC", std::numeric_limits<double>::quiet_NaN()), "nan");
}

TEST(Dates, AnUnknownPatternLetterIsAProgrammingError) {
  EXPECT_DEATH(formatted("UTC", 0, "Q"), "fatal: a date pattern has the unknown letter Q");
}

TEST(Dates, ManyThreadsFormatAtOnce) {
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

TEST(PlatformVersion, IsThirteenUnlessSetOtherwise) {
  EXPECT_TRUE(isPlatformAtLeast({13, 0, 0}));
  EXPECT_TRUE(isPlatformAtLeast({12, 9, 9}));
  EXPECT_FALSE(isPlatformAtLeast({13, 0, 1}));
  setPlatformVersion({12, 4, 1});
  EXPECT_FALSE(isPlatformAtLeast({13, 0, 0}));
  EXPECT_TRUE(isPlatformAtLeast({12, 4, 1}));
}

class BundleTest : public testing::Test {
 protected:
  void SetUp() override {
    std::string name = (std::filesystem::temp_directory_path() / "vespscope-bundle-XXXXXX").string();
    ASSERT_NE(::mkdtemp(name.data()), nullptr);
    folder_ = name;
  }
  void TearDown() override { std::filesystem::remove_all(folder_); }
  [[nodiscard]] std::filesystem::path make(const std::string& name) const {
    std::filesystem::create_directories((folder_ / name).parent_path());
    std::ofstream(folder_ / name) << "content";
    return folder_ / name;
  }
  std::filesystem::path folder_;
};

TEST_F(BundleTest, TheFirstFolderThatHasTheFileWins) {
  const auto first = make("one/both.type");
  const auto hidden = make("two/both.type");
  const auto second = make("two/only.type");
  const Bundle bundle({folder_ / "absent", folder_ / "one", folder_ / "two"});
  EXPECT_EQ(bundle.pathForResource("both", "type"), first);
  EXPECT_EQ(bundle.pathForResource("only", "type"), second);
}

TEST_F(BundleTest, AnAbsentFileAndAFolderAreNoResources) {
  std::filesystem::create_directories(folder_ / "folder.type");
  const Bundle bundle({folder_});
  EXPECT_FALSE(bundle.pathForResource("absent", "type"));
  EXPECT_FALSE(bundle.pathForResource("folder", "type"));
}

TEST_F(BundleTest, TheMainBundleIsTheFolderThatTheEnvironmentGives) {
  const auto path = make("given.type");
  ::setenv("VESPSCOPE_RESOURCES", folder_.c_str(), 1);
  EXPECT_EQ(Bundle::main().pathForResource("given", "type"), path);
}

struct Target {
  void update() { ++updates; }
  int updates = 0;
};

TEST(Timers, ATimerKeepsItsTargetAliveUntilItIsCancelled) {
  auto& loop = dispatch::MainLoop::main();
  auto target = std::make_shared<Target>();
  const std::weak_ptr<Target> watch = target;
  const auto timer = scheduleTimer(std::chrono::milliseconds(5000), std::move(target), &Target::update);
  loop.advance(std::chrono::milliseconds(4999));
  loop.runOnce(std::chrono::milliseconds(0));
  ASSERT_FALSE(watch.expired());
  EXPECT_EQ(watch.lock()->updates, 0);
  loop.advance(std::chrono::milliseconds(1));
  loop.runOnce(std::chrono::milliseconds(0));
  EXPECT_EQ(watch.lock()->updates, 1);
  loop.cancel(timer);
  EXPECT_TRUE(watch.expired());
}

}  // namespace
}  // namespace vespscope::application
