// A modem's state from properties of correct and incorrect types.
#include <cfloat>
#include <cmath>
#include <limits>
#include <string>

#include <gtest/gtest.h>

#include "Properties.h"
#include "sources/modemmanager/Names.h"
#include "sources/modemmanager/ReadModem.h"

namespace vespscope::test {
namespace {

using namespace sources::modemmanager;
using ipc::Array;
using ipc::Dictionary;
using ipc::Object;

const std::string modem = "/org/freedesktop/ModemManager1/Modem/0";

class ReadModem : public ::testing::Test {
 protected:
  [[nodiscard]] ModemState state() const { return readModem(tree_, modem, answers_); }

  void tell(const std::string& interface, const Dictionary& properties) { tree_.set(modem, interface, properties); }

  Cell cell(const Dictionary& told) {
    answers_.cells = {Object(told)};
    return state().cells.at(0);
  }

  ObjectTree tree_;
  Answers answers_;
};

TEST_F(ReadModem, OfAMissingModemGivesNothing) {
  const ModemState nothing = state();
  EXPECT_EQ(nothing.technology, Technology::none);
  EXPECT_EQ(nothing.registration, std::nullopt);
  EXPECT_TRUE(nothing.bearers.empty());
}

TEST_F(ReadModem, TakesTheNewestTechnologyOfThoseInUse) {
  const auto technology = [this](std::uint32_t bits) {
    tell(modemInterface, dictionary({{"AccessTechnologies", number(bits)}}));
    return state().technology;
  };
  EXPECT_EQ(technology(0), Technology::none);
  EXPECT_EQ(technology(1U << 1U), Technology::gsm);
  EXPECT_EQ(technology(1U << 4U), Technology::gsm);
  EXPECT_EQ(technology(1U << 5U), Technology::umts);
  EXPECT_EQ(technology(1U << 9U), Technology::umts);
  EXPECT_EQ(technology(1U << 14U), Technology::lte);
  EXPECT_EQ(technology(1U << 14U | 1U << 15U), Technology::lte) << "an NR carrier beside LTE";
  EXPECT_EQ(technology(1U << 15U), Technology::none) << "NR alone has no metrics";
  EXPECT_EQ(technology(1U << 10U), Technology::none) << "CDMA has no metrics";
  EXPECT_EQ(technology(0xFFFFFFFF), Technology::none) << "any: not known";
}

TEST_F(ReadModem, ReportsWhichHspaIsUsed) {
  const auto used = [this](std::uint32_t bits) {
    tell(modemInterface, dictionary({{"AccessTechnologies", number(bits)}}));
    return std::pair(state().hsdpa, state().hsupa);
  };
  EXPECT_EQ(used(1U << 5U), std::pair(false, false));
  EXPECT_EQ(used(1U << 6U), std::pair(true, false));
  EXPECT_EQ(used(1U << 7U), std::pair(false, true));
  EXPECT_EQ(used(1U << 8U), std::pair(true, true));
}

TEST_F(ReadModem, TakesNothingOfAnotherType) {
  tell(modemInterface, dictionary({{"AccessTechnologies", text("lte")}, {"CurrentCapabilities", Object(true)}}));
  tell(modem3gppInterface, dictionary({{"RegistrationState", Object(std::int64_t{1})},
                                       {"PacketServiceState", text("attached")},
                                       {"EpsUeModeOperation", Object(1.0)},
                                       {"OperatorCode", number(310260)}}));
  tell(signalInterface, dictionary({{"Lte", text("good")}, {"Gsm", Object(dictionary({{"rssi", number(5)}}))}}));
  answers_.cells = {text("cell"), Object(dictionary({{"cell-type", text("lte")}}))};
  const ModemState nothing = state();
  EXPECT_EQ(nothing.technology, Technology::none);
  EXPECT_FALSE(nothing.mayUseLte);
  EXPECT_EQ(nothing.registration, std::nullopt);
  EXPECT_EQ(nothing.packetAttached, std::nullopt);
  EXPECT_EQ(nothing.epsMode, std::nullopt);
  EXPECT_FALSE(nothing.network.has_value());
  EXPECT_EQ(nothing.gsmRssi, std::nullopt);
  EXPECT_TRUE(nothing.cells.empty());
}

TEST_F(ReadModem, TakesNoValueThatMeansUnknown) {
  tell(modem3gppInterface,
       dictionary({{"RegistrationState", number(4)}, {"PacketServiceState", number(0)}, {"OperatorCode", text("")}}));
  const double infinity = std::numeric_limits<double>::infinity();
  tell(signalInterface,
       dictionary({{"Lte", Object(dictionary({{"rsrp", Object(-DBL_MAX)}, {"rsrq", Object(std::nan(""))}}))},
                   {"Umts", Object(dictionary({{"rscp", Object(-infinity)}}))}}));
  answers_.location = "310,260,FFFE,0,0";
  const ModemState nothing = state();
  EXPECT_EQ(nothing.registration, std::nullopt);
  EXPECT_EQ(nothing.packetAttached, std::nullopt);
  EXPECT_EQ(nothing.lte.rsrp, std::nullopt);
  EXPECT_EQ(nothing.lte.rsrq, std::nullopt);
  EXPECT_EQ(nothing.umts.rscp, std::nullopt);
  EXPECT_EQ(nothing.lac, std::nullopt);
  EXPECT_EQ(nothing.cellId, std::nullopt);
  EXPECT_EQ(nothing.tac, std::nullopt);
  EXPECT_EQ(nothing.network->mnc(), 260);
}

TEST_F(ReadModem, TakesTheLocationApart) {
  answers_.location = "001,01,B0C,1C3D4E5,1A2B";
  const ModemState there = state();
  EXPECT_EQ(there.lac, 0x0B0CU);
  EXPECT_EQ(there.cellId, 0x1C3D4E5U);
  EXPECT_EQ(there.tac, 0x1A2BU);
  EXPECT_EQ(there.network->mcc(), 1);
  EXPECT_EQ(there.network->text(), "001-01");
}

TEST_F(ReadModem, TakesNoLocationOfAnotherForm) {
  for (const char* words : {"", ",,,,", "001,01,B0C,1C3D4E5", "001,01,B0C,1C3D4E5,1A2B,9", "001,01,xyz,-1,10000",
                            "000,00,0,0,0", "001,01,0,FFFFFFFF,FFFF"}) {
    answers_.location = words;
    const ModemState nowhere = state();
    EXPECT_EQ(nowhere.lac, std::nullopt) << words;
    EXPECT_EQ(nowhere.cellId, std::nullopt) << words;
    EXPECT_EQ(nowhere.tac, std::nullopt) << words;
  }
}

TEST_F(ReadModem, KnowsANetworkByFiveOrSixDigits) {
  EXPECT_EQ(networkOf("00101")->text(), "001-01");
  EXPECT_EQ(networkOf("310260")->text(), "310-260");
  for (const char* words : {"", "3102", "3102600", "31026x", "00000"}) EXPECT_FALSE(networkOf(words)) << words;
}

TEST_F(ReadModem, ReadsCellsOfEachTechnology) {
  const Cell lte = cell(dictionary({{"cell-type", number(5)},
                                    {"serving", Object(true)},
                                    {"operator-id", text("00101")},
                                    {"tac", text("1A2B")},
                                    {"ci", text("1C3D4E5")},
                                    {"physical-ci", text("B9")},
                                    {"earfcn", number(1300)},
                                    {"rsrp", Object(-99.5)},
                                    {"rsrq", Object(-11.0)}}));
  EXPECT_EQ(lte.technology, Technology::lte);
  EXPECT_TRUE(lte.serving);
  EXPECT_EQ(lte.area, 0x1A2BU);
  EXPECT_EQ(lte.cellId, 0x1C3D4E5U);
  EXPECT_EQ(lte.code, 185U);
  EXPECT_EQ(lte.channel, 1300U);
  EXPECT_EQ(lte.power, -99.5);
  EXPECT_EQ(lte.quality, -11.0);

  const Cell umts = cell(dictionary({{"cell-type", number(3)},
                                     {"serving", Object(false)},
                                     {"psc", number(293)},
                                     {"uarfcn", number(9490)},
                                     {"rscp", Object(-95.0)},
                                     {"ecio", Object(-8.0)}}));
  EXPECT_EQ(umts.technology, Technology::umts);
  EXPECT_FALSE(umts.serving);
  EXPECT_EQ(umts.code, 293U);
  EXPECT_EQ(umts.channel, 9490U);
  EXPECT_EQ(umts.quality, -8.0);

  const Cell gsm = cell(dictionary({{"cell-type", number(2)},
                                    {"lac", text("B0C")},
                                    {"ci", text("4D2")},
                                    {"arfcn", number(62)},
                                    {"base-station-id", text("29")},
                                    {"rx-level", number(37)}}));
  EXPECT_EQ(gsm.technology, Technology::gsm);
  EXPECT_EQ(gsm.cellId, 1234U);
  EXPECT_EQ(gsm.code, 0x29U);
  EXPECT_EQ(gsm.levelCode, 37U);
}

TEST_F(ReadModem, ReadsNoCodeBeyondItsRange) {
  const Cell lte = cell(dictionary({{"cell-type", number(5)},
                                    {"physical-ci", text("1F8")},  // 504
                                    {"ci", text("FFFFFFFF")},
                                    {"tac", text("FFFF")},
                                    {"earfcn", number(0xFFFFFFFF)},
                                    {"rsrp", Object(-DBL_MAX)}}));
  EXPECT_EQ(lte.code, std::nullopt);
  EXPECT_EQ(lte.cellId, std::nullopt);
  EXPECT_EQ(lte.area, std::nullopt);
  EXPECT_EQ(lte.channel, std::nullopt);
  EXPECT_EQ(lte.power, std::nullopt);
  EXPECT_EQ(cell(dictionary({{"cell-type", number(3)}, {"psc", number(512)}})).code, std::nullopt);
  EXPECT_EQ(cell(dictionary({{"cell-type", number(2)}, {"rx-level", number(64)}})).levelCode, std::nullopt);
}

TEST_F(ReadModem, LeavesOutCellsOfOtherTechnologies) {
  answers_.cells = {Object(dictionary({{"cell-type", number(1)}})), Object(dictionary({{"cell-type", number(6)}}))};
  EXPECT_TRUE(state().cells.empty());
}

TEST_F(ReadModem, ReadsItsConnectedBearers) {
  const std::string first = "/org/freedesktop/ModemManager1/Bearer/0";
  const std::string second = "/org/freedesktop/ModemManager1/Bearer/1";
  tell(modemInterface, dictionary({{"Bearers", Object(Array{Object(first), Object(second)})}}));
  EXPECT_FALSE(state().bearersKnown);
  tree_.set(first, bearerInterface,
            dictionary({{"Connected", Object(true)},
                        {"ProfileId", Object(std::int64_t{3})},
                        {"Properties", Object(dictionary({{"apn", text("internet")}, {"ip-type", number(4)}}))},
                        {"Ip4Config", Object(dictionary({{"address", text("10.0.0.2")},
                                                         {"dns1", text("9.9.9.9")},
                                                         {"dns2", text("nowhere")},
                                                         {"dns3", text("1.1.1.1")}}))},
                        {"Ip6Config", Object(dictionary({{"address", text("2001:db8::2")}}))}}));
  tree_.set(second, bearerInterface, dictionary({{"Connected", Object(false)}}));
  const ModemState connected = state();
  EXPECT_TRUE(connected.bearersKnown);
  ASSERT_EQ(connected.bearers.size(), 1U);
  const Bearer& bearer = connected.bearers[0];
  EXPECT_EQ(bearer.contextId, 3U);
  EXPECT_EQ(bearer.accessPoint, "internet");
  EXPECT_EQ(bearer.ipv4, (Bytes{10, 0, 0, 2}));
  EXPECT_EQ(bearer.ipv6, (Bytes{0x20, 0x01, 0x0D, 0xB8, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 2}));
  EXPECT_EQ(bearer.dns, (std::vector<Bytes>{{9, 9, 9, 9}, {1, 1, 1, 1}}));
}

TEST_F(ReadModem, ReadsItsSimCard) {
  const std::string sim = "/org/freedesktop/ModemManager1/SIM/0";
  tell(modemInterface, dictionary({{"Sim", Object(sim)}}));
  tree_.set(sim, simInterface,
            dictionary({{"SimIdentifier", text("8999010000000000018")},
                        {"Imsi", text("001010123456789")},
                        {"OperatorIdentifier", text("00101")},
                        {"OperatorName", text("Test Network")},
                        {"Gid1", Object(Bytes{0x42})},
                        {"Gid2", Object(Bytes{})}}));
  const SimCard card = state().sim;
  EXPECT_EQ(card.iccid, "8999010000000000018");
  EXPECT_EQ(card.imsi, "001010123456789");
  EXPECT_EQ(card.operatorCode, "00101");
  EXPECT_EQ(card.operatorName, "Test Network");
  EXPECT_EQ(card.gid1, Bytes{0x42});
  EXPECT_EQ(card.gid2, std::nullopt);
}

TEST_F(ReadModem, TakesNoIdentityThatIsNoNumber) {
  const std::string sim = "/org/freedesktop/ModemManager1/SIM/0";
  tell(modemInterface, dictionary({{"Sim", Object(sim)}}));
  tree_.set(sim, simInterface,
            dictionary({{"SimIdentifier", text("89990100000000000G8")},
                        {"Imsi", text("00101012345678901")},
                        {"OperatorIdentifier", text("0010")},
                        {"OperatorName", text("")}}));
  const SimCard card = state().sim;
  EXPECT_EQ(card.iccid, std::nullopt);
  EXPECT_EQ(card.imsi, std::nullopt);
  EXPECT_EQ(card.operatorCode, std::nullopt);
  EXPECT_EQ(card.operatorName, std::nullopt);
  tell(modemInterface, dictionary({{"Sim", text("/")}}));
  EXPECT_EQ(simOf(tree_, modem), std::nullopt);
}

}  // namespace
}  // namespace vespscope::test
