// The registry of metric tags against the list of metrics.
#include <set>
#include <string>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "platform/log/Log.h"
#include "registry/KBBMetricUtility.h"
#include "registry/MetricRows.h"

namespace vespscope::test {
namespace {

std::vector<std::string> linesOf(std::int64_t tag, std::string_view messageClass = "KCellularLteRrcState") {
  log::discardOutputs();
  std::vector<std::string> lines;
  const log::Observation observation([&lines](log::Channel channel, std::string_view line) {
    lines.push_back((channel == log::Channel::systemLog ? "system: " : "output: ") + std::string(line));
  });
  lines.emplace_back(KBBMetricUtility::isValidMetricIdTag(tag, messageClass) ? "valid" : "not valid");
  return lines;
}

using Lines = std::vector<std::string>;

TEST(KBBMetricUtility, KnowsTagsAndLogsThem) {
  EXPECT_EQ(linesOf(19), (Lines{"system: valid metricId tag", "valid"}));
  EXPECT_EQ(linesOf(53522), (Lines{"system: valid metricId tag", "valid"}));
}

TEST(KBBMetricUtility, DoesNotKnowOtherNumbersAndKeepsSilent) {
  for (const std::int64_t tag : {std::int64_t{0}, std::int64_t{1}, std::int64_t{3985666}, std::int64_t{65535},
                                 std::int64_t{65536}, std::int64_t{65536 + 19}, std::int64_t{-1},
                                 std::int64_t{19} << 32, std::int64_t{-65517}, INT64_MIN, INT64_MAX}) {
    EXPECT_EQ(linesOf(tag), (Lines{"not valid"})) << tag;
  }
}

TEST(KBBMetricUtility, GivesEveryClassTheSameAnswer) {
  for (const char* messageClass : {"KCellularLteRrcState", "KCellularSimCardFiles", "Plmn", ""}) {
    EXPECT_EQ(linesOf(19, messageClass).back(), "valid");
    EXPECT_EQ(linesOf(20, messageClass).back(), "not valid");
  }
}

TEST(KBBMetricUtility, HasExactly31KeysWhichAreTheLow16BitsOfTheIdentifiers) {
  EXPECT_EQ(KBBMetricUtility::count(), 31U);
  std::set<std::int64_t> known;
  for (const MetricRow& row : metricRows) {
    EXPECT_EQ(row.identifier() & ~0xFFFF, 0x3C0000) << row.identifierName;
    known.insert(row.identifier() - 0x3C0000);
    EXPECT_EQ(linesOf(row.identifier() - 0x3C0000).back(), "valid") << row.identifierName;
  }
  EXPECT_EQ(known.size(), 31U);
  log::discardOutputs();
  for (std::int64_t tag = 0; tag < 65536; ++tag) {
    EXPECT_EQ(KBBMetricUtility::isValidMetricIdTag(tag, ""), known.contains(tag)) << tag;
  }
}

// Repeated here, so that an error in the list of metrics is detected.
struct Metric {
  const char* name;
  std::int32_t identifier;
  const char* text;
};

TEST(KBBMetricUtility, HoldsEveryMetricUnderItsIdentifierNameAndText) {
  const std::vector<Metric> metrics = {
      {"K_LTE_RRC_STATE", 3952132, "KCellularLteRrcState"},
      {"K_LTE_CDRX_CONFIG", 3952152, "KCellularLteCdrxConfig"},
      {"K_LTE_RLF", 3952165, "KCellularLteRadioLinkFailure"},
      {"K_LTE_SCELL_INFO", 3948738, "KCellularLteScellInfo"},
      {"K_LTE_SEL_RESEL_INFO", 3986190, "KCellularLteSelReselCellInfo"},
      {"K_LTE_SCELL_MEAS", 3986177, "KCellularLteServingCellMeasurement"},
      {"K_LTE_TX_POWER", 3986178, "KCellularLteTxPower"},
      {"K_LTE_RSRP_RSRQ_SINR", 3952490, "KCellularRsrpRsrqSinr"},
      {"K_LTE_EMM_CTXT", 3986700, "KCellularEmmContext"},
      {"K_LTE_COMPCARR_INFO", 3986187, "KCellularLteComponentCarrierInfo"},
      {"K_LTE_CA_STATUS", 3986195, "KCellularLteCarrierAggregationStatus"},
      {"K_LTE_INTERRAT_MEAS", 3986192, "KCellularLteNbrInterRatCellMeas"},
      {"K_LTE_INTRARAT_MEAS", 3986191, "KCellularLteNbrEutraCellMeas"},
      {"K_CELLULAR_MM_INFO", 3986697, "KCellularMmCommonInfo"},
      {"K_CELLULAR_ACTIVE_BEARER", 3986701, "KCellularActivatedBearerContexts"},
      {"K_UMTS_RRC_STATE", 3985682, "KCellularWcdmaRrcConnectionState"},
      {"K_UMTS_SCELL_INFO", 3944460, "KCellularWcdmaCellInfo"},
      {"K_UMTS_SCELL_MEAS", 3985666, "KCellularWcdmaScellMeasurement"},
      {"K_UMTS_TX_POWER", 3985667, "KCellularWcdmaTxPower"},
      {"K_UMTS_NCELL_MEAS", 3985669, "KCellularWcdmaNbrCellMeas"},
      {"K_UMTS_SEL_RESEL_INFO", 3985668, "KCellularWcdmaSelReselCellInfo"},
      {"K_UMTS_RRC_CONFIG", 3985683, "KCellularWcdmaRrcConfiguration"},
      {"K_CELLULAR_MM_CTXT", 3986698, "KCellularMmContext"},
      {"K_CELLULAR_GMM_CTXT", 3986699, "KCellularGmmContext"},
      {"K_GSM_SCELL_INFO", 3943948, "kCellularGsmScellInfo"},
      {"K_GSM_IDLE_CONFIG", 3985409, "kCellularGsmIdleConfig"},
      {"K_GSM_IDLE_SCELL_MEAS", 3985410, "kCellularGsmIdleScellMeasurement"},
      {"K_GSM_CS_RF_MEAS", 3985411, "kCellularGsmCsRfMeasurement"},
      {"K_GSM_NCELL_MEAS", 3985417, "kCellularGsmGrrEventMeasCr"},
      {"K_GSM_GPRS_CONFIG", 3985420, "kCellularGsmGprsConfig"},
      {"K_SIM_FILE_INFO", 3932179, "kCellularSimCardFiles"},
  };
  ASSERT_EQ(metrics.size(), metricRows.size());
  for (std::size_t index = 0; index < metrics.size(); ++index) {
    EXPECT_EQ(metricRows[index].identifierName, metrics[index].name);
    EXPECT_EQ(metricRows[index].identifier(), metrics[index].identifier) << metrics[index].name;
    EXPECT_EQ(metricRows[index].registryText, metrics[index].text);
  }
}

TEST(KBBMetricUtility, AnIdentifierIsFoundByItsName) {
  static_assert(metricIdentifier("K_LTE_RRC_STATE") == 3952132);
  static_assert(metricIdentifier("K_SIM_FILE_INFO") == 3932179);
  EXPECT_EQ(metricIdentifier("K_UMTS_RRC_STATE"), 3985682);
}

TEST(KBBMetricUtility, MayBeAskedFirstByManyThreads) {
  log::discardOutputs();
  std::vector<std::thread> threads;
  std::vector<int> valid(8);
  for (int& answer : valid) {
    threads.emplace_back([&answer] { answer = KBBMetricUtility::isValidMetricIdTag(19, "") ? 1 : 0; });
  }
  for (std::thread& thread : threads) thread.join();
  EXPECT_EQ(valid, std::vector<int>(8, 1));
}

}  // namespace
}  // namespace vespscope::test
