// Fields whose names, numbers or kinds are easy to get wrong.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/gsm/KCellularGsmCsRfMeasurement.h"
#include "messages/gsm/KCellularGsmGprsConfig.h"
#include "messages/gsm/KCellularGsmIdleConfig.h"
#include "messages/gsm/KCellularGsmScellInfo.h"
#include "messages/lte/KCellularEmmContext.h"
#include "messages/lte/KCellularLteRrcState.h"
#include "messages/lte/KCellularLteRsrpRsrqSinr.h"
#include "messages/lte/KCellularLteSelReselCellInfo.h"
#include "messages/lte/NbrEutra.h"
#include "messages/lte/SecondaryComponentCarrier.h"
#include "messages/mobility/BearerContext.h"
#include "messages/mobility/KCellularActivatedBearerContexts.h"
#include "messages/mobility/KCellularGmmContext.h"
#include "messages/mobility/KCellularMmContext.h"
#include "messages/mobility/RoutingAreaId.h"
#include "messages/umts/KCellularWcdmaCellInfo.h"
#include "messages/umts/KCellularWcdmaRrcConnectionState.h"
#include "messages/umts/KCellularWcdmaSelReselCellInfo.h"

namespace vespscope::test {
namespace {

// The dictionary of a message of which only the field of `setter` is set, to `value`.
template <class Message>
std::string shown(void (Message::*setter)(std::int32_t), std::int32_t value) {
  Message message;
  (message.*setter)(value);
  const Record dictionary = message.dictionaryRepresentation();
  return dictionary.size() == 1 ? toText(dictionary.at(0).value) : "";
}

std::string unknown(std::int32_t value) { return "(unknown: " + std::to_string(value) + ")"; }

TEST(MessageSchemaLte, RrcState7HasNoNameAndCausesHaveTwoFarOnes) {
  using State = KCellularLteRrcState;
  EXPECT_EQ(shown(&State::setState, 7), "(unknown: 7)");
  EXPECT_EQ(shown(&State::setCause, 254), "KLTE_RRC_CAUSE_NO_SERVICE");
  EXPECT_EQ(shown(&State::setCause, 255), "KLTE_RRC_CAUSE_NA");
  EXPECT_EQ(shown(&State::setCause, 30), "KLTE_RRC_CAUSE_REEST_OTHER_FAIL_INTEG_CHECK");
  for (std::int32_t cause = 31; cause <= 253; ++cause) EXPECT_EQ(shown(&State::setCause, cause), unknown(cause));
}

TEST(MessageSchemaLte, FrameType3HasNoNameAnd2IsInvalid) {
  EXPECT_EQ(shown(&NbrEutra::setFrameType, 3), "(unknown: 3)");
  EXPECT_EQ(shown(&NbrEutra::setFrameType, 2), "INVALID");
}

TEST(MessageSchemaLte, AverageAndInstantValuesAreOneRecordAndAList) {
  KCellularLteRsrpRsrqSinr message;
  const auto values = [](std::uint32_t cell) {
    auto result = std::make_shared<RsrpRsrqSinr>();
    result->setPhyCellId(cell);
    return result;
  };
  message.setAvgValues(values(9));
  for (const std::uint32_t cell : {1U, 2U, 3U}) message.addInstValues(values(cell));
  EXPECT_EQ(message.encoded(), hex("72 02 08 09 7a 02 08 01 7a 02 08 02 7a 02 08 03"));
  const Record dictionary = message.dictionaryRepresentation();
  ASSERT_NE(dictionary.find("avg_values"), nullptr);
  EXPECT_NE(dictionary.find("avg_values")->asRecord(), nullptr);
  EXPECT_EQ(toText(dictionary),
            "[avg_values: [phy_cell_id: 9], inst_values: [[phy_cell_id: 1], [phy_cell_id: 2], [phy_cell_id: 3]]]");
}

TEST(MessageSchemaLte, SecondaryCarriersHaveThreeStates) {
  using Carrier = SecondaryComponentCarrier;
  EXPECT_EQ(shown(&Carrier::setState, 0), "SCC_STATE_DECONFIGURED");
  EXPECT_EQ(shown(&Carrier::setState, 1), "SCC_STATE_CONFIGURED_DEACTIVATED");
  EXPECT_EQ(shown(&Carrier::setState, 2), "SCC_STATE_ACTIVATED");
  EXPECT_EQ(shown(&Carrier::setState, 3), "(unknown: 3)");
}

TEST(MessageSchemaLte, TheEpsUpdateStatusIsNotInAlphabeticalOrder) {
  EXPECT_EQ(shown(&KCellularEmmContext::setUpdateStatus, 0), "EPS_STATUS_UPDATED");
  EXPECT_EQ(shown(&KCellularEmmContext::setUpdateStatus, 1), "EPS_STATUS_NOT_UPDATED");
  EXPECT_EQ(shown(&KCellularEmmContext::setUpdateStatus, 2), "EPS_STATUS_ROAMING_NOT_ALLOWED");
}

TEST(MessageSchemaLte, AnEmptyListOfBandsWritesNothing) {
  KCellularLteSelReselCellInfo message;
  message.addMultiBandInfo(3);
  message.addMultiBandInfo(200);
  EXPECT_EQ(message.encoded(), hex("12 03 03 c8 01"));
  message.clearMultiBandInfos();
  EXPECT_TRUE(message.encoded().empty());
  EXPECT_TRUE(message.dictionaryRepresentation().empty());
}

TEST(MessageSchemaUmts, ConnectionStatesAndCausesEndWhereTheyEnd) {
  using State = KCellularWcdmaRrcConnectionState;
  EXPECT_EQ(shown(&State::setState, 10), "KWCDMA_RRC_CONN_STATE_SCRI_SENT");
  EXPECT_EQ(shown(&State::setState, 11), "(unknown: 11)");
  for (std::int32_t cause = 0; cause <= 22; ++cause)
    EXPECT_NE(shown(&State::setEstablishmentCause, cause), unknown(cause));
  EXPECT_EQ(shown(&State::setEstablishmentCause, 23), "(unknown: 23)");
  for (std::int32_t cause = 0; cause <= 17; ++cause) EXPECT_NE(shown(&State::setReleaseCause, cause), unknown(cause));
  EXPECT_EQ(shown(&State::setReleaseCause, 18), "(unknown: 18)");
}

TEST(MessageSchemaUmts, TheBandEnumerationIsSharedWithGsmAndSkipsTwo) {
  EXPECT_EQ(shown(&KCellularWcdmaCellInfo::setWcdmaBand, 2), "(unknown: 2)");
  EXPECT_EQ(shown(&KCellularGsmScellInfo::setGsmBand, 2), "(unknown: 2)");
  for (std::int32_t band = 0; band <= 170; ++band) {
    EXPECT_EQ(shown(&KCellularWcdmaCellInfo::setWcdmaBand, band), shown(&KCellularGsmScellInfo::setGsmBand, band));
  }
  EXPECT_EQ(shown(&KCellularWcdmaCellInfo::setWcdmaBand, 80), "SYS_BAND_WCDMA_I_IMT_2000");
}

TEST(MessageSchemaUmts, BandsAreField5AndFields14To20BelongToNone) {
  KCellularWcdmaSelReselCellInfo message;
  message.addMultiBandInfo(1);
  EXPECT_EQ(message.encoded(), hex("2a 01 01"));
  // 14 to 18 and 20 as varints; 19 is a metric tag and tested as one.
  EXPECT_EQ(
      textOf(*readFrom<KCellularWcdmaSelReselCellInfo>("70 01 78 02 80 01 03 88 01 04 90 01 05 a0 01 06 a8 01 07")),
      "[s_cell_prio: 7]");
}

TEST(MessageSchemaUmts, TheDuplexModeIsFddOrTdd) {
  using Info = KCellularWcdmaSelReselCellInfo;
  EXPECT_EQ(shown(&Info::setDuplexMode, 0), "FDD");
  EXPECT_EQ(shown(&Info::setDuplexMode, 1), "TDD");
  EXPECT_EQ(shown(&Info::setDuplexMode, 2), "(unknown: 2)");
  EXPECT_EQ(shown(&Info::setDuplexMode, -1), "(unknown: -1)");
}

TEST(MessageSchemaGsm, TheCellStateStartsAtOne) {
  EXPECT_EQ(shown(&KCellularGsmScellInfo::setState, 1), "DEDICATED_STATE");
  EXPECT_EQ(shown(&KCellularGsmScellInfo::setState, 2), "NON_DEDICATED_STATE");
  EXPECT_EQ(shown(&KCellularGsmScellInfo::setState, 0), "(unknown: 0)");
}

TEST(MessageSchemaGsm, TransmitPowersAreZigZagAndPacked) {
  KCellularGsmCsRfMeasurement message;
  message.addCsTxPwr(-1);
  message.addCsTxPwr(1);
  EXPECT_EQ(message.encoded(), hex("2a 02 01 02"));
}

TEST(MessageSchemaGsm, AnIndexAtOrBeyondTheCountOfTransmitPowersRaisesTheRangeException) {
  KCellularGsmCsRfMeasurement message;
  message.addCsTxPwr(-1);
  EXPECT_EQ(message.csTxPwrAtIndex(0), -1);
  const auto reason = [&message](std::size_t index) -> std::string {
    try {
      static_cast<void>(message.csTxPwrAtIndex(index));
    } catch (const std::out_of_range& error) {
      return error.what();
    }
    return "none";
  };
  EXPECT_EQ(reason(1), "idx (1) is out of range (1)");
  EXPECT_EQ(reason(18446744073709551615U), "idx (18446744073709551615) is out of range (1)");
  message.clearCsTxPwrs();
  EXPECT_EQ(reason(0), "idx (0) is out of range (0)");
}

TEST(MessageSchemaGsm, ScellInfoUsesNoTags2And3And12) {
  EXPECT_EQ(textOf(*readFrom<KCellularGsmScellInfo>("10 01 18 02 60 03 20 ea 01")), "[mcc: 234]");
}

TEST(MessageSchemaGsm, FlagsOfTheIdleConfigurationAreNumbersAndThoseOfGprsAreFlags) {
  KCellularGsmIdleConfig idle;
  idle.setAttachAllowed(2);
  idle.setCbchSupported(1);
  EXPECT_EQ(textOf(idle), "[attach_allowed: 2, cbch_supported: 1]");
  EXPECT_TRUE(std::holds_alternative<std::uint32_t>(idle.dictionaryRepresentation().find("cbch_supported")->data()));
  KCellularGsmGprsConfig gprs;
  gprs.setGprsSup(true);
  gprs.setSpPgCy(false);
  gprs.setExtUplTbfSupported(true);
  const Record dictionary = gprs.dictionaryRepresentation();
  EXPECT_EQ(dictionary.find("gprs_sup")->asBool(), true);
  EXPECT_EQ(dictionary.find("sp_pg_cy")->asBool(), false);
  EXPECT_EQ(dictionary.find("ext_upl_tbf_supported")->asBool(), true);
}

TEST(MessageSchemaMobility, TheUpdateStatusStartsAtOneInOneContextAndAtZeroInTheOther) {
  EXPECT_EQ(shown(&KCellularMmContext::setUpdateStatus, 0), "(unknown: 0)");
  EXPECT_EQ(shown(&KCellularMmContext::setUpdateStatus, 1), "STATUS_UPDATED");
  EXPECT_EQ(shown(&KCellularMmContext::setUpdateStatus, 4), "STATUS_UPDATE_DISABLED");
  EXPECT_EQ(shown(&KCellularMmContext::setUpdateStatus, 5), "(unknown: 5)");
  EXPECT_EQ(shown(&KCellularGmmContext::setUpdateStatus, 0), "GPRS_STATUS_UPDATED");
  EXPECT_EQ(shown(&KCellularGmmContext::setUpdateStatus, 2), "GPRS_STATUS_ROAMING_NOT_ALLOWED");
  EXPECT_EQ(shown(&KCellularGmmContext::setUpdateStatus, 3), "(unknown: 3)");
}

TEST(MessageSchemaMobility, RejectCausesAreSparse) {
  for (const std::int32_t cause : {1, 24, 64, 94, 102, 110, 112}) {
    EXPECT_EQ(shown(&KCellularMmContext::setRejectCause, cause), unknown(cause));
    EXPECT_EQ(shown(&KCellularGmmContext::setRejectCause, cause), unknown(cause));
  }
  for (const std::int32_t cause : {95, 96, 97, 98, 99, 100, 101, 111}) {
    EXPECT_NE(shown(&KCellularMmContext::setRejectCause, cause), unknown(cause));
    EXPECT_NE(shown(&KCellularGmmContext::setRejectCause, cause), unknown(cause));
  }
}

TEST(MessageSchemaMobility, RoutingAreaIdHasNoTag2) {
  EXPECT_EQ(textOf(*readFrom<RoutingAreaId>("0a 01 13 10 07 18 08 20 09")), "[encoded_plmn: <13>, lac: 8, rac: 9]");
}

TEST(MessageSchemaMobility, APdpTypeOf8HasNoName) {
  EXPECT_EQ(shown(&BearerContext::setPdpType, 7), "PDP_TYPE_NONE");
  EXPECT_EQ(shown(&BearerContext::setPdpType, 8), "(unknown: 8)");
  EXPECT_EQ(shown(&BearerContext::setPrimaryDnsType, 8), "(unknown: 8)");
  EXPECT_EQ(shown(&BearerContext::setSecondaryDnsType, 8), "(unknown: 8)");
}

TEST(MessageSchemaMobility, TheBearerCountIsIndependentOfTheListAndTheListKeepsItsPlural) {
  KCellularActivatedBearerContexts message;
  message.setBearerContextCount(5);
  auto bearer = std::make_shared<BearerContext>();
  bearer->setCid(1);
  message.addBearerContexts(bearer);
  EXPECT_EQ(message.bearerContextsCount(), 1U);
  EXPECT_EQ(message.bearerContextsAtIndex(0), bearer);
  EXPECT_EQ(textOf(message), "[bearer_context_count: 5, bearer_contexts: [[cid: 1]]]");
  message.clearBearerContexts();
  EXPECT_EQ(textOf(message), "[bearer_context_count: 5]");
}

}  // namespace
}  // namespace vespscope::test
