// GSM system information messages and the events made of them.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "LiteralRecords.h"
#include "Mapping.h"
#include "sources/diag/GsmSystemInformation.h"

namespace vespscope::test {
namespace {

using namespace sources;
using namespace sources::diag;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

const nas::LocationArea area{*radio::Plmn::fromText("26201"), 10'000};
const GsmSelection selection{.hysteresis = 3, .maximumPower = 5, .minimumLevel = 6};
const GsmAccess access{.maximumRetransmissions = 2,
                       .barred = false,
                       .reestablishmentAllowed = false,
                       .emergencyAllowed = false,
                       .barredClasses = 1};

TEST(GsmSystemInformation, Type3DescribesTheCell) {
  const auto information = gsmSystemInformationOf(bytesOf(literal::gsmType3));
  ASSERT_TRUE(information);
  EXPECT_EQ(std::get<GsmCellDescription>(*information),
            (GsmCellDescription{
                .cellIdentity = 0x1234,
                .area = area,
                .attachAllowed = true,
                .pagingMultiframes = 3,
                .locationTimer = 10,
                .uplinkDtx = 1,
                .radioLinkTimeout = 5,
                .selection = selection,
                .access = access,
                .reselection = GsmReselection{.lowPriority = true, .offset = 5, .temporaryOffset = 3, .penaltyTime = 9},
                .secondTerBroadcast = true,
                .earlyClassmarkSending = true,
                .packetService = true}));
}

TEST(GsmSystemInformation, RestOctetsOfPaddingGiveNothing) {
  Bytes bytes = bytesOf(literal::gsmType3);
  std::fill(bytes.end() - 4, bytes.end(), 0x2B);
  const auto cell = std::get<GsmCellDescription>(*gsmSystemInformationOf(bytes));
  EXPECT_FALSE(cell.reselection);
  EXPECT_FALSE(cell.secondTerBroadcast);
  EXPECT_FALSE(cell.earlyClassmarkSending);
  EXPECT_FALSE(cell.packetService);
}

TEST(GsmSystemInformation, ThePseudoLengthMayBeMissing) {
  const Bytes bytes = bytesOf(literal::gsmType3);
  const auto with = gsmSystemInformationOf(bytes);
  const auto without = gsmSystemInformationOf(std::span(bytes).subspan(1));
  EXPECT_EQ(std::get<GsmCellDescription>(*with), std::get<GsmCellDescription>(*without));
}

TEST(GsmSystemInformation, Type4GivesAreaAccessAndBroadcastChannel) {
  const auto information = gsmSystemInformationOf(bytesOf(literal::gsmType4));
  ASSERT_TRUE(information);
  const auto& cell = std::get<GsmCellReminder>(*information);
  EXPECT_EQ(cell.area, area);
  EXPECT_EQ(cell.selection, selection);
  EXPECT_EQ(cell.access, access);
  EXPECT_TRUE(cell.cellBroadcast);
}

TEST(GsmSystemInformation, Type13GivesThePacketService) {
  const auto information = gsmSystemInformationOf(bytesOf(literal::gsmType13));
  ASSERT_TRUE(information);
  const auto& cell = std::get<GsmPacketDescription>(*information);
  EXPECT_EQ(cell.routingAreaCode, 18);
  EXPECT_TRUE(cell.splitPaging);
  EXPECT_EQ(cell.accessThreshold, 6);
  EXPECT_EQ(cell.networkControlOrder, 1);
  EXPECT_EQ(cell.networkMode, 1);
  EXPECT_EQ(cell.extendedUplinkBlockFlow, true);
}

TEST(GsmSystemInformation, OtherAndTruncatedMessagesGiveNothing) {
  for (const char* dump : {"", "49", "49 06", "55 06 19 00", "31 05 1c", "01 06 00", "01 06 00 2b 2b 2b"}) {
    EXPECT_FALSE(gsmSystemInformationOf(bytesOf(dump))) << dump;
  }
  const Bytes three = bytesOf(literal::gsmType3);
  constexpr std::size_t mandatory = 3 + 2 + 5 + 3 + 1 + 2 + 3;
  for (std::size_t length = 0; length <= three.size(); ++length) {
    EXPECT_EQ(gsmSystemInformationOf(std::span(three).first(length)).has_value(), length >= mandatory) << length;
  }
  const Bytes thirteen = bytesOf(literal::gsmType13);
  for (std::size_t length = 0; length < thirteen.size(); ++length) {
    // A separate allocation, so that a read past the end is detected.
    const Bytes cut(thirteen.begin(), thirteen.begin() + static_cast<std::ptrdiff_t>(length));
    EXPECT_EQ(gsmSystemInformationOf(cut).has_value(), length >= 9) << length;
  }
}

class GsmSystemInformationMapping : public MappingTest {
 protected:
  std::vector<std::string> takeMessage(const char* message, std::int64_t time) {
    Bytes payload = bytesOf("80 1b");
    const Bytes bytes = bytesOf(message);
    payload.push_back(static_cast<std::uint8_t>(bytes.size()));
    append(payload, bytes);
    return take(gsmMessageCode, payload, time);
  }
};

TEST(GsmSystemInformation, Type13ThatEndsWithinTheRoutingAreaGivesNothing) {
  EXPECT_FALSE(gsmSystemInformationOf(bytesOf("06 00 d6 d0 a3")));
}

TEST_F(GsmSystemInformationMapping, TheCellAndItsConfigurationAreReportedOnce) {
  EXPECT_THAT(
      takeMessage(literal::gsmType3, 1000),
      ElementsAre("KCellularGsmScellInfo[timestamp: 1000, mcc: 262, mnc: 1, lac: 10000, cell_id: 4660, "
                  "num_mnc_digits: 2]",
                  testing::StartsWith("KCellularGsmIdleConfig[timestamp: 1000, mcc: 262, mnc: 1, lac: 10000, ci: 4660, "
                                      "dtx_from_bs: 1, radio_link_timeout: 5, ms_txpwr: 5, rx_acc_min: 6, cbq: 1, cba: "
                                      "0, c2_valid: 1, ")));
  EXPECT_THAT(takeMessage(literal::gsmType3, 1500), IsEmpty());
  EXPECT_THAT(takeMessage(literal::gsmType4, 1600),
              ElementsAre(AllOf(HasSubstr("KCellularGsmIdleConfig"), HasSubstr("cbch_supported: 1"))));
  EXPECT_THAT(takeMessage(literal::gsmType4, 1700), IsEmpty());
  EXPECT_THAT(takeMessage(literal::gsmType13, 1800),
              ElementsAre("KCellularGsmGprsConfig[timestamp: 1800, gprs_sup: 1, rac: 18, sp_pg_cy: 1, nco: 1, nom: 1, "
                          "acc_thr: 6, ext_upl_tbf_supported: 1]"));
}

TEST_F(GsmSystemInformationMapping, OtherMessagesAreCountedByTheirType) {
  take(gsmMessageCode, "80 19 03 55 06 19");
  take(gsmMessageCode, "80 19 04 55 06 19");
  EXPECT_EQ(report_.skipped, (RecordCounts{{{0x512F, {}, 0x19}, 1}}));
  EXPECT_EQ(report_.broken, (RecordCounts{{{0x512F, {}, {}}, 1}}));
}

}  // namespace
}  // namespace vespscope::test
