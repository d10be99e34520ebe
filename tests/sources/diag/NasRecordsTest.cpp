// NAS records from literal bytes, and the events made from them.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Mapping.h"
#include "sources/diag/NasRecords.h"
#include "sources/nas/LiteralMessages.h"

namespace vespscope::test {
namespace {

using namespace sources;
using namespace sources::diag;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

std::string withHead(std::string_view message) { return "01 09 05 00 " + std::string(message); }

// The header of a message of GSM and UMTS: direction, length.
std::string withLength(std::string_view message) {
  const Bytes bytes = bytesOf(message);
  std::array<char, 32> head{};
  std::snprintf(head.data(), head.size(), "01 %02x 00 00 00 ", static_cast<unsigned>(bytes.size()));
  return head.data() + std::string(message);
}

TEST(NasRecords, TheEmmStateHasTheGutiInLittleEndian) {
  const auto record =
      std::get<EmmStateRecord>(emmStateOf(bytesOf("02 03 04 01 13 00 14 01 06 62 f2 10 20 ff 0e 04 03 02 c1")));
  EXPECT_EQ(record.state, 3);
  EXPECT_EQ(record.substate, 0x0104);
  EXPECT_EQ(record.guti, (nas::Guti{*radio::Plmn::fromText("26201"), 0xFF20, 14, 0xC1020304}));
  const auto without =
      std::get<EmmStateRecord>(emmStateOf(bytesOf("02 01 00 00 ff ff ff 00 00 ff ff ff ff ff ff ff ff ff ff")));
  EXPECT_FALSE(without.guti);
}

TEST(NasRecords, WrongVersionsAndCutRecordsAreFaults) {
  EXPECT_EQ(std::get<RecordFault>(emmStateOf(bytesOf("03 03"))), RecordFault::unknownVersion);
  EXPECT_EQ(std::get<RecordFault>(emmStateOf(Bytes(18, 2))), RecordFault::tooShort);
  EXPECT_EQ(std::get<RecordFault>(emmStateOf({})), RecordFault::tooShort);
  EXPECT_EQ(std::get<RecordFault>(bearerStateOf(bytesOf("02"))), RecordFault::unknownVersion);
  EXPECT_EQ(std::get<RecordFault>(bearerStateOf(Bytes(11, 1))), RecordFault::tooShort);
  EXPECT_EQ(std::get<RecordFault>(bearerStateOf(bytesOf("01 00 04 02 00 00 00 00 00 00 00 09"))),
            RecordFault::outOfRange);
  EXPECT_EQ(std::get<RecordFault>(epsMessageOf(bytesOf("02 09 05 00 07"))), RecordFault::unknownVersion);
  EXPECT_EQ(std::get<RecordFault>(epsMessageOf(bytesOf("01 09 05 00"))), RecordFault::tooShort);
  EXPECT_EQ(std::get<RecordFault>(gprsMessageOf(bytesOf("00 02 00 00 00 08"))), RecordFault::tooShort);
  EXPECT_EQ(std::get<RecordFault>(gprsMessageOf(bytesOf("00 ff ff ff ff 08"))), RecordFault::tooShort);
  EXPECT_EQ(std::get<RecordFault>(mobilityStateOf(bytesOf("03 00"))), RecordFault::tooShort);
  EXPECT_EQ(std::get<RecordFault>(gmmRegistrationOf(bytesOf("00 00 13 00 62 1b e9"))), RecordFault::tooShort);
}

class NasRecordsMapping : public MappingTest {};

TEST_F(NasRecordsMapping, AnAttachIsFollowedFromItsRequestToItsEnd) {
  EXPECT_THAT(take(emmMessageOutCode, withHead(literal::attachRequest)),
              ElementsAre("KCellularEmmContext[timestamp: 1000, reg_status: KREG_STATUS_REGISTRATION_IN_PROGRESS, "
                          "ue_op_mode: EPS_UE_OP_MODE_CSPS_MODE_1, reg_proc: EMM_PROC_ATTACH_COMB]"));
  EXPECT_THAT(
      take(emmMessageInCode, withHead(literal::attachAccept), 1200),
      ElementsAre(
          "KCellularEmmContext[timestamp: 1200, reg_status: KREG_STATUS_NORMAL_SERVICE, update_status: "
          "EPS_STATUS_UPDATED, ue_op_mode: EPS_UE_OP_MODE_CSPS_MODE_1, tai_list: [[encoded_plmn: <62 f2 10>, tac: "
          "4660]], guti: [mmegi: 32769, mmec: 2, m_tmsi: 3221225473], reject_cause: EMM_CAUSE_NO_CAUSE, reg_proc: "
          "EMM_PROC_NO_PROC, t3412_dur_s: 7200, is_ims_voice_supported: 1, is_emerg_bearer_supported: 0]",
          "KCellularMmContext[timestamp: 1200, reg_status: KREG_STATUS_NORMAL_SERVICE, update_status: STATUS_UPDATED, "
          "lai: [encoded_plmn: <62 f2 10>, lac: 10000], tmsi: 3489660930, proc_failure_cause: "
          "KNAS_MM_PROC_FAILURE_CAUSE_NONE, reject_cause: KNAS_MM_REJ_CAUSE_NONE, is_combined_proc: 1]",
          "KCellularMmCommonInfo[timestamp: 1200, eplmn_list: [[encoded_plmn: <62 f2 20>]]]",
          "KCellularActivatedBearerContexts[timestamp: 1200, bearer_context_count: 1, bearer_contexts: [[nsapi: 5, "
          "apn: internet, pdp_type: PDP_TYPE_IPv4_PDN, pdp_addr: <0a 01 02 03>, primary_dns_type: PDP_TYPE_IPv4, "
          "primary_dns_addr: <c0 00 02 35>, secondary_dns_type: PDP_TYPE_IPv4, secondary_dns_addr: <c6 33 64 "
          "35>]]]"));
  // The modem repeats the bearer's message in its own record, and reports that the phone is registered.
  EXPECT_THAT(take(esmMessageInCode, withHead(literal::activateDefault), 1210), IsEmpty());
  EXPECT_THAT(take(emmStateCode, "02 03 00 00 62 f2 10 01 06 62 f2 10 01 80 02 01 00 00 c0", 1220), IsEmpty());
  EXPECT_THAT(take(emmStateCode, "02 01 00 00 ff ff ff 00 00 ff ff ff ff ff ff ff ff ff ff", 1300),
              ElementsAre(HasSubstr("reg_status: KREG_STATUS_AT_NOT_REGISTERED"),
                          "KCellularActivatedBearerContexts[timestamp: 1300, bearer_context_count: 0]"));
}

TEST_F(NasRecordsMapping, ARejectedUpdateGivesItsCauseAndWhatThePhoneForgets) {
  take(emmMessageInCode, withHead(literal::updateAccept));
  EXPECT_THAT(take(emmMessageOutCode, withHead(literal::updateRequest), 1100),
              ElementsAre(AllOf(HasSubstr("KREG_STATUS_REGISTRATION_IN_PROGRESS"), HasSubstr("EMM_PROC_TAU_COMB"),
                                HasSubstr("EPS_UE_OP_MODE_CSPS_MODE_2"))));
  EXPECT_THAT(take(emmMessageInCode, withHead("07 4b 0f"), 1200),
              ElementsAre("KCellularEmmContext[timestamp: 1200, reg_status: KREG_STATUS_REGISTRATION_FAILURE, "
                          "update_status: EPS_STATUS_ROAMING_NOT_ALLOWED, ue_op_mode: EPS_UE_OP_MODE_CSPS_MODE_2, "
                          "reject_cause: EMM_CAUSE_NO_SUITABLE_CELLS_IN_TRACKING_AREA, reg_proc: EMM_PROC_NO_PROC, "
                          "t3412_dur_s: 3240, is_ims_voice_supported: 1, is_emerg_bearer_supported: 1]"));
  EXPECT_THAT(take(emmMessageInCode, withHead("07 44 16"), 1300),
              ElementsAre(AllOf(HasSubstr("EMM_CAUSE_CONGESTION"), Not(HasSubstr("update_status")))));
}

TEST_F(NasRecordsMapping, TheStatesThatTheModemReportsAreTheProceduresOfThePhone) {
  const auto stateOf = [&](const std::string& state, std::int64_t time) {
    return take(emmStateCode, "02 " + state + " ff ff ff 00 00 ff ff ff ff ff ff ff ff ff ff", time);
  };
  EXPECT_THAT(stateOf("03 00 00", 1000),
              ElementsAre("KCellularEmmContext[timestamp: 1000, reg_status: KREG_STATUS_NORMAL_SERVICE, reg_proc: "
                          "EMM_PROC_NO_PROC]"));
  EXPECT_THAT(stateOf("05 00 00", 1100), ElementsAre(HasSubstr("NORMAL_SERVICE, reg_proc: EMM_PROC_SERV_REQ]")));
  // The message itself is not reported again.
  EXPECT_THAT(take(emmMessageOutCode, withHead("c7 11 9b d4"), 1101), IsEmpty());
  EXPECT_THAT(stateOf("04 00 00", 1200), ElementsAre(HasSubstr("KREG_STATUS_REGISTRATION_IN_PROGRESS")));
  // The meaning of other substates is unknown.
  EXPECT_THAT(stateOf("03 03 00", 1300),
              ElementsAre("KCellularEmmContext[timestamp: 1300, reg_proc: EMM_PROC_NO_PROC]"));
}

TEST_F(NasRecordsMapping, BearersComeAndGoWithTheModemsStates) {
  EXPECT_THAT(take(bearerStateCode, "01 00 05 02 00 00 00 00 08 05 05 09 ff ff ff ff 00 00 00 00"),
              ElementsAre("KCellularActivatedBearerContexts[timestamp: 1000, bearer_context_count: 1, bearer_contexts: "
                          "[[nsapi: 5]]]"));
  EXPECT_THAT(take(esmMessageInCode, withHead("62 00 c5 05 01 01 03 21 31 00"), 1100),
              ElementsAre(HasSubstr("bearer_contexts: [[nsapi: 5], [nsapi: 6]]")));
  EXPECT_THAT(take(bearerStateCode, "01 00 05 01 00 00 00 00 08 05 05 09", 1200), IsEmpty());
  // The dedicated bearer is removed with the other one.
  EXPECT_THAT(take(bearerStateCode, "01 00 05 00 00 00 00 00 08 05 05 09", 1300),
              ElementsAre("KCellularActivatedBearerContexts[timestamp: 1300, bearer_context_count: 0]"));
}

TEST_F(NasRecordsMapping, ADeactivatedBearerIsGone) {
  take(esmMessageInCode, withHead(literal::activateDefault));
  EXPECT_THAT(take(esmMessageInCode, withHead("52 00 cd 24"), 1100),
              ElementsAre("KCellularActivatedBearerContexts[timestamp: 1100, bearer_context_count: 0]"));
  EXPECT_THAT(take(esmMessageOutCode, withHead("52 00 ce"), 1110), IsEmpty());
}

TEST_F(NasRecordsMapping, ThePacketDomainIsFollowedInGsmAndUmts) {
  EXPECT_THAT(take(gprsMessageCode, withLength(literal::gmmAttachRequest)),
              ElementsAre("KCellularGmmContext[timestamp: 1000, reg_status: KREG_STATUS_REGISTRATION_IN_PROGRESS, "
                          "reg_proc: KNAS_MM_REG_PROC_COMBINED_ATTACH]"));
  EXPECT_THAT(
      take(gprsMessageCode, withLength(literal::gmmAttachAccept), 1100),
      ElementsAre("KCellularMmContext[timestamp: 1100, reg_status: KREG_STATUS_NORMAL_SERVICE, update_status: "
                  "STATUS_UPDATED, lai: [encoded_plmn: <13 00 62>, lac: 7145], tmsi: 3489660930, proc_failure_cause: "
                  "KNAS_MM_PROC_FAILURE_CAUSE_NONE, reject_cause: KNAS_MM_REJ_CAUSE_NONE, is_combined_proc: 1]",
                  "KCellularGmmContext[timestamp: 1100, reg_status: KREG_STATUS_NORMAL_SERVICE, update_status: "
                  "GPRS_STATUS_UPDATED, rai: [encoded_plmn: <13 00 62>, lac: 7145, rac: 18], p_tmsi: 3221225473, "
                  "t3312_dur_s: 3240, proc_failure_cause: KNAS_MM_PROC_FAILURE_CAUSE_NONE, reject_cause: "
                  "KNAS_MM_REJ_CAUSE_MSC_OUT_OF_REACH, reg_proc: KNAS_MM_REG_PROC_PROC_NONE]",
                  "KCellularMmCommonInfo[timestamp: 1100, eplmn_list: [[encoded_plmn: <62 f2 20>]]]"));
  EXPECT_THAT(take(gprsMessageCode, withLength("08 0b 0a"), 1200),
              ElementsAre(AllOf(HasSubstr("KREG_STATUS_REGISTRATION_FAILURE"),
                                HasSubstr("KNAS_MM_PROC_FAILURE_CAUSE_REJECTED_BY_NW"),
                                HasSubstr("KNAS_MM_REJ_CAUSE_IMPLICITLY_DET"))));
  EXPECT_THAT(
      take(gprsMessageCode, withLength("05 04 0d"), 1300),
      ElementsAre(AllOf(HasSubstr("KCellularMmContext"), HasSubstr("KNAS_MM_REJ_CAUSE_ROM_NOT_ALLOWED_IN_LA"))));
}

TEST_F(NasRecordsMapping, APacketContextNeedsItsRequestAndItsAnswer) {
  EXPECT_THAT(take(gprsMessageCode, withLength(literal::activateContextRequest)), IsEmpty());
  EXPECT_THAT(take(gprsMessageCode, withLength(literal::activateContextAccept), 1100),
              ElementsAre("KCellularActivatedBearerContexts[timestamp: 1100, bearer_context_count: 1, bearer_contexts: "
                          "[[nsapi: 5, apn: internet, pdp_type: PDP_TYPE_IPv4, pdp_addr: <0a 01 02 03>, "
                          "primary_dns_type: PDP_TYPE_IPv4, primary_dns_addr: <c0 00 02 35>]]]"));
  EXPECT_THAT(take(gprsMessageCode, withLength(literal::activateContextAccept), 1200), IsEmpty());
  EXPECT_THAT(take(gprsMessageCode, withLength("0a 46 24"), 1300),
              ElementsAre("KCellularActivatedBearerContexts[timestamp: 1300, bearer_context_count: 0]"));
}

TEST_F(NasRecordsMapping, UpdateStatusesAndTheRoutingAreaOfTheModemAreReported) {
  EXPECT_THAT(take(gmmStateCode, "03 00 01"),
              ElementsAre("KCellularGmmContext[timestamp: 1000, update_status: GPRS_STATUS_NOT_UPDATED]"));
  EXPECT_THAT(take(mmStateCode, "13 00 00"),
              ElementsAre("KCellularMmContext[timestamp: 1000, update_status: STATUS_UPDATED]"));
  EXPECT_THAT(take(mmStateCode, "13 00 02"),
              ElementsAre("KCellularMmContext[timestamp: 1000, update_status: STATUS_ROAMING_NOT_ALLOWED]"));
  EXPECT_THAT(take(mmStateCode, "13 00 07"), ElementsAre("KCellularMmContext[timestamp: 1000]"));
  EXPECT_THAT(take(gmmRegistrationCode, "00 01 13 00 62 1b e9 12 aa bb"),
              ElementsAre("KCellularGmmContext[timestamp: 1000, update_status: GPRS_STATUS_NOT_UPDATED, rai: "
                          "[encoded_plmn: <13 00 62>, lac: 7145, rac: 18]]"));
}

TEST_F(NasRecordsMapping, MessagesWithoutMeaningAreCountedByTheirType) {
  take(emmMessageInCode, withHead("07 52 00"));
  take(esmMessageOutCode, withHead("02 01 d0 11"));
  take(gprsMessageCode, withLength("08 15 01"));
  take(emmMessageInCode, withHead("07 44 0b"));
  take(emmMessageInCode, "02 09 05 00 07 44 0b");
  EXPECT_EQ(report_.read, (RecordCounts{{{0xB0EC, 1, {}}, 1}}));
  EXPECT_EQ(
      report_.skipped,
      (RecordCounts{{{0xB0EC, 1, 0x52}, 1}, {{0xB0EC, 2, {}}, 1}, {{0xB0E3, 1, 0xD0}, 1}, {{0x713A, {}, 0x15}, 1}}));
}

TEST_F(NasRecordsMapping, MessagesWithTheirSecurityHeadMeanWhatIsInside) {
  // Integrity protected: type, authentication code, sequence number, then a service reject.
  EXPECT_THAT(take(securedEmmInCode, withHead("17 a1 a2 a3 a4 05 07 4e 27")),
              ElementsAre("KCellularEmmContext[timestamp: 1000, reject_cause: "
                          "EMM_CAUSE_CS_DOMAIN_TEMPORARILY_NOT_AVAILABLE, reg_proc: EMM_PROC_NO_PROC]"));
  // The header of a service request is part of it.
  EXPECT_THAT(take(securedEmmOutCode, withHead("c7 25 12 34"), 1100), ElementsAre(HasSubstr("EMM_PROC_SERV_REQ")));
  EXPECT_EQ(report_.skipped, RecordCounts());
  // Ciphered: the content is unknown.
  EXPECT_THAT(take(securedEmmInCode, withHead("27 a1 a2 a3 a4 06 07 4e 27"), 1200), IsEmpty());
  EXPECT_THAT(take(securedEsmInCode, withHead("27 a1 a2 a3 a4 07 52 c1"), 1300), IsEmpty());
  EXPECT_EQ(report_.skipped, (RecordCounts{{{0xB0EA, 1, 0x27}, 1}, {{0xB0E0, 1, 0x27}, 1}}));
  EXPECT_THAT(take(securedEmmInCode, withHead("17 a1 a2"), 1400), IsEmpty());
}

TEST_F(NasRecordsMapping, NothingIsRememberedAcrossAHoleInTheLog) {
  take(emmMessageInCode, withHead(literal::updateAccept));
  EXPECT_THAT(take(emmMessageInCode, withHead("07 4e 27"), 100'000),
              ElementsAre("KCellularEmmContext[timestamp: 100000, reject_cause: "
                          "EMM_CAUSE_CS_DOMAIN_TEMPORARILY_NOT_AVAILABLE, reg_proc: EMM_PROC_NO_PROC]"));
}

}  // namespace
}  // namespace vespscope::test
