// Lists of a message replace those of the holders, element by element.
#include <cstdint>
#include <cstdlib>
#include <optional>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "OutputLines.h"
#include "metrics/PostProcessing.h"
#include "values/Text.h"

namespace vespscope::test {
namespace {

using Lines = std::vector<std::string>;

RecordList& neighbours(MetricValidator& validator) { return validator.myLTE.EutraNbrsMeas; }
RecordList& receivers(MetricValidator& validator) { return validator.myUMTS.rXInfo; }
Record& lteTemplate(MetricValidator& validator) { return validator.myLTE.SelReselCellInfo; }
Record& umtsTemplate(MetricValidator& validator) { return validator.myUMTS.SelReselCellInfo; }

constexpr ReplaceList replaceNeighbours = {"list", neighbours, Measured::lteNeighbour};

std::string listText(const RecordList& list) {
  std::string text;
  for (const Record& record : list) text += toText(record);
  return text;
}

TEST(PostProcessing, AListReplacesThePlaceholderWithItsElementsInOrder) {
  MetricValidator validator;
  Record report = {{"list", List{Record{{"pci", 1}}, Record{{"pci", 2}}, Record{}}}};
  postProcess(validator, report, {replaceNeighbours});
  EXPECT_EQ(listText(validator.myLTE.EutraNbrsMeas), "[pci: 1][pci: 2][]");
}

TEST(PostProcessing, AListThatArrivesEmptyReplacesThePlaceholderLeavingNoRecords) {
  MetricValidator validator;
  Record report = {{"list", List{}}};
  postProcess(validator, report, {replaceNeighbours});
  EXPECT_TRUE(validator.myLTE.EutraNbrsMeas.empty());
}

TEST(PostProcessing, ALaterListDropsThePreviousElements) {
  MetricValidator validator;
  Record first = {{"list", List{Record{{"pci", 1}}, Record{{"pci", 2}}}}};
  Record second = {{"list", List{Record{{"pci", 3}}}}};
  postProcess(validator, first, {replaceNeighbours});
  postProcess(validator, second, {replaceNeighbours});
  EXPECT_EQ(listText(validator.myLTE.EutraNbrsMeas), "[pci: 3]");
}

TEST(PostProcessing, AMissingListKeepsThePreviousContents) {
  MetricValidator validator;
  Record report = {{"other", List{Record{}}}};
  postProcess(validator, report, {replaceNeighbours});
  EXPECT_EQ(listText(validator.myLTE.EutraNbrsMeas), "[Waiting for Update: Waiting for Update]");
}

TEST(PostProcessing, AListOfTheWrongTypeKeepsThePreviousContents) {
  MetricValidator validator;
  for (const Value& wrong : {Value("text"), Value(5), Value(Record{{"pci", 1}}), Value(List{Record{}, 5}), Value()}) {
    Record report = {{"list", wrong}};
    postProcess(validator, report, {replaceNeighbours});
    EXPECT_EQ(listText(validator.myLTE.EutraNbrsMeas), "[Waiting for Update: Waiting for Update]") << toText(wrong);
  }
}

TEST(PostProcessing, ASkippedListDoesNotKeepTheOthersFromBeingProcessed) {
  MetricValidator validator;
  Record report = {{"first", 5}, {"list", List{Record{{"pci", 1}}}}};
  postProcess(validator, report, {ReplaceList{"first", receivers}, replaceNeighbours});
  EXPECT_EQ(listText(validator.myUMTS.rXInfo), "[Waiting for Update: Waiting for Update]");
  EXPECT_EQ(listText(validator.myLTE.EutraNbrsMeas), "[pci: 1]");
}

TEST(PostProcessing, TheElementsCodesAreConvertedButTheStoredReportKeepsThem) {
  MetricValidator validator;
  Record report = {{"list", List{Record{{"rsrp", 97}, {"rsrq", 34}}}}};
  postProcess(validator, report, {replaceNeighbours});
  EXPECT_EQ(listText(validator.myLTE.EutraNbrsMeas), "[rsrp: -43, rsrq: -2.5]");
  EXPECT_EQ(toText(report), "[list: [[rsrp: 97, rsrq: 34]]]");
}

TEST(PostProcessing, AnElementTakesTheTimestampOfTheReport) {
  MetricValidator validator;
  Record report = {{"timestamp", "now"}, {"list", List{Record{{"timestamp", 7}, {"pci", 1}}, Record{{"pci", 2}}}}};
  postProcess(validator, report, {replaceNeighbours});
  EXPECT_EQ(listText(validator.myLTE.EutraNbrsMeas), "[timestamp: now, pci: 1][pci: 2, timestamp: now]");
}

TEST(PostProcessing, WithoutATimestampInTheReportTheElementsLoseTheirs) {
  MetricValidator validator;
  Record report = {{"list", List{Record{{"timestamp", 7}, {"pci", 1}}}}};
  postProcess(validator, report, {replaceNeighbours});
  EXPECT_EQ(listText(validator.myLTE.EutraNbrsMeas), "[pci: 1]");
}

TEST(PostProcessing, ASharedEntryIsCopiedIntoEachElementOrRemovedFromIt) {
  MetricValidator validator;
  const Steps steps = {ReplaceList{"rx_info", receivers, Measured::nothing, "connected_mode"}};
  Record with = {{"connected_mode", true}, {"rx_info", List{Record{{"rssi", -60}}, Record{}}}};
  postProcess(validator, with, steps);
  EXPECT_EQ(listText(validator.myUMTS.rXInfo), "[rssi: -60, connected_mode: 1][connected_mode: 1]");
  Record without = {{"rx_info", List{Record{{"connected_mode", false}, {"rssi", -61}}}}};
  postProcess(validator, without, steps);
  EXPECT_EQ(listText(validator.myUMTS.rXInfo), "[rssi: -61]");
}

TEST(PostProcessing, ATemplateTakesTheReportsValuesInItsOwnOrder) {
  MetricValidator validator;
  Record report = {{"s_intersearch", 10},
                   {"s_intrasearch", 9},
                   {"s_qual", 8},
                   {"s_rxlev", 7},
                   {"cell_barred", 5},
                   {"duplex_mode", "FDD"},
                   {"edch_capable", 3},
                   {"hsdpa_capable", 2},
                   {"fach_meas_occ_info_present", 6},
                   {"ims_emergency_support", 1},
                   {"s_search_rat", 11}};
  postProcess(validator, report, {FillTemplate{umtsTemplate}});
  EXPECT_EQ(toText(validator.myUMTS.SelReselCellInfo),
            "[ims_emergency_support: 1, hsdpa_capable: 2, edch_capable: 3, duplex_mode: FDD, cell_barred: 5, "
            "fach_meas_occ_info_present: 6, s_rxlev: 7, s_qual: 8, s_intrasearch: 9, s_intersearch: 10]");
}

TEST(PostProcessing, ATemplateKeyThatTheReportLacksIsRemovedAndStaysRemoved) {
  MetricValidator validator;
  Record lacking = {{"timestamp", "t"}, {"QRxLevMin", -62}};
  postProcess(validator, lacking, {FillTemplate{lteTemplate}});
  EXPECT_EQ(toText(validator.myLTE.SelReselCellInfo), "[timestamp: t, QRxLevMin: -62]");
  Record complete = {{"timestamp", "u"}, {"QRxLevMin", -64}, {"QQualMin", -18}};
  postProcess(validator, complete, {FillTemplate{lteTemplate}});
  EXPECT_EQ(toText(validator.myLTE.SelReselCellInfo), "[timestamp: u, QRxLevMin: -64]");
}

TEST(PostProcessing, AListOfIntegersBecomesItsTextAndIsPrintedAlone) {
  OutputLines output;
  MetricValidator validator;
  Record report = {{"bands", List{std::uint32_t{2}, std::uint32_t{66}}}};
  postProcess(validator, report, {WriteOutIntegers{"bands"}});
  EXPECT_EQ(*report.find("bands"), Value("[2, 66]"));
  EXPECT_EQ(output.take(), Lines{"[2, 66]"});
}

TEST(PostProcessing, AnythingButAListOfIntegersIsLeftAndNotPrinted) {
  OutputLines output;
  MetricValidator validator;
  for (const Value& other : {Value("text"), Value(List{1, "two"}), Value(List{Record{}}), Value(7)}) {
    Record report = {{"bands", other}};
    postProcess(validator, report, {WriteOutIntegers{"bands"}});
    EXPECT_EQ(*report.find("bands"), other);
  }
  Record without;
  postProcess(validator, without, {WriteOutIntegers{"bands"}});
  EXPECT_TRUE(without.empty());
  EXPECT_EQ(output.take(), Lines{});
}

TEST(PostProcessing, ARecordAndAListOfRecordsBecomeTheirTexts) {
  OutputLines output;
  MetricValidator validator;
  Record report = {{"guti", Record{{"mmec", 5}}}, {"tai_list", List{Record{{"tac", 1}}, Record{{"tac", 2}}}}};
  postProcess(validator, report, {WriteOutRecord{"guti"}, WriteOutRecordList{"tai_list"}});
  EXPECT_EQ(*report.find("guti"), Value("[mmec: 5]"));
  EXPECT_EQ(*report.find("tai_list"), Value("[[tac: 1], [tac: 2]]"));
  EXPECT_EQ(output.take(), Lines{});
}

TEST(PostProcessing, EntriesOfOtherTypesAreNotWrittenOut) {
  MetricValidator validator;
  Record report = {{"guti", 5}, {"tai_list", List{7}}};
  postProcess(validator, report, {WriteOutRecord{"guti"}, WriteOutRecordList{"tai_list"}});
  EXPECT_EQ(report, (Record{{"guti", 5}, {"tai_list", List{7}}}));
}

TEST(PostProcessing, AServingCellBandwidthIsHalvedAsAnInteger) {
  MetricValidator validator;
  Record report = {{"dl_bw", std::uint32_t{100}}, {"ul_bw", std::uint32_t{5}}};
  postProcess(validator, report, {Halve{"dl_bw"}, Halve{"ul_bw"}});
  EXPECT_EQ(toText(report), "[dl_bw: 50, ul_bw: 2]");
}

TEST(PostProcessing, ABandwidthBeyond32SignedBitsOrOfAnotherTypeIsLeft) {
  MetricValidator validator;
  Record report = {{"dl_bw", std::uint32_t{4000000000U}}, {"ul_bw", "wide"}};
  postProcess(validator, report, {Halve{"dl_bw"}, Halve{"ul_bw"}, Halve{"absent"}});
  EXPECT_EQ(toText(report), "[dl_bw: 4000000000, ul_bw: wide]");
}

TEST(PostProcessingDeathTest, AnAbsentDictionaryStopsTheProcessAtTheTimestamp) {
  const MetricValidator validator;
  std::optional<Record> absent;
  EXPECT_DEATH(writeOutTimestamp(validator, absent), "a recognised metric has no dictionary");
}

TEST(PostProcessing, ATimestampOfAnyNumberKindBecomesTextAndAnyOtherValueStays) {
  setenv("TZ", "UTC", 1);
  const MetricValidator validator;
  std::optional<Record> report = Record{{"timestamp", std::uint64_t{1700000000000U}}};
  writeOutTimestamp(validator, report);
  EXPECT_EQ(*report->find("timestamp"), Value("2023-11-14 22:13:20 UTC"));
  report = Record{{"timestamp", "already text"}};
  writeOutTimestamp(validator, report);
  EXPECT_EQ(*report->find("timestamp"), Value("already text"));
  report = Record{{"state", 1}};
  writeOutTimestamp(validator, report);
  EXPECT_EQ(*report, (Record{{"state", 1}}));
}

TEST(PostProcessingOfTheValidator, ATimestampOfZeroIsTheStartOf1970InTheDevicesTimeZone) {
  setenv("TZ", "UTC", 1);
  EXPECT_EQ(MetricValidator().formatTimestamp(0), "1970-01-01 00:00:00 UTC");
  setenv("TZ", "EST5", 1);
  EXPECT_EQ(MetricValidator().formatTimestamp(0), "1969-12-31 19:00:00 EST");
}

TEST(PostProcessingOfTheValidator, ATimestampWithMillisecondsShowsItsWholeSecond) {
  setenv("TZ", "UTC", 1);
  EXPECT_EQ(MetricValidator().formatTimestamp(1700000000999.0), "2023-11-14 22:13:20 UTC");
}

}  // namespace
}  // namespace vespscope::test
