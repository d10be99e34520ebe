#include <algorithm>
#include <filesystem>
#include <set>
#include <string>
#include <vector>

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include "Program.h"
#include "support/Process.h"
#include "support/ScriptedRun.h"

namespace vespscope::testing {
namespace {

using Json = nlohmann::ordered_json;

std::vector<Json> decoded(const std::string& file) {
  std::vector<Json> packets;
  for (const std::string& line : linesOf(vespctl({"decode", file}).output)) packets.push_back(Json::parse(line));
  return packets;
}

void expectSuccess(const Outcome& outcome) {
  EXPECT_EQ(outcome.status, 0);
  EXPECT_EQ(outcome.output, "");
  // There is no terminal to show progress on.
  EXPECT_EQ(outcome.errors, "");
}

TEST(VespctlConvert, OfACaptureGivesTheSameCapture) {
  const test::TemporaryFolder folder;
  const std::string run = captureOf(scriptedRun());
  expectSuccess(vespctl({"convert", "replay:" + folder.write("run.pcap", run), folder / "out.pcap"}));
  EXPECT_EQ(contentsOf(folder / "out.pcap"), run);
}

TEST(VespctlConvert, ReadsStandardInputAndWritesStandardOutput) {
  const std::string run = captureOf(scriptedRun());
  const Outcome outcome = vespctl({"convert", "replay:-", "-"}, run);
  EXPECT_EQ(outcome.status, 0);
  EXPECT_EQ(outcome.output, run);
  EXPECT_EQ(outcome.errors, "");
}

TEST(VespctlConvert, LeavesOutWhatComesBeforeTheStartAndWhatComesAfterTheLimit) {
  const test::TemporaryFolder folder;
  const std::string run = folder.write("run.pcap", captureOf(scriptedRun()));
  // The run's events are one second apart.
  expectSuccess(vespctl({"convert", "replay:" + run + ",start=20", folder / "end.pcap"}));
  const std::vector<Json> end = decoded(folder / "end.pcap");
  ASSERT_EQ(end.size(), 9U);
  EXPECT_EQ(end.front()["time"], "1700000020.000000000");
  expectSuccess(vespctl({"convert", "replay:" + run, folder / "begin.pcap", "--seconds", "4"}));
  const std::vector<Json> begin = decoded(folder / "begin.pcap");
  ASSERT_EQ(begin.size(), 5U);
  EXPECT_EQ(begin.back()["time"], "1700000004.000000000");
}

TEST(VespctlConvert, RunsALoopAsLongAsItIsTold) {
  const test::TemporaryFolder folder;
  const std::string run = folder.write("run.pcap", captureOf(scriptedRun()));
  expectSuccess(vespctl({"convert", "replay:" + run + ",loop", folder / "out.pcap", "--seconds", "58"}));
  // A round of 29 events takes 28 seconds, and one more until the next begins.
  const std::vector<Json> packets = decoded(folder / "out.pcap");
  ASSERT_EQ(packets.size(), 59U);
  EXPECT_EQ(packets[29]["record"], packets[0]["record"]);
  EXPECT_EQ(packets[58]["record"], packets[0]["record"]);
}

TEST(VespctlConvert, RefusesWhatGoesOnWithoutEnd) {
  const test::TemporaryFolder folder;
  const std::string run = folder.write("run.pcap", captureOf(scriptedRun()));
  for (const std::string& source : {std::string("scenario:seed=7"), "replay:" + run + ",loop"}) {
    const Outcome outcome = vespctl({"convert", source, folder / "out.pcap"});
    EXPECT_EQ(outcome.status, 2);
    EXPECT_EQ(outcome.errors, "vespctl: " + source + ": goes on without end; say with --seconds how much of it\n");
    EXPECT_FALSE(std::filesystem::exists(folder / "out.pcap"));
  }
}

TEST(VespctlConvert, OfALoopWithoutAnEventEnds) {
  const test::TemporaryFolder folder;
  const std::string empty = folder.write("empty.pcap", captureOf(std::vector<MetricEvent>{}));
  expectSuccess(vespctl({"convert", "replay:" + empty + ",loop", folder / "out.pcap", "--seconds", "5"}));
  EXPECT_EQ(contentsOf(folder / "out.pcap"), contentsOf(empty));
}

TEST(VespctlConvert, OfASimulatedDriveHoldsEveryHandledMetricWithinTwoMinutes) {
  const test::TemporaryFolder folder;
  expectSuccess(vespctl({"convert", "scenario:seed=3", folder / "out.pcap", "--seconds", "120"}));
  std::set<std::string> messages;
  const std::vector<Json> packets = decoded(folder / "out.pcap");
  for (const Json& packet : packets) {
    // The drive also reports the two metrics that are not handled.
    if (packet["message"].is_null()) continue;
    EXPECT_EQ(packet["ok"], true);
    messages.insert(packet["message"]);
  }
  EXPECT_EQ(messages.size(), 29U);
  const double seconds =
      std::stod(packets.back()["time"].get<std::string>()) - std::stod(packets.front()["time"].get<std::string>());
  EXPECT_GT(seconds, 110);
  EXPECT_LE(seconds, 120.001);
}

TEST(VespctlConvert, OfACutCaptureKeepsWhatCameBeforeTheCut) {
  const test::TemporaryFolder folder;
  const std::string run = captureOf(scriptedRun());
  const std::string cut = folder.write("cut.pcap", run.substr(0, run.size() - 1));
  const Outcome outcome = vespctl({"convert", "replay:" + cut, folder / "out.pcap"});
  EXPECT_EQ(outcome.status, 2);
  EXPECT_EQ(outcome.errors.rfind("vespctl: " + cut + ": packet 28: truncated dump file", 0), 0U) << outcome.errors;
  EXPECT_EQ(linesOf(outcome.errors).size(), 1U);
  EXPECT_EQ(decoded(folder / "out.pcap").size(), 28U);
}

TEST(VespctlConvert, DoesNotWriteOverItsOwnSource) {
  const test::TemporaryFolder folder;
  const std::string run = folder.write("run.pcap", captureOf(scriptedRun()));
  std::filesystem::create_symlink(run, folder / "link.pcap");
  for (const std::string& output : {run, folder / "link.pcap"}) {
    const Outcome outcome = vespctl({"convert", "replay:" + run, output});
    EXPECT_EQ(outcome.status, 2);
    EXPECT_EQ(outcome.errors, "vespctl: " + output + ": is the source itself\n");
    EXPECT_EQ(contentsOf(run), captureOf(scriptedRun()));
  }
  // A file in the folder that is read would itself be read.
  const std::string within = folder / "new.pcap";
  EXPECT_EQ(vespctl({"convert", "replay:" + folder.path().string(), within}).errors,
            "vespctl: " + within + ": is the source itself\n");
  EXPECT_FALSE(std::filesystem::exists(within));
}

TEST(VespctlConvert, LeavesTheOutputAloneWhenTheSourceCannotBeRead) {
  const test::TemporaryFolder folder;
  const std::string output = folder.write("out.pcap", "precious");
  for (const auto& [source, reason] : std::vector<std::pair<std::string, std::string>>{
           {"replay:/nowhere.pcap", "/nowhere.pcap: cannot be opened: No such file or directory"},
           {"modemmanager", "modemmanager: a live modem is recorded, not converted"},
           {"drive",
            "source \"drive\": a source is scenario[:seed=N], replay:FILE, diag:FILE, diag:PORT or "
            "modemmanager"},
           {"diag:/dev/ttyUSB0", "diag:/dev/ttyUSB0: a live modem is recorded, not converted"}}) {
    const Outcome outcome = vespctl({"convert", source, output});
    EXPECT_EQ(outcome.status, 2);
    EXPECT_EQ(outcome.errors, "vespctl: " + reason + "\n");
    EXPECT_EQ(contentsOf(output), "precious");
  }
}

TEST(VespctlConvert, TellsAnOutputThatCannotBeWritten) {
  const test::TemporaryFolder folder;
  const std::string run = folder.write("run.pcap", captureOf(scriptedRun()));
  const Outcome absent = vespctl({"convert", "replay:" + run, "/nowhere/out.pcap"});
  EXPECT_EQ(absent.status, 2);
  EXPECT_EQ(absent.errors, "vespctl: /nowhere/out.pcap: cannot be created: No such file or directory\n");
  const Outcome full = vespctl({"convert", "replay:" + run, "/dev/full"});
  EXPECT_EQ(full.status, 2);
  EXPECT_EQ(full.errors, "vespctl: /dev/full: cannot be written: No space left on device\n");
}

TEST(Vespctl, TellsAStandardOutputThatIsFull) {
  const test::TemporaryFolder folder;
  const std::string run = folder.write("run.pcap", captureOf(scriptedRun()));
  for (const char* command : {"decode", "state", "screens"}) {
    const std::string program = std::filesystem::path(VESPSCOPE_BIN_DIR) / "vespctl";
    Process shell("/bin/sh", {"-c", program + " " + command + " " + run + " >/dev/full"});
    EXPECT_EQ(shell.wait(), (ProcessEnd{false, 2}));
    EXPECT_EQ(shell.errors(), "vespctl: standard output: No space left on device\n");
  }
}

TEST(VespctlConvert, TellsWhatBecameOfTheRecordsOfAModemLog) {
  const test::TemporaryFolder folder;
  // A record of a code that nobody knows, then a frame whose checksum is wrong.
  const std::string log(
      "\x10\x00\x0c\x00\x0c\x00\xfe\xff\x00\x00\x01\x00\x00\x00\x00\x00\xea\xa9\x7e"
      "abc\x7e",
      23);
  const std::string source = "diag:" + folder.write("modem.log", log);
  const Outcome outcome = vespctl({"convert", source, folder / "out.pcap", "--report"});
  EXPECT_EQ(outcome.status, 0) << outcome.errors;
  EXPECT_NE(outcome.errors.find("  good                              1\n"), std::string::npos) << outcome.errors;
  EXPECT_NE(outcome.errors.find("  bad checksum                      1  dropped\n"), std::string::npos);
  EXPECT_NE(outcome.errors.find("  FFFE                              1  not mapped: "), std::string::npos);
  EXPECT_NE(outcome.errors.find("  all                               1  0 mapped, 1 not mapped, 0 broken\n"),
            std::string::npos);
  const Outcome other = vespctl({"convert", "scenario", folder / "out.pcap", "--seconds", "1", "--report"});
  EXPECT_EQ(other.status, 2);
  EXPECT_EQ(other.errors, "vespctl: scenario: only a modem log has a report\n");
}

TEST(VespctlConvert, OfARealModemLogGivesEventsThatAllDecode) {
  const std::string log = VESPSCOPE_SOURCE_DIR "/../shared/captures/lte-ca-drive.mi2log";
  if (!std::filesystem::exists(log)) GTEST_SKIP() << "the recorded drive is not there";
  const test::TemporaryFolder folder;
  expectSuccess(vespctl({"convert", "diag:" + log, folder / "drive.pcap"}));
  const std::vector<Json> packets = decoded(folder / "drive.pcap");
  EXPECT_GT(packets.size(), 1000U);
  EXPECT_TRUE(std::all_of(packets.begin(), packets.end(), [](const Json& packet) { return packet["ok"] == true; }));
  const Json screens = Json::parse(vespctl({"screens", folder / "drive.pcap", "LTE", "Serving Cell Info"}).output);
  const std::string rows = screens[0]["sections"][0]["rows"].dump();
  EXPECT_NE(rows.find(R"(["phy_cell_id","185"])"), std::string::npos) << rows;
  EXPECT_NE(rows.find(R"(["dl_freq","5780"])"), std::string::npos) << rows;
}

}  // namespace
}  // namespace vespscope::testing
