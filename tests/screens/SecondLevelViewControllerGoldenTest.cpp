// Every screen of the catalogue compared with golden grids, before the first event and after the scripted run.
#include <cstdlib>
#include <filesystem>
#include <set>
#include <string>

#include <gtest/gtest.h>

#include "screens/Screens.h"
#include "screens/VespViewItems.h"
#include "support/Golden.h"
#include "support/ScreenGrid.h"
#include "support/ScriptedRun.h"

namespace vespscope::test {
namespace {

const std::filesystem::path goldens = std::filesystem::path(VESPSCOPE_SOURCE_DIR) / "tests" / "screens" / "golden";

class SecondLevelViewControllerGolden : public ::testing::TestWithParam<const char*> {
 protected:
  void SetUp() override {
    ::setenv("TZ", "UTC", 1);
    decoder_ = std::make_shared<MetricValidator>();
  }

  // All screens behind one launch row, each under its name.
  [[nodiscard]] std::string grids() const {
    std::string text;
    for (const std::string& row : VespViewItems::shared().firstLevelViewItems.at(GetParam())) {
      const auto screen = secondLevel(GetParam(), row);
      screen->myMetricValidator = decoder_;
      text += (text.empty() ? "" : "\n") + std::string("== ") + row + " ==\n" + gridOf(*screen);
    }
    return text;
  }

  static std::filesystem::path file(const std::string& moment) {
    return goldens / moment / (std::string(GetParam()) + ".txt");
  }

  std::shared_ptr<MetricValidator> decoder_;
};

TEST_P(SecondLevelViewControllerGolden, BeforeTheFirstEvent) { EXPECT_TRUE(matchesGolden(file("before"), grids())); }

TEST_P(SecondLevelViewControllerGolden, AfterTheScriptedRun) {
  for (const MetricEvent& event : scriptedRun()) {
    decoder_->metricsDidUpdate(std::make_shared<Record>(eventDictionary(event)));
  }
  EXPECT_EQ(decoder_->decodeFailures(), 0U);
  EXPECT_TRUE(matchesGolden(file("after"), grids()));
}

std::string testName(const ::testing::TestParamInfo<const char*>& technology) {
  std::string name = technology.param;
  std::erase(name, ' ');
  return name;
}

INSTANTIATE_TEST_SUITE_P(Technologies, SecondLevelViewControllerGolden,
                         ::testing::Values("Device Info", "LTE", "UMTS", "GSM"), testName);

TEST(SecondLevelViewControllerGoldenRun, HoldsEachOfTheTwentyNineHandledMetricsOnce) {
  const MetricValidator decoder;
  std::set<std::int64_t> expected;
  for (const MetricRow& row : metricRows) expected.insert(row.identifier());
  expected.erase(decoder.K_LTE_RLF);
  expected.erase(decoder.K_LTE_SCELL_MEAS);
  std::set<std::int64_t> found;
  for (const MetricEvent& event : scriptedRun()) EXPECT_TRUE(found.insert(event.metricID).second);
  EXPECT_EQ(found, expected);
  EXPECT_EQ(found.size(), 29U);
}

}  // namespace
}  // namespace vespscope::test
