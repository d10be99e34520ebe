// vespctl record as a user runs it.
#include <sys/resource.h>

#include <algorithm>
#include <chrono>
#include <csignal>
#include <filesystem>
#include <map>
#include <string>
#include <vector>

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include "Program.h"
#include "registry/MetricRows.h"
#include "rhoxlink/bus/Names.h"
#include "support/Eventually.h"
#include "support/FakeManager.h"
#include "support/Process.h"
#include "support/ScriptedRun.h"

namespace vespscope::test {
namespace {

using Json = nlohmann::ordered_json;

const std::filesystem::path program = std::filesystem::path(VESPSCOPE_BIN_DIR) / "vespctl";
constexpr std::int64_t rrcState = 3952132;

// The packets in a recording so far.
std::vector<Json> packetsOf(const std::string& file) {
  std::vector<Json> packets;
  for (const std::string& line : linesOf(vespctl({"decode", file}).output)) packets.push_back(Json::parse(line));
  return packets;
}

// Returns true when the file has grown to at least `size` bytes; waits a few seconds.
bool grows(const std::string& file, std::uintmax_t size) {
  return eventually([&] { return std::filesystem::exists(file) && std::filesystem::file_size(file) >= size; });
}

// Bytes of a recording of `count` events whose packets have `packet` bytes each.
constexpr std::uintmax_t sizeOf(std::uintmax_t count, std::uintmax_t packet) { return 24 + count * (16 + packet); }

// The size for an event of the RRC state with a payload of two bytes and profile 0.
constexpr std::uintmax_t shortPacket = 5 + 2 + 2 + 2;

class VespctlRecord : public ::testing::Test {
 protected:
  TemporaryFolder folder_;
  FakeManager manager_{folder_ / "socket"};
  std::string file_ = folder_ / "out.pcap";
  std::string partial_ = folder_ / "out.partial.pcap";  // the name until the end
};

TEST_F(VespctlRecord, AsksForEveryMetricThenTurnsDeliveryOnThenAsksForTheSimCardFiles) {
  Process process(program, {"record", file_, "--manager", manager_.address()});
  ASSERT_TRUE(manager_.waitForCalls(3));
  EXPECT_EQ(manager_.callNames(), (std::vector<std::string>{std::string(rhox::kCommandAddConfiguration), "EventsOn",
                                                            std::string(rhox::kCommandQueryMetric)}));
  const ipc::Dictionary configuration = manager_.calls()[0].request;
  // A separate application: a viewer's configuration is not changed.
  EXPECT_EQ(*configuration.find(rhox::kKeyAppID)->asInt64(), 3);
  const Bytes* toml = configuration.find(rhox::kKeyPayload)->asData();
  ASSERT_NE(toml, nullptr);
  for (const MetricRow& row : metricRows) {
    EXPECT_NE(std::string(toml->begin(), toml->end()).find(std::string(row.identifierName) + " = "), std::string::npos);
  }
  EXPECT_EQ(*manager_.calls()[2].request.find(rhox::kKeyTriggerID)->asInt64(), 8323091);
  process.signal(SIGTERM);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
  EXPECT_EQ(manager_.callNames().back(), rhox::kCommandClearConfiguration);
}

TEST_F(VespctlRecord, WritesOneSimCardWhereItIsNamed) {
  Process process(program, {"record", file_, "--sim", "2", "--manager", manager_.address()});
  ASSERT_TRUE(manager_.waitForCalls(3));
  for (const std::int64_t card : {1, 2, 0, 1}) manager_.sendMetric(rrcState, {0x10, 0x01}, card);
  manager_.finishSending();
  ASSERT_TRUE(grows(partial_, sizeOf(2, shortPacket)));
  process.signal(SIGINT);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
  std::vector<int> cards;
  for (const Json& packet : packetsOf(file_)) cards.push_back(packet["profile_id"].get<int>());
  EXPECT_EQ(cards, (std::vector<int>{2, 0}));
}

TEST_F(VespctlRecord, WritesWhatTheManagerDeliversUntilInterrupted) {
  Process process(program, {"record", file_, "--manager", manager_.address()});
  ASSERT_TRUE(manager_.waitForCalls(3));
  manager_.sendMetric(rrcState, {0x10, 0x01});
  manager_.sendMetric(rrcState, {0x10, 0x03}, 1);
  ASSERT_TRUE(grows(partial_, sizeOf(2, shortPacket)));
  process.signal(SIGINT);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
  EXPECT_EQ(process.output() + process.errors(), "");

  const std::vector<Json> packets = packetsOf(file_);
  ASSERT_EQ(packets.size(), 2U);
  EXPECT_EQ(packets[0]["record"].dump(), R"({"state":"KLTE_RRC_STATE_IDLE"})");
  EXPECT_EQ(packets[0]["profile_id"], 0);
  EXPECT_EQ(packets[1]["record"].dump(), R"({"state":"KLTE_RRC_STATE_CONNECTED"})");
  EXPECT_EQ(packets[1]["profile_id"], 1);
  const auto now = std::chrono::duration<double>(std::chrono::system_clock::now().time_since_epoch()).count();
  EXPECT_NEAR(std::stod(packets[0]["time"].get<std::string>()), now, 60);
}

TEST_F(VespctlRecord, AKillLosesNothingThatWasWritten) {
  Process process(program, {"record", file_, "--manager", manager_.address()});
  ASSERT_TRUE(manager_.waitForCalls(3));
  for (std::uint8_t value = 0; value < 50; ++value) manager_.sendMetric(rrcState, {0x20, value});
  ASSERT_TRUE(grows(partial_, sizeOf(50, shortPacket)));
  process.signal(SIGKILL);
  EXPECT_EQ(process.wait(), (ProcessEnd{true, SIGKILL}));
  EXPECT_FALSE(std::filesystem::exists(file_));
  const std::vector<Json> packets = packetsOf(partial_);
  ASSERT_EQ(packets.size(), 50U);
  for (std::size_t index = 0; index < packets.size(); ++index) {
    EXPECT_EQ(packets[index]["record"]["prev_state_dur_ms"], index);
  }
}

TEST_F(VespctlRecord, OnADiskThatFillsUpEndsWithAReasonAndLeavesAFileThatCanBeRead) {
  Process process(program, {"record", file_, "--manager", manager_.address()});
  ASSERT_TRUE(manager_.waitForCalls(3));
  for (std::uint8_t value = 0; value < 3; ++value) manager_.sendMetric(rrcState, {0x20, value});
  ASSERT_TRUE(grows(partial_, sizeOf(3, shortPacket)));
  // Space for a packet's header and a part of its bytes.
  const rlimit limit{sizeOf(3, shortPacket) + 20, RLIM_INFINITY};
  ASSERT_EQ(::prlimit(process.identifier(), RLIMIT_FSIZE, &limit, nullptr), 0);
  manager_.sendMetric(rrcState, {0x20, 3});
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 2}));
  EXPECT_EQ(process.errors(),
            "vespctl: " + file_ + ": packet 3: cannot be written: File too large; 3 events are in " + partial_ + "\n");
  const Outcome decoded = vespctl({"decode", partial_});
  EXPECT_EQ(decoded.status, 0) << decoded.errors;
  EXPECT_EQ(linesOf(decoded.output).size(), 3U);
}

TEST_F(VespctlRecord, ReportsHowManyEventsWereLost) {
  Process process(program, {"record", file_, "--manager", manager_.address()});
  ASSERT_TRUE(manager_.waitForCalls(3));
  manager_.sendMetric(rrcState, {0x10, 0x01});
  manager_.sendMetric(rrcState, {0x10, 0x01}, 0, 4);
  ASSERT_TRUE(grows(partial_, sizeOf(2, shortPacket)));
  process.signal(SIGINT);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
  EXPECT_EQ(process.errors(), "vespctl: 4 events were lost\n");
}

TEST_F(VespctlRecord, AsksAgainAfterItsManagerWasLost) {
  Process process(program, {"record", file_, "--manager", manager_.address()});
  ASSERT_TRUE(manager_.waitForCalls(3));
  manager_.disconnect();
  ASSERT_TRUE(manager_.waitForConnections(2));
  EXPECT_TRUE(eventually([this] {
    const std::vector<std::string> names = manager_.callNames();
    return std::count(names.begin(), names.end(), rhox::kCommandAddConfiguration) == 2;
  }));
  ASSERT_TRUE(eventually([this] { return manager_.eventsOn(); }));
  manager_.sendMetric(rrcState, {0x10, 0x01});
  EXPECT_TRUE(grows(partial_, sizeOf(1, shortPacket)));
}

TEST_F(VespctlRecord, ReportsWhyTheManagerRefusesAndLeavesTheFileAlone) {
  manager_.answer(rhox::kCommandAddConfiguration, {FakeManager::Answer::Manner::reply, 3, "not today"});
  static_cast<void>(folder_.write("out.pcap", "precious"));
  const Outcome outcome = vespctl({"record", file_, "--manager", manager_.address()});
  EXPECT_EQ(outcome.status, 2);
  EXPECT_EQ(outcome.errors, "vespctl: baseband manager: not today\n");
  EXPECT_EQ(contentsOf(file_), "precious");
}

TEST_F(VespctlRecord, DoesNotReplaceAFileWithoutForce) {
  static_cast<void>(folder_.write("out.pcap", "precious"));
  EXPECT_EQ(vespctl({"record", file_, "--manager", manager_.address()}).errors,
            "vespctl: " + file_ + ": exists already; --force replaces it\n");
  EXPECT_EQ(contentsOf(file_), "precious");
  Process process(program, {"record", file_, "--force", "--manager", manager_.address()});
  ASSERT_TRUE(eventually([this] { return manager_.eventsOn(); }));
  manager_.sendMetric(rrcState, {0x10, 0x01});
  ASSERT_TRUE(grows(partial_, sizeOf(1, shortPacket)));
  EXPECT_EQ(contentsOf(file_), "precious");
  process.signal(SIGINT);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
  EXPECT_EQ(packetsOf(file_).size(), 1U);
}

TEST_F(VespctlRecord, PrintsNoEscapeOfAManagersText) {
  manager_.answer(rhox::kCommandAddConfiguration, {FakeManager::Answer::Manner::reply, 3, "no\x1b[2J\n\x07way"});
  EXPECT_EQ(vespctl({"record", file_, "--manager", manager_.address()}).errors,
            "vespctl: baseband manager: no␛[2J␊␇way\n");
}

TEST(VespctlRecordAlone, DoesNotDestroyTheCaptureThatItsEmbeddedManagerReplays) {
  const TemporaryFolder folder;
  const std::string contents = captureOf(scriptedRun());
  const std::string run = folder.write("run.pcap", contents);
  std::filesystem::create_symlink(run, folder / "link.pcap");
  for (const std::string& output : {run, folder / "link.pcap"}) {
    const Outcome outcome = vespctl({"record", output, "--force", "--manager", "embedded:replay:" + run + ",loop"});
    EXPECT_EQ(outcome.status, 2);
    EXPECT_EQ(outcome.errors, "vespctl: " + output + ": is the source itself\n");
    EXPECT_EQ(contentsOf(run), contents);
  }
}

TEST(VespctlRecordAlone, DoesNotDestroyTheCaptureThatAManagerReplays) {
  const TemporaryFolder folder;
  const std::string contents = captureOf(scriptedRun());
  const std::string run = folder.write("run.pcap", contents);
  const std::string address = "unix:path=" + (folder / "socket");
  Process manager(std::filesystem::path(VESPSCOPE_BIN_DIR) / "rhoxd",
                  {"--listen", address, "--source", "replay:" + run + ",loop", "--state", "none"});
  ASSERT_TRUE(manager.waitForOutput("rhoxd: ")) << manager.errors();
  const Outcome outcome = vespctl({"record", run, "--force", "--manager", address});
  EXPECT_EQ(outcome.status, 2);
  EXPECT_EQ(outcome.errors, "vespctl: " + run + ": is being read by another program\n");
  EXPECT_EQ(contentsOf(run), contents);
}

TEST(VespctlRecordAlone, EndsWithoutEndingAnotherRecordingFromTheSameManager) {
  const test::TemporaryFolder folder;
  const std::string address = "unix:path=" + (folder / "socket");
  Process manager(std::filesystem::path(VESPSCOPE_BIN_DIR) / "rhoxd",
                  {"--listen", address, "--source", "scenario:seed=3,speed=200", "--state", "none"});
  ASSERT_TRUE(manager.waitForOutput("rhoxd: ")) << manager.errors();
  Process first(program, {"record", folder / "first.pcap", "--manager", address});
  Process second(program, {"record", folder / "second.pcap", "--manager", address});
  ASSERT_TRUE(grows(folder / "first.partial.pcap", 1000));
  ASSERT_TRUE(grows(folder / "second.partial.pcap", 1000));
  first.signal(SIGINT);
  ASSERT_EQ(first.wait(), (ProcessEnd{false, 0}));
  EXPECT_TRUE(grows(folder / "second.partial.pcap", std::filesystem::file_size(folder / "second.partial.pcap") + 5000));
  // The last one leaves no configuration behind.
  second.signal(SIGINT);
  ASSERT_EQ(second.wait(), (ProcessEnd{false, 0}));
  EXPECT_EQ(Json::parse(vespctl({"status", "--manager", address}).output)["configurations"], Json::array());
}

TEST(VespctlRecordAlone, ReportsThatThereIsNoManager) {
  const TemporaryFolder folder;
  const std::string socket = folder / "absent";
  const Outcome outcome = vespctl({"record", folder / "out.pcap", "--manager", "unix:path=" + socket});
  EXPECT_EQ(outcome.status, 2);
  EXPECT_EQ(outcome.errors, "vespctl: baseband manager: not connected to a baseband manager: no manager at " + socket +
                                ": No such file or directory\n");
  EXPECT_FALSE(std::filesystem::exists(folder / "out.pcap"));
}

TEST(VespctlRecordAlone, RefusesWordsThatAreNoAddress) {
  const TemporaryFolder folder;
  const Outcome outcome = vespctl({"record", folder / "out.pcap", "--manager", "elsewhere"});
  EXPECT_EQ(outcome.status, 2);
  EXPECT_EQ(outcome.errors,
            "vespctl: \"elsewhere\" is not a manager address (auto, system, unix:path=FILE, ssh:HOST or "
            "embedded:SOURCE)\n");
}

TEST(VespctlRecordAlone, RecordsFromAnEmbeddedManagerEveryMetricThatItsSourceHas) {
  const TemporaryFolder folder;
  const std::string run = folder.write("run.pcap", captureOf(scriptedRun()));
  Process process(program, {"record", folder / "out.pcap"},
                  {{"RHOX_ADDRESS", "embedded:replay:" + run + ",speed=max"}});
  // The SIM card files occur twice: as the answer to the query and in the run.
  std::vector<MetricEvent> events = scriptedRun();
  events.push_back(
      *std::find_if(events.begin(), events.end(), [](const MetricEvent& event) { return event.metricID == 3932179; }));
  ASSERT_TRUE(grows(folder / "out.partial.pcap", captureOf(events).size()));
  process.signal(SIGINT);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
  std::map<std::string, int> messages;
  for (const Json& packet : packetsOf(folder / "out.pcap")) ++messages[packet["message"]];
  EXPECT_EQ(messages.size(), 29U);
  EXPECT_EQ(messages["KCellularSimCardFiles"], 2);
}

TEST(VespctlRecordAlone, StampsTheEventsOfAFasterReplayWithTheRecordingsOwnTimes) {
  const TemporaryFolder folder;
  const std::vector<MetricEvent> events = scriptedRun();
  const std::string run = folder.write("run.pcap", captureOf(events));
  Process process(program, {"record", folder / "out.pcap"}, {{"RHOX_ADDRESS", "embedded:replay:" + run + ",speed=10"}});
  ASSERT_TRUE(eventually([&] { return packetsOf(folder / "out.partial.pcap").size() > events.size(); }));
  process.signal(SIGINT);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
  const std::vector<Json> recorded = packetsOf(folder / "out.pcap");
  const std::vector<Json> original = packetsOf(run);
  // The answer to the query for the SIM card files comes first, with its own time.
  std::vector<std::string> times;
  for (const Json& packet : recorded) times.push_back(packet["time"]);
  std::vector<std::string> expected;
  for (const Json& packet : original) {
    expected.push_back(packet["time"]);
    if (packet["message"] == "KCellularSimCardFiles") expected.push_back(packet["time"]);
  }
  std::sort(times.begin(), times.end());
  EXPECT_EQ(times, expected);
}

}  // namespace
}  // namespace vespscope::test
