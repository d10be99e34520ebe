// The decoder beside what it decodes: where its lines go, and who sees its reports.
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "metrics/MetricValidator.h"
#include "metrics/OutputLines.h"
#include "platform/log/Log.h"
#include "registry/MetricRows.h"
#include "support/ScriptedRun.h"

namespace vespscope::test {
namespace {

using Lines = std::vector<std::string>;

// What the decoder makes of the scripted run, an event that it does not know and one of the other kind.
void decodeEverything(MetricValidator& validator) {
  for (const MetricEvent& event : scriptedRun()) {
    validator.metricsDidUpdate(std::make_shared<const Record>(eventDictionary(event)));
  }
  validator.metricsDidUpdate(std::make_shared<const Record>(Record{{"kKeyMetricID", std::int64_t{5}}}));
  validator.eventsDidUpdate(nullptr);
}

// Collects the lines of one channel, or of both, while it lives.
class LoggedLines {
 public:
  explicit LoggedLines(std::optional<log::Channel> only = std::nullopt) : only_(only) {}
  Lines lines;

 private:
  const std::optional<log::Channel> only_;
  log::Observation observation_{[this](log::Channel channel, std::string_view line) {
    if (!only_ || channel == *only_) lines.emplace_back(line);
  }};
};

TEST(MetricValidatorSink, GivesTheSinkTheLinesThatItWouldPrintAndLog) {
  Lines printed;
  {
    const LoggedLines logged;
    MetricValidator printing;
    decodeEverything(printing);
    printed = logged.lines;
  }
  EXPECT_GT(printed.size(), 3 * 29U);

  const LoggedLines logged;
  Lines given;
  MetricValidator beside([&given](std::string_view line) { given.emplace_back(line); });
  decodeEverything(beside);
  EXPECT_EQ(given, printed);
  EXPECT_EQ(logged.lines, Lines{});
}

TEST(MetricValidatorSink, DecodesSilentlyWithoutASink) {
  OutputLines output;
  MetricValidator silent{MetricValidator::LineSink()};
  MetricValidator printing;
  decodeEverything(silent);
  EXPECT_EQ(output.take(), Lines{});
  decodeEverything(printing);
  EXPECT_EQ(silent.myLTESCellInfoDict, printing.myLTESCellInfoDict);
  EXPECT_EQ(silent.myLTE.EutraNbrs, printing.myLTE.EutraNbrs);
  EXPECT_EQ(silent.myUMTSSelReselDict, printing.myUMTSSelReselDict);
}

// A report with the field number of a metric's tag, 0x13, and then its timestamp.
const Record tagged{{"kKeyMetricID", metricIdentifier("K_LTE_RRC_STATE")},
                    {"kKeyPayload", Bytes{0x98, 0x01, 0x2A, 0x08, 0x05}}};

TEST(MetricValidatorSink, KeepsTheSystemLogFreeOfADecoderBesideTheSharedOne) {
  const LoggedLines system(log::Channel::systemLog);
  MetricValidator silent{MetricValidator::LineSink()};
  silent.metricsDidUpdate(std::make_shared<const Record>(tagged));
  EXPECT_EQ(system.lines, Lines{});
  ASSERT_TRUE(silent.myLTERRCStateDict);

  Lines given;
  MetricValidator beside([&given](std::string_view line) { given.emplace_back(line); });
  beside.metricsDidUpdate(std::make_shared<const Record>(tagged));
  EXPECT_EQ(system.lines, Lines{});
  ASSERT_GE(given.size(), 3U);
  EXPECT_EQ(given[1], "valid metricId tag");
  EXPECT_EQ(given[2], "Unknown tag: 13:42");

  OutputLines output;
  MetricValidator printing;
  printing.metricsDidUpdate(std::make_shared<const Record>(tagged));
  EXPECT_EQ(system.lines, (Lines{"valid metricId tag", "Unknown tag: 13:42"}));
  EXPECT_EQ(printing.myLTERRCStateDict, silent.myLTERRCStateDict);
}

TEST(MetricValidatorSink, ShowsItsObserverEachDecodedReportWithItsTimestampInMilliseconds) {
  MetricValidator validator{MetricValidator::LineSink()};
  std::vector<std::int64_t> identifiers;
  std::vector<double> times;
  validator.setObserver([&](std::int64_t identifier, const Record& report) {
    identifiers.push_back(identifier);
    if (const Value* time = report.find("timestamp")) times.push_back(time->asDouble().value_or(0));
  });
  decodeEverything(validator);
  validator.processMetric(Record{{"kKeyMetricID", std::int64_t{3952132}}, {"kKeyPayload", Bytes{0x08}}});  // cut short
  const auto run = scriptedRun();
  ASSERT_EQ(identifiers.size(), run.size());
  ASSERT_EQ(times.size(), run.size());
  for (std::size_t index = 0; index < run.size(); ++index) {
    EXPECT_EQ(identifiers[index], run[index].metricID);
    EXPECT_EQ(times[index], static_cast<double>(scriptedRunStart + 1000 * index));
  }
}

}  // namespace
}  // namespace vespscope::test
