// vespctl doctor as its user runs it.
#include <fcntl.h>
#include <unistd.h>

#include <algorithm>
#include <filesystem>
#include <set>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include "Program.h"
#include "support/FakeLogPort.h"
#include "support/LogWriter.h"
#include "support/ScratchFile.h"
#include "support/ScriptedRun.h"
#include "support/SharedCaptures.h"
#include "support/WrittenLog.h"
#include "tools/vespctl/RecordScreens.h"

namespace vespscope::test {
namespace {

using Json = nlohmann::ordered_json;
using ::testing::Each;
using ::testing::HasSubstr;
using ::testing::Not;
using ::testing::SizeIs;
using ::testing::StartsWith;

constexpr std::chrono::seconds now{1'700'000'000};

// The text with its line ends and indentations as single blanks.
std::string flat(const std::string& text) {
  std::string words;
  for (const char each : text) {
    const bool blank = each == ' ' || each == '\n';
    if (!blank || (!words.empty() && words.back() != ' ')) words += blank ? ' ' : each;
  }
  return words;
}

Json examined(const std::string& subject) { return Json::parse(vespctl({"doctor", "--json", subject}).output); }

// "filled", or the reason why the screen stays empty.
std::string stateOf(const Json& json, const std::string& launch, const std::string& row) {
  for (const Json& screen : json["screens"]) {
    if (screen["launch"] != launch || screen["row"] != row) continue;
    return screen["filled"].get<bool>() ? "filled" : screen.value("reason", "empty");
  }
  return "no such screen";
}

TEST(VespctlDoctor, AnswersInTheFirstLineWhatALogFills) {
  const ScratchFile log("written.mi2log", writtenLog());
  const Outcome outcome = vespctl({"doctor", log.path()});
  EXPECT_EQ(outcome.status, 0);
  EXPECT_EQ(outcome.errors, "");
  EXPECT_THAT(flat(outcome.output),
              StartsWith(log.path() + ": a modem log that plays for 9 min 59 s and fills 2 of the viewer's 36 screens "
                                      "Screens with values LTE: Serving Cell Info, Serving Cell Meas "));
  EXPECT_THAT(flat(outcome.output), HasSubstr("LTE on: cells (B0C2), levels (B193) "));
  EXPECT_THAT(flat(outcome.output), HasSubstr("UMTS, GSM: no records of their own in the log"));
  EXPECT_THAT(outcome.output, HasSubstr("\nNext\n  vespscope " + log.path() + "\n"));
}

TEST(VespctlDoctor, StaysWithin80Columns) {
  const std::string path = sharedCapture("lte-mobility.mi2log");
  SKIP_WITHOUT_CAPTURE(path);
  std::vector<std::string> lines = linesOf(vespctl({"doctor", path}).output);
  // A command is copied as a whole.
  std::erase_if(lines, [](const std::string& line) { return line.starts_with("  vesp"); });
  ASSERT_GT(lines.size(), 20U);
  EXPECT_THAT(lines, Each(SizeIs(::testing::Le(80U))));
}

TEST(VespctlDoctor, StatesWhatRecordsOfAnUnreadVersionCost) {
  LogWriter log;
  for (int i = 0; i < 7; ++i) log.record(0xB193, now, {1, 1, 0, 0, 25, 99, 8, 0, 1, 2, 3, 4});
  log.record(0xB0C1, now, {2, 1});
  const ScratchFile file("unread.mi2log", log.bytes());
  const Outcome outcome = vespctl({"doctor", file.path()});
  EXPECT_EQ(outcome.status, 1);
  const std::string text = flat(outcome.output);
  EXPECT_THAT(text, StartsWith(file.path() + ": a modem log that fills no screen: its records are not read "));
  EXPECT_THAT(text, HasSubstr("B193 subpacket 25 v99: 7 of the levels of the LTE serving cells; they would fill "
                              "LTE Serving Cell Meas, LTE CA Status, LTE Serving Cell Info "));
  EXPECT_THAT(text, HasSubstr("1 record of codes whose contents are not known: B0C1 "));
  EXPECT_THAT(text, HasSubstr("vespctl convert --unread FOLDER diag:" + file.path()));
  const Json json = examined(file.path());
  EXPECT_EQ(stateOf(json, "LTE", "Serving Cell Meas"),
            "records that could fill it are not read: B193 subpacket 25 v99 (7)");
  EXPECT_EQ(stateOf(json, "LTE", "RRC State"), "not in the log: B0C0");
  EXPECT_EQ(stateOf(json, "LTE", "Tx Power"), "no record that is read fills it");
  EXPECT_EQ(json["log"]["unread"][0]["records"], 7);
  EXPECT_EQ(json["log"]["unread"][0]["screens"],
            (Json{"LTE Serving Cell Meas", "LTE CA Status", "LTE Serving Cell Info"}));
}

TEST(VespctlDoctor, SaysThatLoggingWasOff) {
  LogWriter log;
  for (int i = 0; i < 3; ++i) log.otherFrame();
  const ScratchFile file("off.mi2log", log.bytes());
  const Outcome outcome = vespctl({"doctor", file.path()});
  EXPECT_EQ(outcome.status, 1);
  EXPECT_THAT(flat(outcome.output), StartsWith(file.path() + ": a modem log without records: logging was off "));
  EXPECT_THAT(flat(outcome.output), HasSubstr("was off: the log holds 3 messages of the modem, but no log record"));
  EXPECT_THAT(outcome.output, HasSubstr("rhoxd --source diag:PORT --record FOLDER"));
  EXPECT_EQ(examined(file.path())["log"]["logging"], false);
}

TEST(VespctlDoctor, CountsDamagedFramesAndSimCards) {
  LogWriter log;
  log.record(0xB0C2, now, servingCellPayload(3, {}), 1);
  log.record(0xB0C2, now, servingCellPayload(3, {}), 2);
  log.damagedFrame();
  const ScratchFile file("two.mi2log", log.bytes());
  const std::string text = flat(vespctl({"doctor", file.path()}).output);
  EXPECT_THAT(text, HasSubstr("1 frame is damaged and left out"));
  EXPECT_THAT(text, HasSubstr("SIM cards 1, 2: the viewer shows one of them, which sim=NUMBER chooses"));
  EXPECT_EQ(examined(file.path())["sim_cards"], (Json{1, 2}));
}

TEST(VespctlDoctor, ExaminesACaptureAndAFolder) {
  const TemporaryFolder folder;
  const std::string run = captureOf(scriptedRun());
  const std::string capture = folder.write("run.pcap", run);
  const Json json = examined(capture);
  EXPECT_EQ(json["kind"], "capture");
  EXPECT_EQ(json["events"], 29);
  EXPECT_EQ(stateOf(json, "LTE", "Serving Cell Info"), "filled");
  const Outcome outcome = vespctl({"doctor", folder.path().string()});
  EXPECT_EQ(outcome.status, 0);
  EXPECT_THAT(flat(outcome.output), StartsWith(folder.path().string() + ": a capture that plays for 28 s and fills "));
  // What is damaged is named, and the rest is examined.
  static_cast<void>(folder.write("zz.pcap", run.substr(0, run.size() - 1)));
  const Outcome damaged = vespctl({"doctor", folder.path().string()});
  EXPECT_EQ(damaged.status, 0);
  EXPECT_THAT(flat(damaged.output), HasSubstr("Not all of it can be read: " + (folder / "zz.pcap") + ": packet 28: "));
}

TEST(VespctlDoctor, ReadsStandardInputByTheWordsOfASource) {
  const Bytes log = writtenLog();
  EXPECT_THAT(vespctl({"doctor", "diag:-"}, {log.begin(), log.end()}).output,
              StartsWith("standard input: a modem log that plays for 9 min 59 s"));
  const Outcome outcome = vespctl({"doctor", "-"});
  EXPECT_EQ(outcome.status, 2);
  EXPECT_EQ(outcome.errors, "vespctl: standard input is named diag:- or replay:-\n");
}

TEST(VespctlDoctor, RefusesWhatIsNoRecording) {
  const TemporaryFolder folder;
  const Outcome letter = vespctl({"doctor", folder.write("letter", "Dear reader")});
  EXPECT_EQ(letter.status, 2);
  EXPECT_THAT(letter.errors, StartsWith("vespctl: " + (folder / "letter") + ": neither a capture nor a modem log"));
  const Outcome absent = vespctl({"doctor", "/dev/ttyNONE9"});
  EXPECT_EQ(absent.status, 2);
  EXPECT_THAT(absent.errors, StartsWith("vespctl: /dev/ttyNONE9: there is no such port; "));
  EXPECT_EQ(vespctl({"doctor", "tcp:nowhere"}).status, 2);
}

TEST(VespctlDoctor, AsksAPortThatNothingHolds) {
  const FakeLogPort port(FakeLogPort::Line::terminal, FakeLogPort::Manner::proper, {});
  const Outcome outcome = vespctl({"doctor", port.name()});
  EXPECT_EQ(outcome.status, 0) << outcome.errors;
  EXPECT_THAT(outcome.output, StartsWith(port.name() + ": a modem's log port that answers; its log is off\n"));
  EXPECT_THAT(outcome.output, HasSubstr("  vespscope --manager embedded:diag:" + port.name() + "\n"));
  EXPECT_THAT(port.commands(), ::testing::ElementsAre("counts"));
}

TEST(VespctlDoctor, SaysThatTheLogOfAPortIsOnOrThatNothingAnswers) {
  const Bytes log = writtenLog();
  const FakeLogPort already(FakeLogPort::Line::tcp, FakeLogPort::Manner::already, log);
  const Json on = examined(already.name());
  EXPECT_EQ(on["state"], "logging");
  EXPECT_GT(on["records"], 100);
  const FakeLogPort silent(FakeLogPort::Line::terminal, FakeLogPort::Manner::silent, {});
  const Outcome outcome = vespctl({"doctor", silent.name()});
  EXPECT_EQ(outcome.status, 1);
  EXPECT_THAT(outcome.output, StartsWith(silent.name() + ": does not answer like a log port\n"));
}

TEST(VespctlDoctor, NamesTheProgramThatHoldsAPortAndDoesNotOpenIt) {
  const FakeLogPort port(FakeLogPort::Line::terminal, FakeLogPort::Manner::proper, {});
  const int held = ::open(port.name().c_str(), O_RDWR | O_NOCTTY | O_CLOEXEC);
  ASSERT_GE(held, 0);
  const Outcome outcome = vespctl({"doctor", port.name()});
  ::close(held);
  EXPECT_EQ(outcome.status, 1);
  const std::string self = "test_tools (process " + std::to_string(::getpid()) + ")";
  EXPECT_THAT(outcome.output, StartsWith(port.name() + ": in use by " + self + "\n"));
  EXPECT_THAT(flat(outcome.output), HasSubstr("End " + self + ", then run this again"));
  EXPECT_THAT(port.commands(), ::testing::IsEmpty());
}

TEST(VespctlDoctor, FillsNoScreenFromRecordsThatAreNotListedForIt) {
  for (const char* name :
       {"lte-ca-drive", "lte-four-antennas", "lte-mobility", "nsa-dual-sim-1", "nsa-dual-sim-2", "umts-attach"}) {
    const std::string path = sharedCapture(std::string(name) + ".mi2log");
    SKIP_WITHOUT_CAPTURE(path);
    const Json json = examined(path);
    ASSERT_GT(json["filled"], 0) << name;
    std::set<std::string> reachable;
    for (const Json& code : json["log"]["codes"]) {
      const auto number = static_cast<std::uint16_t>(std::stoul(code.get<std::string>(), nullptr, 16));
      if (const auto* records = tools::findRecordScreens(number)) {
        reachable.insert(records->screens.begin(), records->screens.end());
      }
    }
    for (const Json& screen : json["screens"]) {
      const std::string key = screen["launch"].get<std::string>() + " " + screen["row"].get<std::string>();
      const bool listed = reachable.contains(key);
      EXPECT_TRUE(listed || !screen["filled"].get<bool>()) << name << ": " << key;
    }
  }
}

TEST(VespctlConvertReport, StatesTheScreens) {
  const ScratchFile log("written.mi2log", writtenLog());
  const Outcome outcome = vespctl({"convert", "diag:" + log.path(), "/dev/null", "--report"});
  EXPECT_EQ(outcome.status, 0);
  EXPECT_THAT(outcome.errors, HasSubstr("Screens with values\n  LTE: Serving Cell Info, Serving Cell Meas\n"));
  EXPECT_THAT(flat(outcome.errors), HasSubstr("Tx Power - no record that is read fills it"));
  EXPECT_THAT(outcome.errors, Not(HasSubstr("vespscope ")));
}

}  // namespace
}  // namespace vespscope::test
