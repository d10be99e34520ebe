// The contents of the state holders before any event, and their sharing.
#include <algorithm>
#include <type_traits>
#include <vector>

#include <gtest/gtest.h>

#include "metrics/MetricValidator.h"

namespace vespscope::test {
namespace {

std::vector<std::string> keysOf(const Record& record) {
  std::vector<std::string> keys;
  for (const Entry& entry : record) keys.emplace_back(entry.key.view());
  return keys;
}

void expectEmptyTexts(const Record& record) {
  for (const Entry& entry : record) EXPECT_EQ(entry.value, Value("")) << entry.key.view();
}

const RecordList placeholder = {Record{{"Waiting for Update", "Waiting for Update"}}};

TEST(MetricValidatorHolders, BeforeAnyEventEveryListHoldsOnePlaceholderRecord) {
  const MetricValidator validator;
  const LTE& lte = validator.myLTE;
  for (const RecordList* list : {&lte.EutraNbrs, &lte.RsrpRsrqSinr, &lte.TxPower, &lte.EutraNbrsMeas, &lte.UtraNbrsMeas,
                                 &lte.GeraNbrsMeas, &lte.CAStatusList, &lte.MMCommonInfo}) {
    EXPECT_EQ(*list, placeholder);
  }
  const UMTS& umts = validator.myUMTS;
  for (const RecordList* list : {&umts.rXInfo, &umts.TxPower, &umts.eUtraNbrs, &umts.utraNbrs, &umts.geraNbrs,
                                 &umts.eUtraNbrMeas, &umts.utraNbrMeas, &umts.geraNbrMeas}) {
    EXPECT_EQ(*list, placeholder);
  }
  const GSM& gsm = validator.myGSM;
  for (const RecordList* list : {&gsm.eUtraNbrMeas, &gsm.utraNbrMeas, &gsm.geraNbrMeas}) EXPECT_EQ(*list, placeholder);
  EXPECT_EQ(validator.myCommon.activeBearer, placeholder);
  EXPECT_EQ(validator.myCommon.simContents, placeholder);
}

TEST(MetricValidatorHolders, BeforeAnyEventTheImsiSaysComeBackLater) {
  EXPECT_EQ(MetricValidator().myLTE.IMSI, Value("Come Back Later"));
}

TEST(MetricValidatorHolders, BeforeAnyEventEveryRecordIsAbsentAndSoIsTheIdentifier) {
  const MetricValidator validator;
  EXPECT_FALSE(validator.metricID);
  for (const auto member : {&MetricValidator::myLTERRCStateDict,          &MetricValidator::myLTECDRXConfigDict,
                            &MetricValidator::myLTESCellInfoDict,         &MetricValidator::myLTESCellMeasDict,
                            &MetricValidator::myLTESelReselDict,          &MetricValidator::myLTERsrpRsrqSinrDict,
                            &MetricValidator::myLTECompCarrDict,          &MetricValidator::myLTETxPowerDict,
                            &MetricValidator::myLTEInterRatMeasDict,      &MetricValidator::myLTEIntraRatMeasDict,
                            &MetricValidator::myLTECAStatusDict,          &MetricValidator::myLTEEMMContextDict,
                            &MetricValidator::myCellularMMCommonInfoDict, &MetricValidator::myCellularActiveBearerDict,
                            &MetricValidator::myGMMContextDict,           &MetricValidator::myMMContextDict,
                            &MetricValidator::myUMTSRRCStateDict,         &MetricValidator::myUMTSRRCConfigDict,
                            &MetricValidator::myUMTSCellInfoDict,         &MetricValidator::myUMTSCellMeasDict,
                            &MetricValidator::myUMTSTxPowerDict,          &MetricValidator::myUMTSSelReselDict,
                            &MetricValidator::myUMTSNbrMeasDict,          &MetricValidator::myGSMScellInfoDict,
                            &MetricValidator::myGSMIdleConfigInfoDict,    &MetricValidator::myGSMIdleScellMeasDict,
                            &MetricValidator::myGSMConnRfMeasDict,        &MetricValidator::myGSMNbrMeasDict,
                            &MetricValidator::myGSMGPRSConfigDict,        &MetricValidator::mySIMFileInfoDict}) {
    EXPECT_FALSE((validator.*member).has_value());
  }
}

TEST(MetricValidatorHolders, TheLteReselectionTemplateHasItsKeysInOrderWithEmptyTexts) {
  const Record record = LTE().SelReselCellInfo;
  EXPECT_EQ(keysOf(record),
            (std::vector<std::string>{
                "timestamp", "ims_emergency_support", "ac_barring_for_emergency", "mo_signalling_ac_barring_factor",
                "mo_signalling_ac_barring_time", "mo_signalling_ac_barring_for_special_ac", "mo_data_ac_barring_factor",
                "mo_data_ac_barring_time", "mo_data_ac_barring_for_special_ac", "QRxLevMin", "QQualMin",
                "S_non_intra_search_P", "S_non_intra_search_Q", "S_intra_search_P", "S_intra_search_Q",
                "Thresh_serving_lowP", "Thresh_serving_lowQ", "priority_operating_freq"}));
  expectEmptyTexts(record);
}

TEST(MetricValidatorHolders, TheUmtsReselectionTemplateHasItsKeysInOrderWithEmptyTexts) {
  const Record record = UMTS().SelReselCellInfo;
  EXPECT_EQ(keysOf(record), (std::vector<std::string>{"ims_emergency_support", "hsdpa_capable", "edch_capable",
                                                      "duplex_mode", "cell_barred", "fach_meas_occ_info_present",
                                                      "s_rxlev", "s_qual", "s_intrasearch", "s_intersearch"}));
  expectEmptyTexts(record);
}

TEST(MetricValidatorHolders, ACopyIsASnapshotThatLaterChangesDoNotReach) {
  static_assert(std::is_copy_assignable_v<LTE> && std::is_copy_assignable_v<UMTS> && std::is_copy_assignable_v<GSM> &&
                std::is_copy_assignable_v<Common>);
  MetricValidator validator;
  const LTE snapshot = validator.myLTE;
  validator.myLTE.EutraNbrs = {Record{{"earfcn", 5780}}};
  EXPECT_EQ(snapshot.EutraNbrs, placeholder);
}

TEST(MetricValidatorHolders, EveryFieldCanBeWrittenAndModifiedInPlaceFromOutside) {
  MetricValidator validator;
  validator.myLTE.EutraNbrs.push_back(Record{{"earfcn", 700}});
  EXPECT_EQ(validator.myLTE.EutraNbrs.size(), 2U);
  validator.myLTESCellMeasDict = Record{{"rsrp", -90}};
  validator.myLTESCellMeasDict->set("rsrp", -91);
  EXPECT_EQ(*validator.myLTESCellMeasDict->find("rsrp"), Value(-91));
}

TEST(MetricValidatorHoldersShared, TheIdentifiersAreThoseOfTheMetrics) {
  const MetricValidator validator;
  const std::vector<std::pair<std::int64_t, std::int64_t>> expected = {
      {validator.K_LTE_CDRX_CONFIG, 3952152},     {validator.K_LTE_RRC_STATE, 3952132},
      {validator.K_LTE_SCELL_INFO, 3948738},      {validator.K_LTE_RLF, 3952165},
      {validator.K_LTE_SEL_RESEL_INFO, 3986190},  {validator.K_LTE_SCELL_MEAS, 3986177},
      {validator.K_LTE_TX_POWER, 3986178},        {validator.K_LTE_RSRP_RSRQ_SINR, 3952490},
      {validator.K_LTE_COMPCARR_INFO, 3986187},   {validator.K_LTE_CA_STATUS, 3986195},
      {validator.K_LTE_INTERRAT_MEAS, 3986192},   {validator.K_LTE_INTRARAT_MEAS, 3986191},
      {validator.K_CELLULAR_MM_INFO, 3986697},    {validator.K_CELLULAR_ACTIVE_BEARER, 3986701},
      {validator.K_LTE_EMM_CTXT, 3986700},        {validator.K_CELLULAR_MM_CTXT, 3986698},
      {validator.K_CELLULAR_GMM_CTXT, 3986699},   {validator.K_UMTS_RRC_STATE, 3985682},
      {validator.K_UMTS_RRC_CONFIG, 3985683},     {validator.K_UMTS_SCELL_INFO, 3944460},
      {validator.K_UMTS_SCELL_MEAS, 3985666},     {validator.K_UMTS_TX_POWER, 3985667},
      {validator.K_UMTS_SEL_RESEL_INFO, 3985668}, {validator.K_UMTS_NCELL_MEAS, 3985669},
      {validator.K_GSM_SCELL_INFO, 3943948},      {validator.K_GSM_IDLE_CONFIG, 3985409},
      {validator.K_GSM_IDLE_SCELL_MEAS, 3985410}, {validator.K_GSM_CS_RF_MEAS, 3985411},
      {validator.K_GSM_NCELL_MEAS, 3985417},      {validator.K_GSM_GPRS_CONFIG, 3985420},
      {validator.K_SIM_FILE_INFO, 3932179},
  };
  ASSERT_EQ(expected.size(), metricRows.size());
  for (const auto& [actual, number] : expected) {
    EXPECT_EQ(actual, number);
    EXPECT_EQ(1, std::count_if(metricRows.begin(), metricRows.end(),
                               [&wanted = actual](const MetricRow& row) { return row.identifier() == wanted; }));
  }
}

TEST(MetricValidatorHoldersShared, TheEventKeysAreTheWrappersTexts) {
  const MetricValidator validator;
  EXPECT_EQ(validator.metricIDKey, "kKeyMetricID");
  EXPECT_EQ(validator.payloadKey, "kKeyPayload");
  EXPECT_EQ(validator.profileIDKey, "kKeyProfileID");
}

TEST(MetricValidatorHoldersShared, TheBandwidthLookupHoldsTheSixChannelBandwidths) {
  EXPECT_EQ(MetricValidator().dlbwlookup,
            (std::map<std::int32_t, float>{{0, 1.4F}, {1, 3.0F}, {2, 5.0F}, {3, 10.0F}, {4, 15.0F}, {5, 20.0F}}));
}

}  // namespace
}  // namespace vespscope::test
