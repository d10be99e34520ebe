// vespctl state and screens, before any event and after every metric.
#include <string>
#include <vector>

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include "Program.h"
#include "support/Golden.h"
#include "support/ScriptedRun.h"

namespace vespscope::test {
namespace {

using Json = nlohmann::ordered_json;

const std::string golden = VESPSCOPE_SOURCE_DIR "/tests/tools/golden/";

// The output of a command that reads `capture`, formatted over several lines for comparison.
std::string outputOf(std::vector<std::string> arguments, const std::string& capture) {
  const Outcome outcome = vespctl(arguments, capture);
  EXPECT_EQ(outcome.status, 0);
  EXPECT_EQ(outcome.errors, "");
  EXPECT_EQ(linesOf(outcome.output).size(), 1U);
  return Json::parse(outcome.output).dump(1) + "\n";
}

const std::string noEvents = captureOf(std::vector<MetricEvent>{});

TEST(VespctlState, BeforeAnyEventShowsPlaceholdersTemplatesAndNulls) {
  EXPECT_TRUE(matchesGolden(golden + "state-before.json", outputOf({"state", "-"}, noEvents)));
}

TEST(VespctlState, AfterEveryMetricShowsWhatTheDecoderHolds) {
  EXPECT_TRUE(matchesGolden(golden + "state-after.json", outputOf({"state", "-"}, captureOf(scriptedRun()))));
}

TEST(VespctlState, WritesA32BitNumberWithItsShortestDigits) {
  // A secondary carrier of bandwidth code 0, which is 1.4 MHz, with a quality of -11.23 dB.
  const std::string packet = binary("0893a6f301 1000 1a09 1207 3000 60c511 5801");
  const Json state = Json::parse(vespctl({"state", "-"}, captureOf(std::vector{packetAt(0, 0, packet)})).output);
  EXPECT_EQ(state["myLTE"]["CAStatusList"].dump(), R"([{"dl_bandwidth":1.4,"rsrp":0,"rsrq":-11.23}])");
  EXPECT_EQ(state["metricID"], 3986195);
}

TEST(VespctlState, OfATruncatedCaptureShowsTheStateBeforeTheCut) {
  const std::string packet = packetAt(0, 0, binary("08849cf101 1a02 1001"));
  const Outcome outcome = vespctl({"state", "-"}, captureOf(std::vector{packet, packet.substr(0, 20)}));
  EXPECT_EQ(outcome.status, 2);
  EXPECT_EQ(Json::parse(outcome.output)["myLTERRCStateDict"].dump(), R"({"state":"KLTE_RRC_STATE_IDLE"})");
  EXPECT_EQ(outcome.errors,
            "vespctl: standard input: packet 1: truncated dump file; tried to read 9 captured bytes, only got 4\n");
}

TEST(VespctlScreens, BeforeAnyEventAreAll42InTheOrderOfTheCatalogue) {
  const std::string output = outputOf({"screens", "-"}, noEvents);
  EXPECT_EQ(Json::parse(output).size(), 42U);
  EXPECT_TRUE(matchesGolden(golden + "screens-before.json", output));
}

TEST(VespctlScreens, AfterEveryMetricShowItsRows) {
  EXPECT_TRUE(matchesGolden(golden + "screens-after.json", outputOf({"screens", "-"}, captureOf(scriptedRun()))));
}

TEST(VespctlScreens, CanBeNarrowedToALaunchRowAndToOneScreen) {
  const std::string capture = captureOf(scriptedRun());
  const Json all = Json::parse(outputOf({"screens", "-"}, capture));
  const Json gsm = Json::parse(outputOf({"screens", "-", "GSM"}, capture));
  EXPECT_EQ(gsm.size(), 11U);
  for (std::size_t index = 0; index < gsm.size(); ++index) EXPECT_EQ(gsm[index], all[all.size() - 11 + index]);
  const Json one = Json::parse(outputOf({"screens", "-", "LTE", "Serving Cell Info"}, capture));
  ASSERT_EQ(one.size(), 1U);
  EXPECT_EQ(one[0]["launch"], "LTE");
  EXPECT_EQ(one[0]["row"], "Serving Cell Info");
  EXPECT_EQ(one[0]["key"], "LTE Serving Cell Info");
}

TEST(VespctlScreens, OfOneLiteralEventAreExact) {
  const std::string packet = binary("08849cf101 1a02 1001");
  const Outcome outcome = vespctl({"screens", "-", "LTE", "RRC State"}, captureOf(std::vector{packetAt(0, 0, packet)}));
  EXPECT_EQ(outcome.output, R"([{"launch":"LTE","row":"RRC State","key":"LTE RRC State",)"
                            R"("sections":[{"title":null,"rows":[["state","KLTE_RRC_STATE_IDLE"]]}]}])"
                            "\n");
}

TEST(VespctlScreens, RefusesRowsThatTheCatalogueDoesNotHave) {
  const Outcome launch = vespctl({"screens", "-", "NR"}, noEvents);
  EXPECT_EQ(launch.status, 2);
  EXPECT_EQ(launch.output, "");
  EXPECT_EQ(launch.errors, "vespctl: no launch row 'NR'; there are Device Info, LTE, UMTS, GSM\n");
  const Outcome row = vespctl({"screens", "-", "Device Info", "NAS"}, noEvents);
  EXPECT_EQ(row.status, 2);
  EXPECT_EQ(row.errors, "vespctl: no row 'NAS' behind Device Info; there are IMSI, IMEISV, SIM Files\n");
}

}  // namespace
}  // namespace vespscope::test
