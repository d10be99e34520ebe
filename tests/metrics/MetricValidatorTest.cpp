// The whole path of an event: manager, connection, client library, wrapper, main queue, decoder.
#include <chrono>
#include <cstdlib>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "EventServer.h"
#include "OutputLines.h"
#include "RowCases.h"
#include "client/RhoxWrapper.h"
#include "metrics/MetricValidator.h"
#include "platform/dispatch/MainLoop.h"
#include "rhoxlink/bus/Names.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using Lines = std::vector<std::string>;

class MetricValidatorDelivery : public ::testing::Test {
 protected:
  MetricValidatorDelivery() { setenv("TZ", "UTC", 1); }

  // The next `count` lines of standard output, or those that arrived in time.
  Lines linesWhileRunning(std::size_t count) {
    Lines lines;
    const auto end = std::chrono::steady_clock::now() + 5s;
    while (lines.size() < count && std::chrono::steady_clock::now() < end) {
      dispatch::MainLoop::main().runOnce(100ms);
      for (std::string& line : output_.take()) lines.push_back(std::move(line));
    }
    return lines;
  }

  EventServer server_;
  OutputLines output_;
};

class MetricValidatorDeliveryOfEveryRow : public MetricValidatorDelivery,
                                          public ::testing::WithParamInterface<RowCase> {};

INSTANTIATE_TEST_SUITE_P(Rows, MetricValidatorDeliveryOfEveryRow, ::testing::ValuesIn(rowCases()), nameOfRow);

TEST_P(MetricValidatorDeliveryOfEveryRow, PrintsItsLinesAndStoresTheReport) {
  const RowCase& row = GetParam();
  const auto validator = MetricValidator::shared();
  ASSERT_TRUE(server_.waitUntilEventsOn(5s));
  server_.send(rhox::kEventMetric, metricEvent(row.identifier, bytesOf(row.payload)));

  Lines expected = linesOf(row);
  expected.emplace_back("Received Valid Metric");
  EXPECT_EQ(linesWhileRunning(expected.size()), expected);
  ASSERT_TRUE(*validator.*row.stored);
  EXPECT_EQ(toText(*((*validator).*row.stored)), "[timestamp: " + reportTime + ", " + row.storedReport + "]");
  for (const ListCase& list : row.lists) {
    EXPECT_EQ(list.actual(*validator), withTime(list.elements)) << list.name;
  }
}

TEST_F(MetricValidatorDelivery, TheSharedDecoderListensAndIsTheWrappersDelegate) {
  const auto validator = MetricValidator::shared();
  EXPECT_EQ(validator, MetricValidator::shared());
  EXPECT_EQ(validator->mySharedRhoxInstance, RhoxWrapper::sharedInstance());
  EXPECT_EQ(RhoxWrapper::sharedInstance()->delegate(), validator);
  EXPECT_TRUE(server_.waitUntilEventsOn(5s));
}

TEST_F(MetricValidatorDelivery, EventsAreProcessedInTheOrderOfTheirArrival) {
  const auto validator = MetricValidator::shared();
  ASSERT_TRUE(server_.waitUntilEventsOn(5s));
  for (std::uint8_t value = 0; value < 100; ++value) {
    server_.send(rhox::kEventMetric, metricEvent(3952132, {0x20, value}));
  }
  const Lines lines = linesWhileRunning(300);
  ASSERT_EQ(lines.size(), 300U);
  for (std::size_t index = 0; index < 100; ++index) {
    EXPECT_EQ(lines[3 * index + 1], "Current RRC state is [prev_state_dur_ms: " + std::to_string(index) + "]");
  }
}

TEST_F(MetricValidatorDelivery, AMetricThatIsNotHandledIsIgnored) {
  const auto validator = MetricValidator::shared();
  ASSERT_TRUE(server_.waitUntilEventsOn(5s));
  server_.send(rhox::kEventMetric, metricEvent(3986177, {}));
  server_.send(rhox::kEventMetric, metricEvent(3952132, {}));
  EXPECT_EQ(linesWhileRunning(5),
            (Lines{"Metric ID in Hex = 3CD301", "I dont care for this Metric", "Metric ID in Hex = 3C4E04",
                   "Current RRC state is []", "Received Valid Metric"}));
}

TEST_F(MetricValidatorDelivery, AnEventOfTheOtherKindIsNotCaredFor) {
  const auto validator = MetricValidator::shared();
  ASSERT_TRUE(server_.waitUntilEventsOn(5s));
  server_.send(rhox::kEventTrigger, {});
  EXPECT_EQ(linesWhileRunning(1), Lines{"I dont care for events"});
}

TEST_F(MetricValidatorDelivery, BrokenPayloadsOfEveryMetricAreCountedAndNothingStops) {
  const auto validator = MetricValidator::shared();
  ASSERT_TRUE(server_.waitUntilEventsOn(5s));
  for (const RowCase& row : rowCases()) {
    server_.send(rhox::kEventMetric, metricEvent(row.identifier, {0x08, 0xFF, 0xFF}));
  }
  EXPECT_EQ(linesWhileRunning(3 * rowCases().size()).size(), 3 * rowCases().size());
  EXPECT_EQ(validator->decodeFailures(), rowCases().size());
}

using MetricValidatorDeliveryDeathTest = MetricValidatorDelivery;

TEST_F(MetricValidatorDeliveryDeathTest, AnEventWithoutAnIntegerIdentifierStopsTheProcessWithOneClearLine) {
  // The child runs the test from its start, so that it has the threads that deliver the event.
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  const auto validator = MetricValidator::shared();
  ASSERT_TRUE(server_.waitUntilEventsOn(5s));
  ipc::Dictionary event;
  event.set(rhox::kKeyMetricID, ipc::Object(std::string("3952132")));
  // In the child only: here the event would stop whichever test runs the main queue next.
  const auto receive = [&] {
    server_.send(rhox::kEventMetric, event);
    linesWhileRunning(1);
  };
  EXPECT_DEATH(receive(), "a metric event without an integer identifier");
}

}  // namespace
}  // namespace vespscope::test
