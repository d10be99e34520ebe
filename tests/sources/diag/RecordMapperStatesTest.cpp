// The tables of docs/states.md, row by row: which message changes which state, and which leaves it.
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "LiteralRecords.h"
#include "Mapping.h"
#include "sources/diag/LteRecords.h"
#include "sources/diag/NasRecords.h"
#include "sources/diag/WcdmaRecords.h"

namespace vespscope::test {
namespace {

using namespace sources::diag;
using testing::AllOf;
using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

struct Signal {
  std::uint8_t channel;
  const char* bytes;
};
constexpr Signal paging{4, "68800000000000ffffffffffb0"};
constexpr Signal reestablishmentReject{5, "20 00"};
constexpr Signal reject{5, "41e0"};
constexpr Signal release{6, "2c02"};
constexpr Signal mobility{6, "181460800224466aa0"};
constexpr Signal security{6, "360020"};
constexpr Signal reestablishmentRequest{7, "08c034d00004"};
constexpr Signal request{7, "40 00 00 00 00 08"};
constexpr Signal resumeRequest{7, "80 00"};
constexpr Signal measurementReport{8, "0810000093fec062ff5800"};
constexpr Signal reconfigurationComplete{8, "12 00"};
constexpr Signal reestablishmentComplete{8, "1a 00"};
constexpr Signal setupComplete{8, "20220000ff03076016"};
constexpr Signal resumeComplete{8, "90 00"};

const std::string idle = "state: KLTE_RRC_STATE_IDLE";
const std::string attempt = "state: KLTE_RRC_STATE_ATMPT_CONNECTION";
const std::string connected = "state: KLTE_RRC_STATE_CONNECTED";
const std::string leaving = "state: KLTE_RRC_STATE_ATMPT_OUTBND_MOBILITY";

class RecordMapperStates : public MappingTest {
 protected:
  // B0C0 of version 8.
  std::vector<std::string> send(const Signal& signal, std::int64_t time) {
    Bytes payload = bytesOf("08 09 0a 01 b9 00 94 16 00 00 34 12");
    payload.push_back(signal.channel);
    append(payload, bytesOf("00 00 00 00"));
    const Bytes message = bytesOf(signal.bytes);
    payload.push_back(static_cast<std::uint8_t>(message.size()));
    payload.push_back(0);
    append(payload, message);
    return take(rrcMessageCode, payload, time);
  }
  // The reports of one metric alone, in which a state is the first field behind the timestamp.
  std::vector<std::string> statesAfter(const Signal& signal, std::int64_t time) {
    std::vector<std::string> states;
    for (std::string& event : send(signal, time)) {
      if (event.starts_with("KCellularLteRrcState[")) states.push_back(std::move(event));
    }
    return states;
  }
  std::vector<std::string> nas(std::uint16_t code, const std::string& message, std::int64_t time) {
    return take(code, bytesOf("01 09 05 00 " + message), time);
  }
  std::vector<std::string> gprs(const std::string& message, std::int64_t time) {
    Bytes content = bytesOf(message);
    Bytes payload = {0, static_cast<std::uint8_t>(content.size()), 0, 0, 0};
    append(payload, content);
    return take(gprsMessageCode, payload, time);
  }
  void connect(std::int64_t time) {
    send(request, time);
    send(setupComplete, time + 50);
  }
};

TEST_F(RecordMapperStates, RequestsAttemptAConnection) {
  EXPECT_THAT(statesAfter(request, 1000), ElementsAre(AllOf(HasSubstr(attempt), HasSubstr("CAUSE_EST_MO_DATA"))));
  EXPECT_THAT(statesAfter(release, 2000), ElementsAre(HasSubstr(idle)));
  EXPECT_THAT(statesAfter(resumeRequest, 3000), ElementsAre(HasSubstr(attempt)));
  EXPECT_THAT(statesAfter(setupComplete, 3100), ElementsAre(HasSubstr(connected)));
  EXPECT_THAT(statesAfter(reestablishmentRequest, 4000),
              ElementsAre(AllOf(HasSubstr(attempt), HasSubstr("CAUSE_REEST_HO_FAIL"))));
}

TEST_F(RecordMapperStates, CompletionsOpenTheConnection) {
  std::int64_t time = 1000;
  for (const Signal& completion : {setupComplete, resumeComplete, reestablishmentComplete}) {
    send(request, time);
    EXPECT_THAT(statesAfter(completion, time + 100), ElementsAre(HasSubstr(connected))) << completion.bytes;
    EXPECT_THAT(statesAfter(release, time + 200), ElementsAre(HasSubstr(idle)));
    time += 1000;
  }
}

TEST_F(RecordMapperStates, AHandoverFromAnotherTechnologyOpensTheConnection) {
  connect(1000);
  send(release, 2000);
  EXPECT_THAT(statesAfter(reconfigurationComplete, 2100), IsEmpty()) << "late, of the connection before";
  EXPECT_THAT(statesAfter(reconfigurationComplete, 2201), ElementsAre(HasSubstr(connected)));
  EXPECT_THAT(statesAfter(mobility, 3000), ElementsAre(HasSubstr(leaving)));
  EXPECT_THAT(statesAfter(reconfigurationComplete, 3200), ElementsAre(HasSubstr(connected)));
}

TEST_F(RecordMapperStates, RejectionsAndTheReleaseEndInIdle) {
  send(request, 1000);
  EXPECT_THAT(statesAfter(reject, 1100), ElementsAre(AllOf(HasSubstr(idle), HasSubstr("CAUSE_EST_FAIL_REJ"))));
  send(reestablishmentRequest, 2000);
  EXPECT_THAT(statesAfter(reestablishmentReject, 2100),
              ElementsAre(AllOf(HasSubstr(idle), HasSubstr("CAUSE_REL_CONN_FAIL_REEST_REJ"))));
  connect(3000);
  EXPECT_THAT(statesAfter(release, 4000), ElementsAre(AllOf(HasSubstr(idle), HasSubstr("CAUSE_REL_OTHER"))));
}

TEST_F(RecordMapperStates, OtherMessagesShowAConnectionOnlyWhenNothingIsKnown) {
  EXPECT_THAT(statesAfter(measurementReport, 1000), ElementsAre(HasSubstr(connected)));
  send(release, 2000);
  for (const std::int64_t late : {2001, 2100, 2101, 9000}) {
    EXPECT_THAT(statesAfter(measurementReport, late), IsEmpty()) << late;
    EXPECT_THAT(statesAfter(security, late), IsEmpty()) << late;
  }
  send(request, 10'000);
  EXPECT_THAT(statesAfter(measurementReport, 10'010), IsEmpty());
}

TEST_F(RecordMapperStates, IdleEndsWhatBelongsToTheConnection) {
  connect(1000);
  take(servingMeasurementCode, bytesOf(literal::measurementV22), 1100);
  nas(emmMessageOutCode, "c7 25 12 34", 1150);
  const auto events = send(release, 1200);
  EXPECT_THAT(events, Contains(HasSubstr("SCC_STATE_DECONFIGURED")));
  EXPECT_THAT(events, Contains(HasSubstr("reg_proc: EMM_PROC_NO_PROC")));
}

TEST_F(RecordMapperStates, AStateIsReportedAgainWhileMessagesConfirmIt) {
  connect(1000);
  EXPECT_THAT(statesAfter(measurementReport, 6049), IsEmpty()) << "sooner than five seconds";
  EXPECT_THAT(statesAfter(measurementReport, 6050),
              ElementsAre(AllOf(HasSubstr("timestamp: 6050"), HasSubstr(connected))));
  send(release, 7000);
  EXPECT_THAT(statesAfter(measurementReport, 13'000), IsEmpty()) << "a late report confirms nothing";
  EXPECT_THAT(statesAfter(paging, 13'000), ElementsAre(AllOf(HasSubstr("timestamp: 13000"), HasSubstr(idle))));
  EXPECT_THAT(statesAfter(paging, 13'500), IsEmpty());
  // Registration and bearers by the modem's own statements.
  const std::string registered = "02 03 00 00 ff ff ff 00 00 ff ff ff ff ff ff ff ff ff ff";
  const std::string active = "01 00 05 02 00 00 00 00 08 05 05 09";
  take(emmStateCode, registered, 20'000);
  take(bearerStateCode, active, 20'000);
  EXPECT_THAT(take(emmStateCode, registered, 24'999), IsEmpty());
  EXPECT_THAT(take(emmStateCode, registered, 25'000), ElementsAre(HasSubstr("timestamp: 25000, reg_status")));
  EXPECT_THAT(take(bearerStateCode, active, 25'000),
              ElementsAre(HasSubstr("timestamp: 25000, bearer_context_count: 1")));
}

TEST_F(RecordMapperStates, ProceduresOfEpsEndByTheirAnswers) {
  nas(emmMessageOutCode, "07 48 0b 0b f6 62 f2 10 80 01 02 c0 00 00 01", 1000);
  EXPECT_THAT(nas(emmMessageInCode, "07 4b 0f", 1100),
              ElementsAre(AllOf(HasSubstr("KREG_STATUS_REGISTRATION_FAILURE"), HasSubstr("EMM_PROC_NO_PROC"))));
  EXPECT_THAT(nas(emmMessageOutCode, "c7 25 12 34", 2000), ElementsAre(HasSubstr("EMM_PROC_SERV_REQ")));
  EXPECT_THAT(nas(emmMessageInCode, "07 4e 27", 2100),
              ElementsAre(AllOf(HasSubstr("EMM_CAUSE_CS_DOMAIN_TEMPORARILY"), HasSubstr("EMM_PROC_NO_PROC"))));
}

TEST_F(RecordMapperStates, AProcedureThatIsCutOffLeavesTheRegistrationUnknown) {
  connect(1000);
  EXPECT_THAT(nas(emmMessageOutCode, "07 48 0b 0b f6 62 f2 10 80 01 02 c0 00 00 01", 1100),
              ElementsAre(HasSubstr("KREG_STATUS_REGISTRATION_IN_PROGRESS")));
  EXPECT_THAT(send(release, 2000), Contains(AllOf(HasSubstr("KCellularEmmContext"), HasSubstr("EMM_PROC_NO_PROC"),
                                                  Not(HasSubstr("reg_status")))));
}

TEST_F(RecordMapperStates, LeavingTheNetworkClearsTheBearers) {
  const std::string bearer = "01 00 05 02 00 00 00 00 08 05 05 09";
  const auto none = HasSubstr("bearer_context_count: 0");
  take(bearerStateCode, bearer, 1000);
  EXPECT_THAT(nas(emmMessageOutCode, "07 45 09 0b f6", 1100), Contains(none)) << "power-off";
  take(bearerStateCode, bearer, 2000);
  nas(emmMessageOutCode, "07 45 01 0b f6", 2100);
  EXPECT_THAT(nas(emmMessageInCode, "07 46", 2200), Contains(none)) << "detach and its answer";
  take(bearerStateCode, bearer, 3000);
  EXPECT_THAT(take(emmStateCode, "02 01 00 00 ff ff ff 00 00 ff ff ff ff ff ff ff ff ff ff", 3100), Contains(none));
  take(bearerStateCode, bearer, 4000);
  EXPECT_THAT(take(bearerStateCode, "01 00 05 00 00 00 00 00 08 05 05 09", 4100), ElementsAre(none));
}

TEST_F(RecordMapperStates, ProceduresOfThePacketDomainEndByTheirAnswersAndWithTheConnection) {
  const auto none = HasSubstr("reg_proc: KNAS_MM_REG_PROC_PROC_NONE");
  const auto serviceRequest = [&](std::int64_t time) {
    EXPECT_THAT(gprs("08 0c 01", time), ElementsAre(HasSubstr("reg_proc: KNAS_MM_REG_PROC_SERVICE_REQ")));
  };
  serviceRequest(1000);
  EXPECT_THAT(gprs("08 0d", 1100), ElementsAre(none)) << "accepted";
  serviceRequest(2000);
  EXPECT_THAT(gprs("08 0e 0a", 2100), ElementsAre(none)) << "rejected";
  serviceRequest(3000);
  EXPECT_THAT(gprs("08 05 01", 3100), Contains(none)) << "detached";
  serviceRequest(4000);
  EXPECT_THAT(gprs("08 14", 4100), ElementsAre(none)) << "authentication rejected";
  serviceRequest(5000);
  EXPECT_THAT(take(wcdmaRrcCode, "03 02 04 00 3e 31 0c 00", 5100), Contains(none)) << "connection released";
}

}  // namespace
}  // namespace vespscope::test
