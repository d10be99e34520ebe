// Every row of the event table prints, stores and converts its message.
#include <algorithm>
#include <cstdlib>
#include <random>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "OutputLines.h"
#include "RowCases.h"
#include "metrics/EventRows.h"
#include "registry/MetricRows.h"
#include "values/Text.h"

namespace vespscope::test {
namespace {

using Lines = std::vector<std::string>;

Record eventOf(std::int64_t identifier, Bytes payload) {
  return {{"kKeyMetricID", identifier}, {"kKeyPayload", std::move(payload)}, {"kKeyProfileID", 0}};
}

const RowCase& caseOf(std::string_view message) {
  const auto& cases = rowCases();
  return *std::find_if(cases.begin(), cases.end(), [message](const RowCase& row) { return row.message == message; });
}

class EventRows : public ::testing::Test {
 protected:
  EventRows() {
    setenv("TZ", "UTC", 1);
    output_.take();
  }

  MetricValidator validator_;
  OutputLines output_;
};

class EventRowsEach : public EventRows, public ::testing::WithParamInterface<RowCase> {};

INSTANTIATE_TEST_SUITE_P(Rows, EventRowsEach, ::testing::ValuesIn(rowCases()), nameOfRow);

TEST_P(EventRowsEach, IsPrintedStoredAndPostProcessed) {
  const RowCase& row = GetParam();
  EXPECT_TRUE(validator_.processMetric(eventOf(row.identifier, bytesOf(row.payload))));

  EXPECT_EQ(output_.take(), linesOf(row));
  ASSERT_TRUE(validator_.*row.stored);
  EXPECT_EQ(toText(*(validator_.*row.stored)), "[timestamp: " + reportTime + ", " + row.storedReport + "]");
  for (const ListCase& list : row.lists) {
    EXPECT_EQ(list.actual(validator_), withTime(list.elements)) << list.name;
  }
  EXPECT_EQ(validator_.metricID, row.identifier);
  EXPECT_EQ(validator_.decodeFailures(), 0U);
}

TEST_P(EventRowsEach, ChangesNoOtherState) {
  const RowCase& row = GetParam();
  validator_.processMetric(eventOf(row.identifier, bytesOf(row.payload)));
  for (const RowCase& other : rowCases()) {
    EXPECT_EQ((validator_.*other.stored).has_value(), other.identifier == row.identifier) << other.message;
    for (const ListCase& list : other.lists) {
      const bool written = std::any_of(row.lists.begin(), row.lists.end(), [&list](const ListCase& own) {
        return std::string_view(own.name) == list.name;
      });
      EXPECT_EQ(list.actual(validator_) == list.actual(MetricValidator()), !written) << list.name;
    }
  }
}

TEST_P(EventRowsEach, WithAnEmptyPayloadStoresAnEmptyDictionaryAndChangesNoList) {
  const RowCase& row = GetParam();
  EXPECT_TRUE(validator_.processMetric(eventOf(row.identifier, {})));
  EXPECT_EQ(output_.take(), (Lines{identifierLineOf(row), std::string(row.literal) + " []"}));
  EXPECT_EQ(validator_.*row.stored, Record{});
  EXPECT_EQ(validator_.decodeFailures(), 0U);
}

TEST_P(EventRowsEach, WithoutAPayloadOrWithOneThatDoesNotDecodeStoresAnEmptyDictionary) {
  const RowCase& row = GetParam();
  validator_.*row.stored = Record{{"timestamp", "before"}};
  EXPECT_TRUE(validator_.processMetric({{"kKeyMetricID", row.identifier}}));
  EXPECT_EQ(validator_.*row.stored, Record{});
  EXPECT_TRUE(validator_.processMetric({{"kKeyMetricID", row.identifier}, {"kKeyPayload", "text"}}));
  // A truncated timestamp.
  EXPECT_TRUE(validator_.processMetric(eventOf(row.identifier, {0x08, 0x80})));
  EXPECT_EQ(validator_.*row.stored, Record{});
  EXPECT_EQ(validator_.decodeFailures(), 3U);
  for (const ListCase& list : row.lists) {
    if (std::string_view(list.name).ends_with("SelReselCellInfo")) continue;
    EXPECT_EQ(list.actual(validator_), "[Waiting for Update: Waiting for Update]") << list.name;
  }
}

TEST_P(EventRowsEach, TakesRandomBytesWithoutStopping) {
  const RowCase& row = GetParam();
  std::mt19937 random(static_cast<std::uint32_t>(row.identifier));
  std::uniform_int_distribution<int> byte(0, 255);
  for (int round = 0; round < 300; ++round) {
    Bytes payload(static_cast<std::size_t>(round % 60));
    std::generate(payload.begin(), payload.end(), [&] { return static_cast<std::uint8_t>(byte(random)); });
    EXPECT_TRUE(validator_.processMetric(eventOf(row.identifier, payload)));
  }
  // A valid payload with one byte replaced reaches further into the message.
  const Bytes valid = bytesOf(row.payload);
  for (std::size_t index = 0; index < valid.size(); ++index) {
    for (const int replacement : {0x00, 0x7F, 0x80, 0xFF, byte(random)}) {
      Bytes payload = valid;
      payload[index] = static_cast<std::uint8_t>(replacement);
      EXPECT_TRUE(validator_.processMetric(eventOf(row.identifier, payload)));
    }
  }
}

TEST_P(EventRowsEach, IsForAMetricOfTheRegistryUnderItsMessage) {
  const EventRow* row = findEventRow(GetParam().identifier);
  ASSERT_NE(row, nullptr);
  EXPECT_EQ(row->message, GetParam().message);
  const auto metric = std::find_if(metricRows.begin(), metricRows.end(), [row](const MetricRow& candidate) {
    return candidate.identifier() == row->identifier;
  });
  ASSERT_NE(metric, metricRows.end());
  // The registry spells seven initials in lower case, and one name without its technology.
  const std::string_view expected = row->message == "KCellularLteRsrpRsrqSinr" ? "KCellularRsrpRsrqSinr" : row->message;
  EXPECT_EQ(metric->registryText.substr(1), expected.substr(1));
}

TEST_F(EventRows, HoldEveryMetricButTheRadioLinkFailureAndTheServingCellMeasurement) {
  EXPECT_EQ(eventRows().size(), 29U);
  for (const MetricRow& metric : metricRows) {
    const bool handled = metric.identifierName != "K_LTE_RLF" && metric.identifierName != "K_LTE_SCELL_MEAS";
    EXPECT_EQ(findEventRow(metric.identifier()) != nullptr, handled) << metric.identifierName;
  }
}

TEST_F(EventRows, EachIdentifierBesideARowIsIgnored) {
  for (const EventRow& row : eventRows()) {
    for (const std::int64_t beside : {row.identifier - 1, row.identifier + 1}) {
      const bool handled = std::any_of(eventRows().begin(), eventRows().end(),
                                       [beside](const EventRow& other) { return other.identifier == beside; });
      EXPECT_EQ(validator_.processMetric(eventOf(beside, {})), handled) << beside;
      EXPECT_EQ(validator_.metricID, beside);
    }
  }
}

TEST_F(EventRows, TheServingCellMeasurementIsIgnoredAndNothingFollowsItsLine) {
  const auto event = std::make_shared<const Record>(eventOf(3986177, {0x08, 0x01}));
  validator_.metricsDidUpdate(event);
  EXPECT_EQ(output_.take(), (Lines{"Metric ID in Hex = 3CD301", "I dont care for this Metric"}));
  EXPECT_FALSE(validator_.myLTESCellMeasDict);
  EXPECT_EQ(validator_.metricID, 3986177);
}

TEST_F(EventRows, TheRadioLinkFailureIsIgnored) {
  EXPECT_FALSE(validator_.processMetric(eventOf(3952165, {0x08, 0x01})));
  EXPECT_EQ(output_.take(), (Lines{"Metric ID in Hex = 3C4E25", "I dont care for this Metric"}));
}

TEST_F(EventRows, AnIdentifierIsPrintedInUpperCaseHexadecimalOfAtLeastTwoCharacters) {
  validator_.processMetric(eventOf(3985666, {}));
  EXPECT_EQ(output_.take().front(), "Metric ID in Hex = 3CD102");
  validator_.processMetric(eventOf(5, {}));
  EXPECT_EQ(output_.take().front(), "Metric ID in Hex =  5");
  validator_.processMetric(eventOf(0, {}));
  EXPECT_EQ(output_.take().front(), "Metric ID in Hex =  0");
  validator_.processMetric(eventOf(-1, {}));
  EXPECT_EQ(output_.take().front(), "Metric ID in Hex = FFFFFFFF");
}

TEST_F(EventRows, AnIdentifierBeyond32BitsIsIgnoredEvenIfItsLowBitsAreAMetrics) {
  EXPECT_FALSE(validator_.processMetric(eventOf((std::int64_t{1} << 32) + 3952132, {})));
  EXPECT_FALSE(validator_.myLTERRCStateDict);
}

TEST_F(EventRows, AnIdentifierOfAnyIntegerKindIsRead) {
  EXPECT_TRUE(validator_.processMetric({{"kKeyMetricID", std::uint64_t{3952132}}}));
  EXPECT_TRUE(validator_.processMetric({{"kKeyMetricID", std::int32_t{3952132}}}));
}

TEST_F(EventRows, TheKeysAreReadFromTheirProperties) {
  validator_.metricIDKey = "id";
  validator_.payloadKey = "bytes";
  EXPECT_TRUE(validator_.processMetric({{"id", 3952132}, {"bytes", Bytes{0x10, 0x01}}}));
  EXPECT_EQ(toText(*validator_.myLTERRCStateDict), "[state: KLTE_RRC_STATE_IDLE]");
}

TEST_F(EventRows, AMetricWhoseListIsMissingIsStillValid) {
  validator_.metricsDidUpdate(std::make_shared<const Record>(eventOf(3986195, {0x08, 0x00})));
  EXPECT_EQ(output_.take(),
            (Lines{"Metric ID in Hex = 3CD313", "Received CA Status Dict is [timestamp: 1970-01-01 00:00:00 UTC]",
                   "Received Valid Metric"}));
  EXPECT_EQ(textOf(validator_.myLTE.CAStatusList), "[Waiting for Update: Waiting for Update]");
}

TEST_F(EventRows, OfAReportWithSeveralListsTheOnesThatArePresentAreProcessed) {
  // Only "meas_nbr_geran", with one element.
  validator_.processMetric(eventOf(3986192, bytesOf("1a0408051814")));
  EXPECT_EQ(textOf(validator_.myLTE.UtraNbrsMeas), "[Waiting for Update: Waiting for Update]");
  EXPECT_EQ(textOf(validator_.myLTE.GeraNbrsMeas), "[arfcn: 5, rxlev: -90]");
}

TEST_F(EventRows, AReselectionWithoutQQualMinLosesThatTemplateKeyForGood) {
  const RowCase& row = caseOf("KCellularLteSelReselCellInfo");
  validator_.processMetric(eventOf(row.identifier, bytesOf(row.payload)));
  EXPECT_EQ(validator_.myLTE.SelReselCellInfo.find("QQualMin"), nullptr);
  EXPECT_EQ(*validator_.myLTE.SelReselCellInfo.find("QRxLevMin"), Value(-62));
  // The next report has "QQualMin", but the template has not.
  validator_.processMetric(eventOf(row.identifier, bytesOf("58236011")));
  EXPECT_EQ(*validator_.myLTESelReselDict->find("QQualMin"), Value(-9));
  EXPECT_EQ(textOf(validator_.myLTE.SelReselCellInfo), "[QRxLevMin: -18]");
}

TEST_F(EventRows, TheReselectionThresholdNumberedLikeTheSimFilesMetricIsNeverStored) {
  // Field 19, "Thresh_serving_lowQ", with the value 1.
  validator_.processMetric(eventOf(3986190, bytesOf("980101")));
  EXPECT_EQ(*validator_.myLTESelReselDict, Record{});
}

TEST_F(EventRows, TheBandsTheGutiAndTheTrackingAreasAreStoredAsTexts) {
  for (const char* message :
       {"KCellularLteSelReselCellInfo", "KCellularEmmContext", "KCellularWcdmaSelReselCellInfo"}) {
    validator_.processMetric(eventOf(caseOf(message).identifier, bytesOf(caseOf(message).payload)));
  }
  EXPECT_EQ(*validator_.myLTESelReselDict->find("multi_band_info"), Value("[17]"));
  EXPECT_EQ(*validator_.myUMTSSelReselDict->find("multi_band_info"), Value("[2, 4]"));
  EXPECT_EQ(*validator_.myLTEEMMContextDict->find("guti"), Value("[mmegi: 1, mmec: 2, m_tmsi: 3]"));
  EXPECT_EQ(*validator_.myLTEEMMContextDict->find("tai_list"),
            Value("[[encoded_plmn: <13 00 14>, tac: 9], [tac: 10]]"));
}

TEST_F(EventRows, ALaterReportReplacesTheStoredOneWhole) {
  validator_.processMetric(eventOf(3952132, {0x10, 0x01, 0x20, 0x05}));
  validator_.processMetric(eventOf(3952132, {0x18, 0x02}));
  EXPECT_EQ(toText(*validator_.myLTERRCStateDict), "[prev_state: KLTE_RRC_STATE_ATMPT_CONNECTION]");
}

TEST_F(EventRows, AReportWithoutATimestampRemovesItFromNothingAndPrintsNone) {
  validator_.processMetric(eventOf(3986178, bytesOf("12021801")));
  EXPECT_EQ(output_.take().back(), "Received LTE Tx Power is [tx_power_info: [[subframe_index: 1]]]");
  EXPECT_EQ(textOf(validator_.myLTE.TxPower), "[subframe_index: 1]");
}

TEST_F(EventRows, AUmtsServingCellWithoutAModeLeavesTheReceiversWithoutOne) {
  validator_.processMetric(eventOf(3985666, bytesOf("1a020877")));
  EXPECT_EQ(textOf(validator_.myUMTS.rXInfo), "[rssi: -60]");
}

TEST_F(EventRows, AnEventOfTheOtherKindPrintsItsLineWhateverItHolds) {
  validator_.eventsDidUpdate(nullptr);
  validator_.eventsDidUpdate(std::make_shared<const Record>());
  EXPECT_EQ(output_.take(), (Lines{"I dont care for events", "I dont care for events"}));
}

// Handles every event itself.
class Overriding : public MetricValidator {
 public:
  bool processMetric(const Record& event) override { return !event.empty(); }
};

TEST_F(EventRows, TheProcessingCanBeOverridden) {
  Overriding overriding;
  overriding.metricsDidUpdate(std::make_shared<const Record>());
  EXPECT_EQ(output_.take(), Lines{});
  overriding.metricsDidUpdate(std::make_shared<const Record>(Record{{"any", 1}}));
  EXPECT_EQ(output_.take(), Lines{"Received Valid Metric"});
}

using EventRowsDeathTest = EventRows;

TEST_F(EventRowsDeathTest, AnAbsentDictionaryStopsTheProcess) {
  EXPECT_DEATH(validator_.metricsDidUpdate(nullptr), "a metric event without a dictionary");
}

TEST_F(EventRowsDeathTest, AnEventWithoutAnIntegerIdentifierStopsTheProcess) {
  EXPECT_DEATH(validator_.processMetric({}), "a metric event without an integer identifier");
  EXPECT_DEATH(validator_.processMetric({{"kKeyMetricID", "3952132"}}), "without an integer identifier");
  EXPECT_DEATH(validator_.processMetric({{"kKeyMetricID", 3952132.0}}), "without an integer identifier");
  EXPECT_DEATH(validator_.processMetric({{"kKeyMetricID", true}}), "without an integer identifier");
  EXPECT_DEATH(validator_.processMetric({{"kKeyMetricID", Value()}}), "without an integer identifier");
}

}  // namespace
}  // namespace vespscope::test
