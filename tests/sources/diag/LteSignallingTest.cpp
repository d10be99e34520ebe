// Values from RRC messages: cells from broadcasts, reselection, discontinuous reception, reported levels; and states
// that only certain messages change.
#include <algorithm>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "../../rrc/Literals.h"
#include "LiteralRecords.h"
#include "Mapping.h"
#include "sources/diag/LteSignalling.h"

namespace vespscope::test {
namespace {

using testing::AllOf;
using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

constexpr std::uint8_t broadcast = 1;
constexpr std::uint8_t systemInformation = 2;
constexpr std::uint8_t paging = 4;
constexpr std::uint8_t downlinkCcch = 5;
constexpr std::uint8_t downlinkDcch = 6;
constexpr std::uint8_t uplinkCcch = 7;
constexpr std::uint8_t uplinkDcch = 8;

class LteSignallingTest : public MappingTest {
 protected:
  // Takes a B0C0 of version 8 for the cell 5780/185, or 5815/254.
  std::vector<std::string> takeBytes(std::uint8_t type, const Bytes& message, std::int64_t time, bool other = false) {
    Bytes payload = bytesOf("08 09 0a 01");
    append(payload, bytesOf(other ? "fe 00 b7 16 00 00" : "b9 00 94 16 00 00"));
    append(payload, bytesOf("34 12"));
    payload.push_back(type);
    append(payload, bytesOf("00 00 00 00"));
    payload.push_back(static_cast<std::uint8_t>(message.size()));
    payload.push_back(0);
    append(payload, message);
    return take(sources::diag::rrcMessageCode, payload, time);
  }
  std::vector<std::string> takeLiteral(std::uint8_t type, std::string_view name, std::int64_t time,
                                       bool other = false) {
    const auto* found = std::find_if(std::begin(literals), std::end(literals),
                                     [name](const Literal& literal) { return literal.name == name; });
    EXPECT_NE(found, std::end(literals)) << name;
    return takeBytes(type, bytesOf(found->hex), time, other);
  }
};

TEST_F(LteSignallingTest, TheServingCellIsDescribedByItsBroadcast) {
  takeLiteral(downlinkDcch, "release", 1000);
  EXPECT_THAT(takeLiteral(systemInformation, "sib1", 1100),
              ElementsAre("KCellularLteScellInfo[timestamp: 1100, phy_cell_id: 185, dl_freq: 5780, cell_id: 180149761, "
                          "freq_band_ind: 66, tracking_area_code: 4660, num_mnc_digits: 2, sel_plmn_mcc: 1, "
                          "sel_plmn_mnc: 1]"));
  // A repetition is not reported.
  EXPECT_THAT(takeLiteral(systemInformation, "sib1", 1200), IsEmpty());
  EXPECT_THAT(takeLiteral(broadcast, "mib", 1300),
              ElementsAre(HasSubstr("dl_bw: 20"), HasSubstr("pcc_earfcn: 5780, pcc_bandwidth: 10")));
}

TEST_F(LteSignallingTest, AnotherCellsBroadcastIsKeptUntilItServes) {
  takeLiteral(downlinkDcch, "release", 1000);
  EXPECT_THAT(takeLiteral(systemInformation, "sib1", 1100, true), IsEmpty());
  EXPECT_THAT(takeLiteral(paging, "paging", 1200, true),
              ElementsAre(AllOf(HasSubstr("phy_cell_id: 254"), HasSubstr("cell_id: 180149761"))));
}

TEST_F(LteSignallingTest, TheModemsOwnDescriptionComesBeforeTheBroadcast) {
  take(sources::diag::servingCellCode, bytesOf(literal::servingCellV3), 1000);
  EXPECT_THAT(takeLiteral(systemInformation, "sib1", 1100), IsEmpty());
  // Paging does not name another cell then either.
  EXPECT_THAT(takeLiteral(paging, "paging", 1200, true), IsEmpty());
}

TEST_F(LteSignallingTest, ReselectionParametersAreThoseOfTheServingCell) {
  takeLiteral(downlinkDcch, "release", 1000);
  EXPECT_THAT(takeLiteral(systemInformation, "si", 1100, true), IsEmpty());
  const auto events = takeLiteral(systemInformation, "si", 1200);
  ASSERT_THAT(events, Contains(HasSubstr("KCellularLteSelReselCellInfo")));
  EXPECT_THAT(events, Contains(AllOf(HasSubstr("Q_hyst: "), HasSubstr("nbr_eutra: [[earfcn: "))));
  EXPECT_THAT(takeLiteral(systemInformation, "si", 1300), Not(Contains(HasSubstr("KCellularLteSelReselCellInfo"))));
}

TEST_F(LteSignallingTest, DiscontinuousReceptionIsSetAndEndsWithTheConnection) {
  takeLiteral(uplinkDcch, "setup-complete", 1000);
  const auto set = takeLiteral(downlinkDcch, "recon-drx", 1100);
  ASSERT_THAT(set, Contains(AllOf(HasSubstr("KCellularLteCdrxConfig"), HasSubstr("on_duration_ms: "),
                                  HasSubstr("cdrx_config_status: 1"))));
  EXPECT_THAT(takeLiteral(downlinkDcch, "recon-drx", 1200), Not(Contains(HasSubstr("KCellularLteCdrxConfig"))));
  EXPECT_THAT(takeLiteral(downlinkDcch, "release", 1300),
              Contains("KCellularLteCdrxConfig[timestamp: 1300, cdrx_config_status: 0]"));
}

TEST_F(LteSignallingTest, AReportFillsInLevelsThatNoRecordMeasures) {
  takeLiteral(uplinkDcch, "setup-complete", 1000);
  EXPECT_THAT(takeLiteral(uplinkDcch, "report-umts", 1100),
              Contains(AllOf(HasSubstr("KCellularLteRsrpRsrqSinr"), HasSubstr("phy_cell_id: 185, rsrp0: "))));
  take(sources::diag::servingMeasurementCode, bytesOf(literal::measurementV19), 1200);
  EXPECT_THAT(takeLiteral(uplinkDcch, "report-umts", 1300), Not(Contains(HasSubstr("KCellularLteRsrpRsrqSinr"))));
  EXPECT_THAT(takeLiteral(uplinkDcch, "report-umts", 4300), Contains(HasSubstr("KCellularLteRsrpRsrqSinr")));
}

TEST_F(LteSignallingTest, AReportNamesNeighboursInUmtsAndGsm) {
  takeLiteral(uplinkDcch, "setup-complete", 1000);
  EXPECT_THAT(takeLiteral(uplinkDcch, "report-umts", 1100),
              Contains(AllOf(HasSubstr("KCellularLteNbrInterRatCellMeas"), HasSubstr("psc: "))));
  EXPECT_THAT(takeLiteral(uplinkDcch, "report-gsm", 1200),
              Contains(AllOf(HasSubstr("KCellularLteNbrInterRatCellMeas"), HasSubstr("rxlev: "))));
}

TEST_F(LteSignallingTest, NeighboursWithoutAKnownCarrierAreLeftOut) {
  takeLiteral(uplinkDcch, "setup-complete", 1000);
  EXPECT_THAT(takeLiteral(uplinkDcch, "report-lte", 1100), Not(Contains(HasSubstr("KCellularLteNbrEutraCellMeas"))));
}

TEST_F(LteSignallingTest, ALateReportDoesNotReopenTheConnection) {
  takeLiteral(uplinkDcch, "setup-complete", 1000);
  takeLiteral(downlinkDcch, "release", 2000);
  const auto state = HasSubstr("KCellularLteRrcState");
  EXPECT_THAT(takeLiteral(uplinkDcch, "report-umts", 2100), Not(Contains(state)));
  EXPECT_THAT(takeLiteral(uplinkDcch, "report-umts", 2500), Not(Contains(state)));
  EXPECT_THAT(takeBytes(downlinkDcch, bytesOf("22 10"), 2600), Not(Contains(state)));
  EXPECT_THAT(takeBytes(uplinkDcch, bytesOf("12 00"), 2050), Not(Contains(state)));
  EXPECT_THAT(takeLiteral(uplinkCcch, "request", 3000), Contains(HasSubstr("ATMPT_CONNECTION")));
  EXPECT_THAT(takeLiteral(uplinkDcch, "report-umts", 3010), Not(Contains(state)));
  EXPECT_THAT(takeLiteral(uplinkDcch, "setup-complete", 3050), Contains(HasSubstr("RRC_STATE_CONNECTED")));
}

TEST_F(LteSignallingTest, AHandoverFromAnotherTechnologyAndAResumeOpenTheConnection) {
  takeLiteral(downlinkDcch, "release", 1000);
  EXPECT_THAT(takeBytes(uplinkDcch, bytesOf("12 00"), 2000), Contains(HasSubstr("RRC_STATE_CONNECTED")));
  takeLiteral(downlinkDcch, "release", 3000);
  EXPECT_THAT(takeBytes(uplinkDcch, bytesOf("90 00"), 4000), Contains(HasSubstr("RRC_STATE_CONNECTED")));
}

// Record headers of four bytes, then NAS messages.
const std::string head = "01 09 05 00 ";

TEST_F(LteSignallingTest, AServiceRequestEndsWithItsConnection) {
  using namespace sources::diag;
  takeLiteral(uplinkDcch, "setup-complete", 1000);
  EXPECT_THAT(take(emmMessageOutCode, bytesOf(head + "c7 25 12 34"), 1010),
              ElementsAre(HasSubstr("reg_proc: EMM_PROC_SERV_REQ")));
  EXPECT_THAT(takeLiteral(downlinkDcch, "release", 2000), Contains(HasSubstr("reg_proc: EMM_PROC_NO_PROC")));
}

TEST_F(LteSignallingTest, ADetachClearsTheBearers) {
  using namespace sources::diag;
  const Bytes bearer = bytesOf("01 00 05 02 00 00 00 00 00 00 00 09");
  const auto noBearers = HasSubstr("bearer_context_count: 0");
  // Power-off has no answer.
  take(bearerStateCode, bearer, 1000);
  EXPECT_THAT(take(emmMessageOutCode, bytesOf(head + "07 45 09 0b f6"), 1100),
              AllOf(Contains(noBearers), Contains(HasSubstr("KREG_STATUS_AT_NOT_REGISTERED"))));
  // Any other detach ends with the answer.
  take(bearerStateCode, bearer, 2000);
  EXPECT_THAT(take(emmMessageInCode, bytesOf(head + "07 45 01"), 2100), Not(Contains(noBearers)));
  EXPECT_THAT(take(emmMessageOutCode, bytesOf(head + "07 46"), 2200), Contains(noBearers));
  // A detach from the circuit domain only changes nothing in EPS.
  take(bearerStateCode, bearer, 3000);
  take(emmMessageInCode, bytesOf(head + "07 45 03"), 3100);
  EXPECT_THAT(take(emmMessageOutCode, bytesOf(head + "07 46"), 3200), IsEmpty());
}

}  // namespace
}  // namespace vespscope::test
