// Metric configurations as literal TOML, and their meaning or the reason why they are rejected.
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "manager/Configuration.h"
#include "registry/MetricRows.h"

namespace vespscope::test {
namespace {

using manager::Configuration;
using manager::MetricRule;

using testing::HasSubstr;
using testing::StartsWith;

TEST(Configuration, GivesEachNamedMetricItsRule) {
  const auto configuration = Configuration::parse(
      "# comment\n"
      "[metrics]\n"
      "K_LTE_RRC_STATE = { on = \"change\" }\n"
      "K_LTE_TX_POWER = { period_ms = 250 }\n"
      "[metrics.K_GSM_NCELL_MEAS]\n"
      "period_ms = 86_400_000\n"
      "[metrics.K_LTE_RLF]\n"
      "on = \"event\"\n");
  ASSERT_TRUE(configuration.ok()) << configuration.reason();
  EXPECT_EQ(configuration->size(), 4U);
  const MetricRule* change = configuration->ruleFor(3952132);
  ASSERT_NE(change, nullptr);
  EXPECT_TRUE(change->onChange());
  const MetricRule* periodic = configuration->ruleFor(3986178);
  ASSERT_NE(periodic, nullptr);
  EXPECT_FALSE(periodic->onChange());
  EXPECT_EQ(periodic->period, std::chrono::milliseconds(250));
  EXPECT_EQ(configuration->ruleFor(3985417)->period, std::chrono::hours(24));
  const MetricRule* every = configuration->ruleFor(3952165);
  ASSERT_NE(every, nullptr);
  EXPECT_TRUE(every->everyEvent);
  EXPECT_FALSE(every->onChange() || change->everyEvent || periodic->everyEvent);
  EXPECT_EQ(configuration->ruleFor(3952152), nullptr);
}

TEST(Configuration, IsRefusedWithLineAndReason) {
  const std::vector<std::pair<std::string, std::string>> table = {
      {"", "the configuration is empty"},
      {"# nothing\n", "line 1: there is no table [metrics]"},
      {"[metrics]\n", "line 1: [metrics] names no metric"},
      {"metrics = 3\n", "line 1: metrics must be a table, not a value of type integer"},
      {"title = \"x\"\n[metrics]\nK_LTE_RLF = { period_ms = 1 }\n",
       "line 1: there is no setting title outside [metrics]"},
      {"[metrics]\nK_LTE_RLF = { period_ms = 1 }\nK_NOISE = { period_ms = 1 }\n", "line 3: there is no metric K_NOISE"},
      {"[metrics]\nk_lte_rlf = { period_ms = 1 }\n", "line 2: there is no metric k_lte_rlf"},
      {"[metrics]\n\nK_LTE_RLF = 1000\n",
       "line 3: K_LTE_RLF must be a table with period_ms or on, not a value of type integer"},
      {"[metrics]\nK_LTE_RLF = {}\n", "line 2: K_LTE_RLF needs either period_ms or on"},
      {"[metrics]\nK_LTE_RLF = { period_ms = 1, on = \"change\" }\n",
       "line 2: K_LTE_RLF needs either period_ms or on, not both"},
      {"[metrics]\nK_LTE_RLF = { period_ms = 0 }\n", "line 2: K_LTE_RLF: period_ms must be 1 to 86400000, not 0"},
      {"[metrics]\nK_LTE_RLF = { period_ms = -5 }\n", "line 2: K_LTE_RLF: period_ms must be 1 to 86400000, not -5"},
      {"[metrics]\nK_LTE_RLF = { period_ms = 86400001 }\n",
       "line 2: K_LTE_RLF: period_ms must be 1 to 86400000, not 86400001"},
      {"[metrics]\nK_LTE_RLF = { period_ms = 1.5 }\n",
       "line 2: K_LTE_RLF: period_ms must be an integer, not a value of type floating-point"},
      {"[metrics]\nK_LTE_RLF = { period_ms = \"1000\" }\n",
       "line 2: K_LTE_RLF: period_ms must be an integer, not a value of type string"},
      {"[metrics]\nK_LTE_RLF = { on = \"always\" }\n", "line 2: K_LTE_RLF: on must be \"change\" or \"event\""},
      {"[metrics]\nK_LTE_RLF = { on = true }\n", "line 2: K_LTE_RLF: on must be \"change\" or \"event\""},
      {"[metrics]\nK_LTE_RLF = { period_ms = 1, colour = 2 }\n", "line 2: K_LTE_RLF: there is no setting colour"},
      {"[metrics]\nK_LTE_RLF = { period_ms = 1000\nK_LTE_TX_POWER = { period_ms = 1000 }\n", "line 2: "},
      {"[metrics\n", "line 1: "},
      {std::string("[metrics]\n\0", 11), "line 2: "},
      {"[metrics]\n# \xFF\n", "line 2: "},
  };
  for (const auto& [toml, reason] : table) {
    SCOPED_TRACE(toml);
    const auto configuration = Configuration::parse(toml);
    ASSERT_FALSE(configuration.ok());
    if (reason.ends_with(": ")) {
      EXPECT_THAT(configuration.reason(), StartsWith(reason));
      EXPECT_GT(configuration.reason().size(), reason.size() + 10);
    } else {
      EXPECT_EQ(configuration.reason(), reason);
    }
    EXPECT_EQ(configuration.reason().find('\n'), std::string::npos);
  }
}

TEST(Configuration, ThatNamesAMetricTwiceIsRefused) {
  const auto configuration = Configuration::parse(
      "[metrics]\nK_LTE_RLF = { period_ms = 1000 }\nK_LTE_TX_POWER = { period_ms = 1000 }\nK_LTE_RLF = { on = "
      "\"change\" }\n");
  ASSERT_FALSE(configuration.ok());
  EXPECT_THAT(configuration.reason(), StartsWith("line 4: "));
  EXPECT_THAT(configuration.reason(), HasSubstr("K_LTE_RLF"));
}

TEST(Configuration, ReportsTheFirstOfSeveralFaults) {
  const auto configuration =
      Configuration::parse("[metrics]\nZ = { period_ms = 1 }\nK_LTE_RLF = { period_ms = 0 }\nA = 1\n");
  EXPECT_EQ(configuration.reason(), "line 2: there is no metric Z");
}

TEST(Configuration, LongerThanItsBoundIsRefused) {
  const std::string toml = "[metrics]\nK_LTE_RLF = { period_ms = 1 }\n#";
  const std::string longest = toml + std::string(Configuration::sizeLimit - toml.size(), 'x');
  EXPECT_TRUE(Configuration::parse(longest).ok());
  EXPECT_EQ(Configuration::parse(longest + 'x').reason(), "the configuration is longer than 65536 bytes");
}

// Each of these would overflow the stack of the parser, or of its destructors.
TEST(Configuration, NestedWithoutEndIsRefusedNotFatal) {
  std::string key = "a";
  for (int part = 1; part < 100'000; ++part) key += ".a";
  for (const std::string& toml : {key + "=1", "[" + key + "]", "[metrics]\n" + key + "=1"}) {
    EXPECT_FALSE(Configuration::parse(toml).ok());
  }
  key.resize(59'999);
  for (const std::string& toml :
       {key + "=1", "[" + key + "]", "[[" + key + "]]", "x={" + key + "=1}", "[metrics]\n" + key + "=1",
        "[metrics]\nx={" + key + "=1}", "[metrics." + key + "]"}) {
    const auto configuration = Configuration::parse(toml);
    ASSERT_FALSE(configuration.ok());
    EXPECT_THAT(configuration.reason(), testing::EndsWith(": a key has more than 8 parts"));
  }
  EXPECT_EQ(Configuration::parse("[metrics]\nK_LTE_RLF = " + std::string(60'000, '[')).reason(),
            "line 2: values are nested more than 8 deep");
}

TEST(Configuration, WithALongNameIsRefusedInAShortLine) {
  for (const std::string& name : {std::string(10'000, 'K'), '"' + std::string(10'000, 'K') + '"'}) {
    EXPECT_EQ(Configuration::parse("[metrics]\n" + name + " = { period_ms = 1 }\n").reason(),
              "line 2: a key is longer than 256 bytes");
  }
}

TEST(Configuration, ShippedWithTheViewerNamesAllMetrics) {
  std::ifstream file(VESPSCOPE_SOURCE_DIR "/resources/ice_test_lte.deviceconfig");
  const std::string toml{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
  const auto configuration = Configuration::parse(toml);
  ASSERT_TRUE(configuration.ok()) << configuration.reason();
  EXPECT_EQ(configuration->size(), metricRows.size());
  for (const MetricRow& row : metricRows) EXPECT_NE(configuration->ruleFor(row.identifier()), nullptr);
}

}  // namespace
}  // namespace vespscope::test
