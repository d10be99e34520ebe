// vespctl convert as a user runs it.
#include <fcntl.h>
#include <sys/ioctl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <csignal>
#include <filesystem>
#include <map>
#include <set>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include "Program.h"
#include "support/Eventually.h"
#include "support/Process.h"
#include "support/ScratchFile.h"
#include "support/ScriptedRun.h"
#include "support/SharedCaptures.h"
#include "support/WrittenLog.h"

namespace vespscope::test {
namespace {

using Json = nlohmann::ordered_json;
using ::testing::EndsWith;
using ::testing::StartsWith;

std::vector<Json> decoded(const std::string& file) {
  std::vector<Json> packets;
  for (const std::string& line : linesOf(vespctl({"decode", file}).output)) packets.push_back(Json::parse(line));
  return packets;
}

std::map<int, int> eventsByProfile(const std::string& file) {
  std::map<int, int> events;
  for (const Json& packet : decoded(file)) ++events[packet["profile_id"].get<int>()];
  return events;
}

void expectSuccess(const Outcome& outcome) {
  EXPECT_EQ(outcome.status, 0);
  EXPECT_EQ(outcome.output, "");
  // There is no terminal for the progress line.
  EXPECT_EQ(outcome.errors, "");
}

TEST(VespctlConvert, OfACaptureGivesTheSameCapture) {
  const TemporaryFolder folder;
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
  const TemporaryFolder folder;
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

TEST(VespctlConvert, RunsALoopForTheGivenTime) {
  const TemporaryFolder folder;
  const std::string run = folder.write("run.pcap", captureOf(scriptedRun()));
  expectSuccess(vespctl({"convert", "replay:" + run + ",loop", folder / "out.pcap", "--seconds", "58"}));
  // A round of 29 events takes 28 seconds, and one more until the next begins.
  const std::vector<Json> packets = decoded(folder / "out.pcap");
  ASSERT_EQ(packets.size(), 59U);
  EXPECT_EQ(packets[29]["record"], packets[0]["record"]);
  EXPECT_EQ(packets[58]["record"], packets[0]["record"]);
}

TEST(VespctlConvert, RefusesWhatHasNoEnd) {
  const TemporaryFolder folder;
  const std::string run = folder.write("run.pcap", captureOf(scriptedRun()));
  for (const std::string& source : {std::string("scenario:seed=7"), "replay:" + run + ",loop"}) {
    const Outcome outcome = vespctl({"convert", source, folder / "out.pcap"});
    EXPECT_EQ(outcome.status, 2);
    EXPECT_EQ(outcome.errors, "vespctl: " + source + ": has no end; limit it with --seconds\n");
    EXPECT_FALSE(std::filesystem::exists(folder / "out.pcap"));
  }
}

TEST(VespctlConvert, OfALoopWithoutAnEventEnds) {
  const TemporaryFolder folder;
  const std::string empty = folder.write("empty.pcap", captureOf(std::vector<MetricEvent>{}));
  expectSuccess(vespctl({"convert", "replay:" + empty + ",loop", folder / "out.pcap", "--seconds", "5"}));
  EXPECT_EQ(contentsOf(folder / "out.pcap"), contentsOf(empty));
}

TEST(VespctlConvert, OfASimulatedDriveHoldsEveryHandledMetricWithinTwoMinutes) {
  const TemporaryFolder folder;
  expectSuccess(vespctl({"convert", "scenario:seed=3", folder / "out.pcap", "--seconds", "120"}));
  std::set<std::string> messages;
  const std::vector<Json> packets = decoded(folder / "out.pcap");
  for (const Json& packet : packets) {
    // The drive also reports the two metrics without a handler.
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

TEST(VespctlConvert, OfACutCaptureLeavesAPartialFileWithWhatCameBeforeTheCut) {
  const TemporaryFolder folder;
  const std::string run = captureOf(scriptedRun());
  const std::string cut = folder.write("cut.pcap", run.substr(0, run.size() - 1));
  const std::string good = folder.write("out.pcap", "precious");
  const Outcome outcome = vespctl({"convert", "--force", "replay:" + cut, good});
  EXPECT_EQ(outcome.status, 2);
  EXPECT_THAT(outcome.errors, StartsWith("vespctl: " + cut + ": packet 28: truncated dump file"));
  EXPECT_THAT(outcome.errors, EndsWith("; 28 events are in " + (folder / "out.partial.pcap") + "\n"));
  EXPECT_EQ(linesOf(outcome.errors).size(), 1U);
  EXPECT_EQ(decoded(folder / "out.partial.pcap").size(), 28U);
  EXPECT_EQ(contentsOf(good), "precious");
}

TEST(VespctlConvert, KeepsBothSimCardsOfALogUnlessOneIsNamed) {
  const TemporaryFolder folder;
  const Bytes bytes = writtenLogOfTwoSims();
  const std::string log = "diag:" + folder.write("two.mi2log", std::string(bytes.begin(), bytes.end()));
  expectSuccess(vespctl({"convert", log, folder / "both.pcap"}));
  const std::map<int, int> both = eventsByProfile(folder / "both.pcap");
  ASSERT_EQ(both.size(), 2U);
  EXPECT_GE(both.at(1), twoSimsRecords);
  EXPECT_GE(both.at(2), twoSimsRecords);
  expectSuccess(vespctl({"convert", log + ",sim=1", folder / "one.pcap"}));
  EXPECT_EQ(eventsByProfile(folder / "one.pcap"), (std::map<int, int>{{1, both.at(1)}}));
}

TEST(VespctlConvert, OfAFolderReadsOnBehindADamagedFile) {
  const TemporaryFolder folder;
  std::filesystem::create_directory(folder / "in");
  const std::string run = captureOf(scriptedRun());
  const std::string damaged = folder.write("in/a.pcap", run + std::string(4096, '\0'));
  static_cast<void>(folder.write("in/b.pcap", run));
  const Outcome outcome = vespctl({"convert", "replay:" + (folder / "in"), folder / "out.pcap"});
  EXPECT_EQ(outcome.status, 2);
  EXPECT_THAT(outcome.errors, StartsWith("vespctl: " + damaged + ": packet 29: a packet without bytes: "));
  EXPECT_THAT(outcome.errors, EndsWith("; 58 events are in " + (folder / "out.partial.pcap") + "\n"));
  EXPECT_EQ(decoded(folder / "out.partial.pcap").size(), 58U);
}

TEST(VespctlConvert, DoesNotReplaceAFileWithoutForce) {
  const TemporaryFolder folder;
  const std::string run = captureOf(scriptedRun());
  const std::string source = "replay:" + folder.write("run.pcap", run);
  const std::string output = folder.write("out.pcap", "precious");
  ASSERT_EQ(::chmod(output.c_str(), 0666), 0);
  const Outcome refused = vespctl({"convert", source, output});
  EXPECT_EQ(refused.status, 2);
  EXPECT_EQ(refused.errors, "vespctl: " + output + ": exists already; --force replaces it\n");
  EXPECT_EQ(contentsOf(output), "precious");
  expectSuccess(vespctl({"convert", source, output, "--force"}));
  EXPECT_EQ(contentsOf(output), run);
  // Events contain identities: only its owner can access the new file, whatever the old file's mode was.
  struct stat status {};
  ASSERT_EQ(::stat(output.c_str(), &status), 0);
  EXPECT_EQ(status.st_mode & 07777, 0600U);
  EXPECT_FALSE(std::filesystem::exists(folder / "out.partial.pcap"));
}

TEST(VespctlConvert, EndedByASignalLeavesTheGoodFileAndAPartialOne) {
  const TemporaryFolder folder;
  const std::string run = captureOf(scriptedRun());
  const std::string output = folder.write("out.pcap", "precious");
  for (const int number : {SIGTERM, SIGINT, SIGHUP}) {
    const std::string pipe = folder / ("pipe" + std::to_string(number));
    ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
    const int end = ::open(pipe.c_str(), O_RDWR | O_CLOEXEC);
    ASSERT_EQ(::write(end, run.data(), run.size() - 1), static_cast<ssize_t>(run.size() - 1));
    Process process(std::filesystem::path(VESPSCOPE_BIN_DIR) / "vespctl", {"convert", "--force", "replay:-", output},
                    {}, pipe);
    const std::string partial = folder / "out.partial.pcap";
    ASSERT_TRUE(eventually([&] {
      int waiting = 1;
      return std::filesystem::exists(partial) && ::ioctl(end, FIONREAD, &waiting) == 0 && waiting == 0;
    }));
    process.readFor(std::chrono::seconds(1));  // everything read so far is converted by then
    process.signal(number);
    EXPECT_EQ(process.wait(), (ProcessEnd{true, number}));
    EXPECT_EQ(process.errors(), "vespctl: interrupted; 28 events are in " + partial + "\n");
    EXPECT_EQ(contentsOf(output), "precious");
    EXPECT_EQ(decoded(partial).size(), 28U);
    std::filesystem::remove(partial);
    ::close(end);
  }
}

TEST(VespctlConvert, DoesNotWriteOverItsOwnSource) {
  const TemporaryFolder folder;
  const std::string run = folder.write("run.pcap", captureOf(scriptedRun()));
  std::filesystem::create_symlink(run, folder / "link.pcap");
  for (const std::string& output : {run, folder / "link.pcap"}) {
    const Outcome outcome = vespctl({"convert", "replay:" + run, output});
    EXPECT_EQ(outcome.status, 2);
    EXPECT_EQ(outcome.errors, "vespctl: " + output + ": is the source itself\n");
    EXPECT_EQ(contentsOf(run), captureOf(scriptedRun()));
  }
  // A file in the input folder would itself be read.
  const std::string within = folder / "new.pcap";
  EXPECT_EQ(vespctl({"convert", "replay:" + folder.path().string(), within}).errors,
            "vespctl: " + within + ": is the source itself\n");
  EXPECT_FALSE(std::filesystem::exists(within));
}

TEST(VespctlConvert, DoesNotDestroyItsSourceUnderAnotherName) {
  const TemporaryFolder folder;
  std::filesystem::create_directory(folder / "in");
  const std::string run = captureOf(scriptedRun());
  const std::string capture = folder.write("run.pcap", run);
  std::filesystem::create_hard_link(capture, folder / "hard.pcap");
  std::filesystem::create_symlink(capture, folder / "in/link.pcap");
  const std::string tool = std::filesystem::path(VESPSCOPE_BIN_DIR) / "vespctl";
  for (const std::string& words :
       {"replay:- " + capture + " < " + capture, "replay:" + capture + " " + (folder / "hard.pcap"),
        "replay:" + (folder / "in") + " " + capture, "replay:" + capture + " - >> " + capture}) {
    Process shell("/bin/sh", {"-c", tool + " convert --force " + words});
    EXPECT_EQ(shell.wait(), (ProcessEnd{false, 2})) << words;
    EXPECT_THAT(shell.errors(), EndsWith(": is the source itself\n")) << words;
    EXPECT_EQ(contentsOf(capture), run) << words;
  }
  // A record of an unknown code.
  const std::string records("\x10\x00\x0c\x00\x0c\x00\xfe\xff\x00\x00\x01\x00\x00\x00\x00\x00\xea\xa9\x7e", 19);
  const std::string log = folder.write("modem.log", records);
  Process shell("/bin/sh", {"-c", tool + " convert --force diag:- " + log + " < " + log});
  EXPECT_EQ(shell.wait(), (ProcessEnd{false, 2}));
  EXPECT_THAT(shell.errors(), EndsWith(": is the source itself\n"));
  EXPECT_EQ(contentsOf(log), records);
}

TEST(VespctlConvert, KeepsItsReportOutOfTheCaptureWhenStandardDescriptorsAreClosed) {
  const TemporaryFolder folder;
  const std::string run = captureOf(scriptedRun());
  const std::string source = "replay:" + folder.write("run.pcap", run.substr(0, run.size() - 1));
  const std::string tool = std::filesystem::path(VESPSCOPE_BIN_DIR) / "vespctl";
  Process shell("/bin/sh", {"-c", tool + " convert " + source + " " + (folder / "out.pcap") + " <&- >&- 2>&-"});
  EXPECT_EQ(shell.wait(), (ProcessEnd{false, 2}));
  EXPECT_EQ(decoded(folder / "out.partial.pcap").size(), 28U);
  // A closed standard output cannot take a capture.
  Process closed("/bin/sh", {"-c", tool + " convert " + source + " - >&-"});
  EXPECT_EQ(closed.wait(), (ProcessEnd{false, 2}));
  EXPECT_EQ(closed.errors(), "vespctl: standard output: cannot be written: Bad file descriptor\n");
}

TEST(VespctlConvert, LeavesTheOutputAloneWhenTheSourceCannotBeRead) {
  const TemporaryFolder folder;
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

TEST(VespctlConvert, NamesAnOutputThatCannotBeWritten) {
  const TemporaryFolder folder;
  const std::string run = folder.write("run.pcap", captureOf(scriptedRun()));
  const Outcome absent = vespctl({"convert", "replay:" + run, "/nowhere/out.pcap"});
  EXPECT_EQ(absent.status, 2);
  EXPECT_EQ(absent.errors, "vespctl: /nowhere/out.pcap: cannot be created: No such file or directory\n");
  const Outcome full = vespctl({"convert", "replay:" + run, "/dev/full"});
  EXPECT_EQ(full.status, 2);
  EXPECT_EQ(full.errors, "vespctl: /dev/full: cannot be written: No space left on device\n");
}

// Like other shell tools: the rest of the output is not needed.
TEST(Vespctl, EndsQuietlyWhenItsReaderLeaves) {
  const TemporaryFolder folder;
  std::vector<MetricEvent> events;
  while (events.size() < 3000) {
    for (const MetricEvent& event : scriptedRun()) events.push_back(event);
  }
  const std::string run = folder.write("run.pcap", captureOf(events));
  const std::string tool = std::filesystem::path(VESPSCOPE_BIN_DIR) / "vespctl";
  for (const std::string& command : {"decode " + run, "convert replay:" + run + " -"}) {
    Process shell("/bin/bash",
                  {"-c", "trap '' PIPE; " + tool + " " + command + " | head -c 9 >/dev/null; exit ${PIPESTATUS[0]}"});
    EXPECT_EQ(shell.wait(), (ProcessEnd{false, 128 + SIGPIPE})) << command;
    EXPECT_EQ(shell.errors(), "");
  }
}

TEST(Vespctl, ReportsAStandardOutputThatIsFull) {
  const TemporaryFolder folder;
  const std::string run = folder.write("run.pcap", captureOf(scriptedRun()));
  for (const char* command : {"decode", "state", "screens"}) {
    const std::string program = std::filesystem::path(VESPSCOPE_BIN_DIR) / "vespctl";
    Process shell("/bin/sh", {"-c", program + " " + command + " " + run + " >/dev/full"});
    EXPECT_EQ(shell.wait(), (ProcessEnd{false, 2}));
    EXPECT_EQ(shell.errors(), "vespctl: standard output: No space left on device\n");
  }
}

TEST(VespctlConvert, ReportsHowTheRecordsOfAModemLogWereHandled) {
  const TemporaryFolder folder;
  // A record of an unknown code, then a frame with a wrong checksum.
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

TEST(VespctlConvert, OfAWrittenModemLogGivesEventsThatAllDecode) {
  const ScratchFile log("written.mi2log", writtenLog());
  const TemporaryFolder folder;
  expectSuccess(vespctl({"convert", "diag:" + log.path(), folder / "written.pcap"}));
  const std::vector<Json> packets = decoded(folder / "written.pcap");
  EXPECT_GE(packets.size(), static_cast<std::size_t>(writtenLogCells + writtenLogMeasurements));
  EXPECT_TRUE(std::all_of(packets.begin(), packets.end(), [](const Json& packet) { return packet["ok"] == true; }));
  const Json screens = Json::parse(vespctl({"screens", folder / "written.pcap", "LTE", "Serving Cell Info"}).output);
  const std::string rows = screens[0]["sections"][0]["rows"].dump();
  EXPECT_NE(rows.find(R"(["phy_cell_id","186"])"), std::string::npos) << rows;
}

TEST(VespctlConvert, OfARealModemLogGivesEventsThatAllDecode) {
  const std::string log = sharedCapture("lte-ca-drive.mi2log");
  SKIP_WITHOUT_CAPTURE(log);
  const TemporaryFolder folder;
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
}  // namespace vespscope::test
