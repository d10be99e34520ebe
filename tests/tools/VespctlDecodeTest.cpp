// vespctl decode, state and screens as a user runs them.
#include <sys/stat.h>

#include <chrono>
#include <memory>
#include <ostream>
#include <string>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include "Program.h"
#include "messages/mobility/BearerContext.h"
#include "messages/mobility/KCellularActivatedBearerContexts.h"
#include "registry/MetricRows.h"
#include "support/ScriptedRun.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using ::testing::HasSubstr;
using Lines = std::vector<std::string>;

// A change of the RRC state: metric 3952132, profile 0, timestamp 1700000000000, state 3, previous state 1.
const std::string rrcState = binary("08849cf101 1000 1a0b 0880d095ffbc3110031801");
const std::string rrcStateJson =
    R"("metric_id":3952132,"profile_id":0,"message":"KCellularLteRrcState","ok":true,)"
    R"("record":{"timestamp":1700000000000,"state":"KLTE_RRC_STATE_CONNECTED","prev_state":"KLTE_RRC_STATE_IDLE"}})";

// The output for a capture of one packet.
std::string decoded(const std::string& packet) {
  const TemporaryFolder folder;
  const Outcome outcome =
      vespctl({"decode", folder.write("a.pcap", captureOf(std::vector{packetAt(1700000000, 123456789, packet)}))});
  EXPECT_EQ(outcome.status, 0);
  EXPECT_EQ(outcome.errors, "");
  return outcome.output;
}

constexpr const char* head = R"({"index":0,"time":"1700000000.123456789",)";

TEST(VespctlDecode, PrintsOneObjectPerPacketWithTheMessageAsDecoded) {
  EXPECT_EQ(decoded(rrcState), head + rrcStateJson + "\n");
}

TEST(VespctlDecode, NumbersThePacketsAndWritesTheirTimesWithNineDecimals) {
  const TemporaryFolder folder;
  const Outcome outcome = vespctl(
      {"decode", folder.write("a.pcap", captureOf(std::vector{packetAt(0, 0, rrcState), packetAt(1, 5, rrcState)}))});
  EXPECT_EQ(linesOf(outcome.output), (Lines{R"({"index":0,"time":"0.000000000",)" + rrcStateJson,
                                            R"({"index":1,"time":"1.000000005",)" + rrcStateJson}));
}

TEST(VespctlDecode, ShowsAnIdentifierWithoutARowWithNulls) {
  EXPECT_EQ(decoded(binary("0805")), std::string(head) +
                                         R"("metric_id":5,"profile_id":0,"message":null,"ok":null,"record":null})"
                                         "\n");
  // The radio link failure: registered, but not handled.
  EXPECT_EQ(decoded(binary("08a59cf101 1001 1a02 0801")),
            std::string(head) + R"("metric_id":3952165,"profile_id":1,"message":null,"ok":null,"record":null})"
                                "\n");
}

TEST(VespctlDecode, ShowsAPayloadThatDoesNotDecodeAsNotOkWithAnEmptyRecord) {
  EXPECT_EQ(decoded(binary("08849cf101 10ffffffffffffffffff01 1a02 0880")),
            std::string(head) +
                R"("metric_id":3952132,"profile_id":-1,"message":"KCellularLteRrcState","ok":false,"record":{}})"
                "\n");
}

TEST(VespctlDecode, TakesAPacketWithoutAPayloadForAnEmptyMessage) {
  EXPECT_EQ(decoded(binary("08849cf101")),
            std::string(head) +
                R"("metric_id":3952132,"profile_id":0,"message":"KCellularLteRrcState","ok":true,"record":{}})"
                "\n");
}

TEST(VespctlDecode, WritesBytesAsHexadecimalBooleansAsSuchAndReplacesInvalidText) {
  EXPECT_EQ(decoded(binary("088daaf301 1000 1a0f 1a0d 0801 1a0361ff7a 2a020aff 5001")),
            std::string(head) +
                R"("metric_id":3986701,"profile_id":0,"message":"KCellularActivatedBearerContexts","ok":true,)"
                R"("record":{"bearer_contexts":[{"cid":1,"apn":"a)"
                "\xEF\xBF\xBD"
                R"(z","pdp_addr":"0aff","is_addr_irat_mobile":true}]}})"
                "\n");
}

TEST(VespctlDecode, WritesByTheirNumbersWhatATerminalWouldActOn) {
  // ESC, DEL, C1 (CSI), ALM, LRM, RLO, PDF, line separator, LRI; and similar characters without an effect.
  const std::string name = "a\x1b\x7f\u009b\u061c\u200e\u202e\u202c\u2028\u2066\u00a0\u2027\u206a\u00e9z";
  KCellularActivatedBearerContexts message;
  const auto bearer = std::make_shared<BearerContext>();
  bearer->setApn(name);
  message.addBearerContexts(bearer);
  const MetricEvent event{metricIdentifier("K_CELLULAR_ACTIVE_BEARER"), 0, message.encoded(), 1700000000s};
  for (const std::string command : {"decode", "state", "screens"}) {
    const Outcome outcome = vespctl({command, "-"}, captureOf(std::vector{event}));
    EXPECT_EQ(outcome.status, 0);
    EXPECT_EQ(outcome.output.find_first_of("\x1b\x7f"), std::string::npos) << command;
    for (const std::string raw : {"\u009b", "\u061c", "\u200e", "\u202e", "\u202c", "\u2028", "\u2066"}) {
      EXPECT_EQ(outcome.output.find(raw), std::string::npos) << command;
    }
    ASSERT_TRUE(nlohmann::json::accept(outcome.output)) << command;
  }
  const Outcome outcome = vespctl({"decode", "-"}, captureOf(std::vector{event}));
  EXPECT_EQ(nlohmann::json::parse(outcome.output)["record"]["bearer_contexts"][0]["apn"], name);
  EXPECT_THAT(
      outcome.output,
      HasSubstr("\"a\\u001b\\u007f\\u009b\\u061c\\u200e\\u202e\\u202c\\u2028\\u2066\u00a0\u2027\u206a\u00e9z\""));
}

TEST(VespctlDecode, ShowsTheReportedCodesWithoutConversion) {
  EXPECT_EQ(decoded(binary("0893a6f301 1000 1a08 1206 3000 5801 6003")),
            std::string(head) +
                R"("metric_id":3986195,"profile_id":0,"message":"KCellularLteCarrierAggregationStatus","ok":true,)"
                R"("record":{"scc_list":[{"dl_bandwidth":0,"rsrp":-1,"rsrq":-2}]}})"
                "\n");
}

TEST(VespctlDecode, ReadsStandardInput) {
  const Outcome outcome = vespctl({"decode", "-"}, captureOf(std::vector{packetAt(1700000000, 123456789, rrcState)}));
  EXPECT_EQ(outcome.status, 0);
  EXPECT_EQ(outcome.output, head + rrcStateJson + "\n");
}

TEST(VespctlDecode, PrintsNothingForACaptureWithoutPackets) {
  const Outcome outcome = vespctl({"decode", "-"}, captureOf(std::vector<std::string>{}));
  EXPECT_EQ(outcome.status, 0);
  EXPECT_EQ(outcome.output + outcome.errors, "");
}

TEST(VespctlDecode, OfATruncatedCapturePrintsAllBeforeTheCut) {
  const TemporaryFolder folder;
  std::string bytes = captureOf(std::vector{packetAt(0, 0, rrcState), packetAt(1, 0, rrcState)});
  bytes.pop_back();
  const std::string file = folder.write("cut.pcap", bytes);
  const Outcome outcome = vespctl({"decode", file});
  EXPECT_EQ(outcome.status, 2);
  EXPECT_EQ(linesOf(outcome.output), Lines{R"({"index":0,"time":"0.000000000",)" + rrcStateJson});
  EXPECT_EQ(outcome.errors,
            "vespctl: " + file + ": packet 1: truncated dump file; tried to read 20 captured bytes, only got 19\n");
}

TEST(Vespctl, PrintsItsVersion) {
  const Outcome outcome = vespctl({"--version"});
  EXPECT_EQ(outcome.status, 0);
  EXPECT_EQ(outcome.output, "vespctl " VESPSCOPE_VERSION "\n");
  EXPECT_EQ(outcome.errors, "");
}

struct BadInput {
  const char* name;
  std::string bytes;
  std::string reason;
};

void PrintTo(const BadInput& input, std::ostream* out) { *out << input.name; }

class VespctlDecodeBadInput : public ::testing::TestWithParam<BadInput> {};

INSTANTIATE_TEST_SUITE_P(
    Inputs, VespctlDecodeBadInput,
    ::testing::Values(BadInput{"Empty", "", "is empty"},
                      BadInput{"OtherText", "This is no capture file.", "not a capture: it is text"},
                      BadInput{"OtherLinkType", binary("4d3cb2a1 0200 0400 00000000 00000000 00000400 01000000"),
                               "link type 1 (EN10MB) where 147 (USER0) is needed"},
                      BadInput{"NoIdentifier", captureOf(std::vector{packetAt(0, 0, binary("1001"))}),
                               "packet 0: a MetricEvent without metric_id"},
                      BadInput{"NoMessage", captureOf(std::vector{packetAt(0, 0, binary("08"))}),
                               "packet 0: not a MetricEvent: field 1 reaches past the end"}),
    [](const ::testing::TestParamInfo<BadInput>& input) { return std::string(input.param.name); });

TEST_P(VespctlDecodeBadInput, IsReportedInOneLineWithTheFileAndStatus2ByEveryCommandThatReads) {
  const TemporaryFolder folder;
  const std::string file = folder.write("bad.pcap", GetParam().bytes);
  for (const char* command : {"decode", "state", "screens"}) {
    const Outcome outcome = vespctl({command, file});
    EXPECT_EQ(outcome.status, 2) << command;
    EXPECT_EQ(outcome.errors, "vespctl: " + file + ": " + GetParam().reason + "\n") << command;
  }
  EXPECT_EQ(vespctl({"decode", file}).output, "");
}

TEST(Vespctl, NamesAFileThatCannotBeOpened) {
  for (const char* command : {"decode", "state", "screens"}) {
    const Outcome outcome = vespctl({command, "/nowhere/a.pcap"});
    EXPECT_EQ(outcome.status, 2);
    EXPECT_EQ(outcome.errors, "vespctl: /nowhere/a.pcap: cannot be opened: No such file or directory\n");
    EXPECT_EQ(outcome.output, "");
  }
}

TEST(Vespctl, NamesStandardInputWhenThatIsBad) {
  EXPECT_EQ(vespctl({"decode", "-"}, "nonsense of some length").errors,
            "vespctl: standard input: not a capture: unknown file format\n");
}

TEST(Vespctl, NamesACommandThatDoesNotExist) {
  const Outcome outcome = vespctl({"decoed", "a.pcap"});
  EXPECT_EQ(outcome.status, 2);
  EXPECT_EQ(outcome.errors,
            "vespctl: there is no command \"decoed\", only decode, state, screens, convert, record, doctor, status "
            "(see vespctl --help)\n");
}

TEST(Vespctl, PointsAtTheConversionOfAModemLog) {
  const TemporaryFolder folder;
  // A record of an unknown code.
  const std::string log("\x10\x00\x0c\x00\x0c\x00\xfe\xff\x00\x00\x01\x00\x00\x00\x00\x00\xea\xa9\x7e", 19);
  const std::string file = folder.write("drive,2.mi2log", log);
  for (const char* command : {"decode", "state", "screens"}) {
    EXPECT_EQ(vespctl({command, file}).errors,
              "vespctl: " + file + ": is a modem log, not a capture; convert it first: vespctl convert diag:" +
                  (folder / "drive,,2.mi2log") + " OUT.pcap\n");
  }
}

TEST(Vespctl, PrintsNoEscapeOfAFilesName) {
  EXPECT_EQ(vespctl({"decode", "/nowhere/\x1b[2J\n\x9b.pcap"}).errors,
            "vespctl: /nowhere/␛[2J␊�.pcap: cannot be opened: No such file or directory\n");
  EXPECT_THAT(vespctl({"\x1b]0;title\x07"}).errors,
              ::testing::StartsWith("vespctl: there is no command \"␛]0;title␇\""));
}

TEST(VespctlDecode, ReadsOnBehindDamagedFilesOfAFolderAndNamesEach) {
  const TemporaryFolder folder;
  const std::string run = captureOf(scriptedRun());
  // A file after a power failure; a pipe without a writer; a file that is not a capture.
  static_cast<void>(folder.write("a.pcap", run + std::string(4096, '\0')));
  ASSERT_EQ(::mkfifo((folder / "b.pcap").c_str(), 0600), 0);
  static_cast<void>(folder.write("c.pcap", "a letter"));
  static_cast<void>(folder.write("d.pcap", run));
  const Outcome outcome = vespctl({"decode", folder.path().string()});
  EXPECT_EQ(outcome.status, 2);
  EXPECT_EQ(linesOf(outcome.output).size(), 2 * scriptedRun().size());
  const Lines errors = linesOf(outcome.errors);
  ASSERT_EQ(errors.size(), 3U);
  EXPECT_EQ(errors[0], "vespctl: " + (folder / "a.pcap") +
                           ": packet 29: a packet without bytes: the recording is damaged here, for example by a power "
                           "failure; the rest of the "
                           "file is skipped");
  EXPECT_THAT(errors[1], ::testing::StartsWith("vespctl: " + (folder / "b.pcap") + ": is a pipe, not a file"));
  EXPECT_THAT(errors[2], ::testing::StartsWith("vespctl: " + (folder / "c.pcap") + ": not a capture: "));
  EXPECT_EQ(vespctl({"state", folder.path().string()}).errors, outcome.errors);
}

TEST(Vespctl, ReportsAWrongCallInOneLineWithStatus2) {
  for (const auto& [arguments, error] : std::vector<std::pair<Lines, std::string>>{
           {{}, "vespctl: A subcommand is required (see vespctl --help)\n"},
           {{"decode"}, "vespctl: FILE is required (see vespctl --help)\n"},
           {{"decode", "a", "b"}, "vespctl: The following argument was not expected: b (see vespctl --help)\n"}}) {
    const Outcome outcome = vespctl(arguments);
    EXPECT_EQ(outcome.status, 2);
    EXPECT_EQ(outcome.errors, error);
    EXPECT_EQ(outcome.output, "");
  }
}

TEST(Vespctl, HelpsOnRequest) {
  const Outcome outcome = vespctl({"--help"});
  EXPECT_EQ(outcome.status, 0);
  EXPECT_EQ(outcome.errors, "");
  for (const auto& [command, operand] : std::vector<std::pair<std::string, std::string>>{{"decode", "FILE"},
                                                                                         {"state", "FILE"},
                                                                                         {"screens", "LAUNCH"},
                                                                                         {"convert", "SOURCE"},
                                                                                         {"record", "OUT.pcap"}}) {
    EXPECT_NE(outcome.output.find("\n  " + command + " "), std::string::npos) << command;
    EXPECT_NE(vespctl({command, "--help"}).output.find(operand), std::string::npos) << command;
  }
}

}  // namespace
}  // namespace vespscope::test
