// The viewer without an interface, with a manager.
#include <signal.h>

#include <cstdint>
#include <filesystem>
#include <random>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "registry/MetricRows.h"
#include "support/FakeManager.h"
#include "support/Process.h"
#include "support/ScriptedRun.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using ::testing::EndsWith;
using ::testing::HasSubstr;

const std::filesystem::path viewer = std::filesystem::path(VESPSCOPE_BIN_DIR) / "vespscope";
const std::string startLines = "pushing metric file\nQuerying SIM files\n";

std::size_t countOf(const std::string& text, const std::string& part) {
  std::size_t count = 0;
  for (std::size_t at = text.find(part); at != std::string::npos; at = text.find(part, at + part.size())) ++count;
  return count;
}

class VespscopeRunOnTheDrive : public ::testing::TestWithParam<int> {};

TEST_P(VespscopeRunOnTheDrive, PrintsItsLinesAndEndsInOrderOnASignal) {
  Process process(viewer, {"--ui", "none", "--manager", "embedded:scenario"});
  ASSERT_TRUE(process.waitForOutput("Received Valid Metric\n"));
  process.signal(GetParam());
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
  EXPECT_EQ(countOf(process.output(), "pushing metric file\n"), 1U);
  EXPECT_EQ(countOf(process.output(), "Querying SIM files\n"), 1U);
  EXPECT_LT(process.output().find("pushing metric file\n"), process.output().find("Querying SIM files\n"));
  EXPECT_THAT(process.output(), HasSubstr("Metric ID in Hex = 3C0013\nReceived SIM Card File Info is"));
  EXPECT_EQ(process.errors().find("fatal"), std::string::npos);
}

std::string signalName(const ::testing::TestParamInfo<int>& signal) {
  return signal.param == SIGINT ? "Interrupt" : "Terminate";
}

INSTANTIATE_TEST_SUITE_P(Signals, VespscopeRunOnTheDrive, ::testing::Values(SIGINT, SIGTERM), signalName);

class VespscopeRun : public ::testing::Test {
 protected:
  VespscopeRun() {
    folder_.write("ice_test_lte.deviceconfig", "any");
    variables_ = {{"VESPSCOPE_RESOURCES", folder_.path().string()}, {"TZ", "UTC"}};
  }

  // Returns true when all calls of the start-up have arrived.
  [[nodiscard]] bool started() const { return manager_.waitForCalls(7) && manager_.eventsOn(); }

  TemporaryFolder folder_;
  FakeManager manager_{folder_ / "manager.socket"};
  std::map<std::string, std::string> variables_;
  const std::vector<std::string> arguments_ = {"--ui", "none", "--manager", manager_.address()};
};

TEST_F(VespscopeRun, PrintsExactlyTheLinesOfWhatHappens) {
  Process process(viewer, arguments_, variables_);
  ASSERT_TRUE(started());
  const MetricEvent event = scriptedRun().front();
  manager_.sendMetric(event.metricID, event.payload);
  manager_.sendMetric(metricIdentifier("K_LTE_SCELL_MEAS"), event.payload);
  manager_.sendTrigger("any");
  ASSERT_TRUE(process.waitForOutput("I dont care for events\n"));
  process.signal(SIGTERM);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
  EXPECT_EQ(process.output(),
            startLines +
                "Metric ID in Hex = 3C4E04\n"
                "Current RRC state is [timestamp: 2023-11-14 22:13:20 UTC, state: KLTE_RRC_STATE_CONNECTED, "
                "prev_state: KLTE_RRC_STATE_ATMPT_CONNECTION, prev_state_dur_ms: 97, "
                "cause: KLTE_RRC_CAUSE_EST_MO_DATA]\n"
                "Received Valid Metric\n"
                "Metric ID in Hex = 3CD301\n"
                "I dont care for this Metric\n"
                "I dont care for events\n");
}

TEST_F(VespscopeRun, FindsTheManagerOfTheEnvironment) {
  variables_["RHOX_ADDRESS"] = manager_.address();
  Process process(viewer, {"--ui", "none"}, variables_);
  EXPECT_TRUE(started());
}

TEST_F(VespscopeRun, TheCommandLineGoesBeforeTheEnvironment) {
  variables_["RHOX_ADDRESS"] = "unix:path=/nonexistent/manager";
  Process process(viewer, arguments_, variables_);
  EXPECT_TRUE(started());
}

TEST_F(VespscopeRun, AnEventWithoutAnIdentifierStopsItWithOneLine) {
  Process process(viewer, arguments_, variables_);
  ASSERT_TRUE(started());
  manager_.sendMetricWithoutIdentifier();
  EXPECT_EQ(process.wait(), (ProcessEnd{true, SIGABRT}));
  EXPECT_EQ(process.output(), startLines);
  EXPECT_EQ(countOf(process.errors(), "fatal: "), 1U);
  EXPECT_THAT(process.errors(), EndsWith(")\n"));
  EXPECT_THAT(process.errors(), HasSubstr("identifier"));
}

TEST_F(VespscopeRun, AnIdentifierThatIsATextStopsItToo) {
  Process process(viewer, arguments_, variables_);
  ASSERT_TRUE(started());
  manager_.sendMetricWithTextIdentifier("3952132");
  EXPECT_EQ(process.wait(), (ProcessEnd{true, SIGABRT}));
  EXPECT_EQ(countOf(process.errors(), "fatal: "), 1U);
}

TEST_F(VespscopeRun, PayloadsOfRandomBytesNeverStopIt) {
  Process process(viewer, arguments_, variables_);
  ASSERT_TRUE(started());
  std::mt19937 random(20231114);
  std::uniform_int_distribution<int> byte(0, 255);
  for (int round = 0; round < 20; ++round) {
    for (const MetricRow& row : metricRows) {
      Bytes payload(static_cast<std::size_t>(byte(random)));
      for (std::uint8_t& value : payload) value = static_cast<std::uint8_t>(byte(random));
      manager_.sendMetric(row.identifier(), payload);
    }
  }
  manager_.sendTrigger("last");
  EXPECT_TRUE(process.waitForOutput("I dont care for events\n"));
  EXPECT_EQ(countOf(process.output(), "Received Valid Metric\n"), 20U * 29U);
  process.signal(SIGTERM);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
}

TEST_F(VespscopeRun, ABrokenStandardOutputDoesNotStopIt) {
  Process process(viewer, arguments_, variables_);
  ASSERT_TRUE(started());
  process.closeOutput();
  const MetricEvent event = scriptedRun().front();
  manager_.sendMetric(event.metricID, event.payload);
  manager_.disconnect();
  EXPECT_TRUE(manager_.waitForConnections(2));
  process.signal(SIGTERM);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
}

TEST_F(VespscopeRun, AClosedStandardOutputDoesNotStopIt) {
  const std::string command =
      "exec " + viewer.string() + " --ui none --manager " + manager_.address() + " <&- >&- 2>&-";
  Process process("/bin/sh", {"-c", command}, variables_);
  ASSERT_TRUE(started());
  const MetricEvent event = scriptedRun().front();
  manager_.sendMetric(event.metricID, event.payload);
  manager_.disconnect();
  EXPECT_TRUE(manager_.waitForConnections(2));
  process.signal(SIGTERM);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
}

}  // namespace
}  // namespace vespscope::test
