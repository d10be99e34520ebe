// The live log of a port: turning on, reading, turning off, and waiting.
#include <filesystem>
#include <fstream>
#include <mutex>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Bytes.h"
#include "LiteralRecords.h"
#include "sources/diag/DiagPortSource.h"
#include "sources/diag/DiagStream.h"
#include "support/Eventually.h"
#include "support/FakeLogPort.h"
#include "support/ScratchFile.h"
#include "support/SharedCaptures.h"
#include "support/TemporaryFolder.h"
#include "support/WrittenLog.h"

namespace vespscope::test {
namespace {

using namespace sources;
using namespace sources::diag;
using Line = FakeLogPort::Line;
using Manner = FakeLogPort::Manner;
using namespace std::chrono_literals;

class Collector final : public EventSink {
 public:
  void deliver(MetricEvent event) override {
    const std::lock_guard lock(mutex_);
    events_.push_back(std::move(event));
  }
  [[nodiscard]] std::size_t count() const {
    const std::lock_guard lock(mutex_);
    return events_.size();
  }
  [[nodiscard]] std::vector<MetricEvent> events() const {
    const std::lock_guard lock(mutex_);
    return events_;
  }

 private:
  mutable std::mutex mutex_;
  std::vector<MetricEvent> events_;
};

constexpr PortPace quick{.patience = 200ms, .firstRetry = 10ms, .longestRetry = 40ms, .farewell = 500ms};
constexpr PortPace patient{.patience = 20s, .firstRetry = 10ms, .longestRetry = 40ms, .farewell = 500ms};

// A cell, a hundred of its measurements, its neighbours.
Bytes someLog() {
  Bytes log = frameOf(recordOf(0xB0C2, 1000, bytesOf(literal::servingCellV3)));
  for (std::uint64_t i = 0; i < 100; ++i) {
    append(log, frameOf(recordOf(0xB193, 1010 + i * 10, bytesOf(literal::measurementV19))));
  }
  append(log, frameOf(recordOf(0xB195, 2100, bytesOf(literal::connectedNeighbours))));
  return log;
}

std::vector<MetricEvent> eventsOfFile(const std::string& path) {
  auto stream = openDiagStream(path);
  EXPECT_TRUE(stream) << stream.reason();
  std::vector<MetricEvent> events;
  while (auto event = (*stream)->next()) events.push_back(std::move(*event));
  return events;
}

void expectSameEvents(const std::vector<MetricEvent>& live, const std::vector<MetricEvent>& file) {
  ASSERT_EQ(live.size(), file.size());
  for (std::size_t i = 0; i < live.size(); ++i) {
    ASSERT_EQ(live[i].metricID, file[i].metricID) << i;
    ASSERT_EQ(live[i].payload, file[i].payload) << i;
    ASSERT_EQ(live[i].profileID, file[i].profileID) << i;
    ASSERT_EQ(live[i].time, file[i].time) << i;
  }
}

const std::vector<std::string> commandsOfOneRun = {
    "counts", "on 4: 4127 412F", "on 5: 512F", "on 7: 7130 7131 7135 713A",
    "on 11: B0C0 B0C2 B0E0 B0E1 B0E2 B0E3 B0E5 B0EA B0EB B0EC B0ED B0EE B179 B192 B193 B195 B821"};

class DiagPortSourceOn : public testing::TestWithParam<Line> {};
INSTANTIATE_TEST_SUITE_P(EachLine, DiagPortSourceOn, testing::Values(Line::terminal, Line::tcp),
                         [](const auto& line) { return line.param == Line::terminal ? "SerialLine" : "Tcp"; });

TEST_P(DiagPortSourceOn, TheLogIsTurnedOnReadAndTurnedOff) {
  const Bytes log = someLog();
  const ScratchFile file("some.log", log);
  const std::vector<MetricEvent> expected = eventsOfFile(file.path());
  FakeLogPort port(GetParam(), Manner::proper, log);
  Collector collector;
  DiagPortSource source(port.name(), patient);
  EXPECT_EQ(source.label(), port.name() + ": not opened yet");
  EXPECT_EQ(source.kind(), SourceKind::live);
  source.start(collector);
  EXPECT_TRUE(eventually([&] { return collector.count() == expected.size(); }, 20s));
  EXPECT_EQ(source.label(), port.name());
  EXPECT_EQ(port.commands(), commandsOfOneRun);
  source.stop();
  EXPECT_TRUE(eventually([&] { return port.commands().size() == commandsOfOneRun.size() + 1; }, 20s));
  EXPECT_EQ(port.commands().back(), "off");
  expectSameEvents(collector.events(), expected);
}

void expectEventsOfTheFile(Line line, const Bytes& log, const std::vector<MetricEvent>& expected) {
  FakeLogPort port(line, Manner::proper, log);
  Collector collector;
  DiagPortSource source(port.name(), patient);
  source.start(collector);
  EXPECT_TRUE(eventually([&] { return collector.count() >= expected.size(); }, 60s));
  source.stop();
  expectSameEvents(collector.events(), expected);
}

TEST_P(DiagPortSourceOn, AWrittenLogGivesTheSameEventsAsItsFile) {
  const Bytes log = writtenLog();
  const ScratchFile file("written.mi2log", log);
  const std::vector<MetricEvent> expected = eventsOfFile(file.path());
  EXPECT_GE(expected.size(), static_cast<std::size_t>(writtenLogCells + writtenLogMeasurements));
  expectEventsOfTheFile(GetParam(), log, expected);
}

TEST_P(DiagPortSourceOn, ARealLogGivesTheSameEventsAsItsFile) {
  const std::string path = sharedCapture("lte-ca-drive.mi2log");
  SKIP_WITHOUT_CAPTURE(path);
  std::ifstream file(path, std::ios::binary);
  const Bytes log{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
  expectEventsOfTheFile(GetParam(), log, eventsOfFile(path));
}

TEST_P(DiagPortSourceOn, APortThatAnswersNothingIsTriedAgain) {
  FakeLogPort port(GetParam(), Manner::silent, {});
  Collector collector;
  DiagPortSource source(port.name(), quick);
  source.start(collector);
  EXPECT_TRUE(eventually([&] { return port.commands().size() >= 3; }, 20s));
  EXPECT_THAT(port.commands(), testing::Each("counts"));
  EXPECT_TRUE(eventually([&] { return source.label() == port.name() + ": does not answer; trying again"; }, 20s));
  source.stop();
  EXPECT_EQ(collector.count(), 0U);
}

TEST_P(DiagPortSourceOn, APortThatSendsInvalidDataIsReportedAsSuch) {
  FakeLogPort port(GetParam(), Manner::nonsense, {});
  Collector collector;
  DiagPortSource source(port.name(), quick);
  source.start(collector);
  const std::string expected = port.name() + ": sends data that no modem sends; trying again";
  EXPECT_TRUE(eventually([&] { return source.label() == expected; }, 20s));
  source.stop();
}

TEST_P(DiagPortSourceOn, AModemThatRefusesIsReportedAsSuch) {
  FakeLogPort port(GetParam(), Manner::refusing, {});
  Collector collector;
  DiagPortSource source(port.name(), quick);
  source.start(collector);
  const std::string expected = port.name() + ": rejects the command to turn its log on; trying again";
  EXPECT_TRUE(eventually([&] { return source.label() == expected; }, 20s));
  source.stop();
}

TEST(DiagPortSource, ALogThatComesUnaskedIsTaken) {
  FakeLogPort port(Line::tcp, Manner::already, someLog());
  Collector collector;
  DiagPortSource source(port.name(), quick);
  source.start(collector);
  EXPECT_TRUE(eventually([&] { return collector.count() > 100; }, 20s));
  EXPECT_TRUE(eventually([&] { return source.label() == port.name(); }, 20s));
  source.stop();
}

TEST(DiagPortSource, AConnectionThatEndsIsMadeAgain) {
  FakeLogPort port(Line::tcp, Manner::proper, someLog());
  Collector collector;
  DiagPortSource source(port.name(), patient);
  source.start(collector);
  EXPECT_TRUE(eventually([&] { return collector.count() > 100; }, 20s));
  const std::size_t once = collector.count();
  port.unplug();
  EXPECT_TRUE(eventually([&] { return collector.count() == 2 * once; }, 20s));
  EXPECT_TRUE(eventually([&] { return source.label() == port.name(); }, 20s));
  source.stop();
}

TEST(DiagPortSource, APortThatIsUnpluggedIsWaitedForUntilItIsBack) {
  const TemporaryFolder folder;
  const std::string path = folder / "modem";
  Collector collector;
  DiagPortSource source(path, patient);
  source.start(collector);
  EXPECT_TRUE(eventually([&] { return source.label() == path + ": No such file or directory; trying again"; }, 20s));

  auto port = std::make_unique<FakeLogPort>(Line::terminal, Manner::proper, someLog());
  std::filesystem::create_symlink(port->name(), path);
  EXPECT_TRUE(eventually([&] { return collector.count() > 100; }, 20s));
  EXPECT_TRUE(eventually([&] { return source.label() == path; }, 20s));
  const std::size_t once = collector.count();

  port->unplug();
  std::filesystem::remove(path);
  EXPECT_TRUE(eventually([&] { return source.label() == path + ": No such file or directory; trying again"; }, 20s));

  port = std::make_unique<FakeLogPort>(Line::terminal, Manner::proper, someLog());
  std::filesystem::create_symlink(port->name(), path);
  EXPECT_TRUE(eventually([&] { return collector.count() == 2 * once; }, 20s));
  source.stop();
  EXPECT_TRUE(eventually([&] { return !port->commands().empty() && port->commands().back() == "off"; }, 20s));
}

TEST(DiagPortSource, ReportsThatNothingListens) {
  std::string name;
  {
    const FakeLogPort port(Line::tcp, Manner::proper, {});
    name = port.name();
  }
  Collector collector;
  DiagPortSource source(name, quick);
  source.start(collector);
  EXPECT_TRUE(eventually([&] { return source.label() == name + ": Connection refused; trying again"; }, 20s));
  source.stop();
}

TEST(DiagPortSource, StopsAtOnceWhileItWaits) {
  Collector collector;
  DiagPortSource source("/nowhere/modem", {.patience = 1h, .firstRetry = 1h, .longestRetry = 1h, .farewell = 1s});
  source.start(collector);
  EXPECT_TRUE(eventually([&] { return source.label() == "/nowhere/modem: No such file or directory; trying again"; }));
  source.stop();
}

}  // namespace
}  // namespace vespscope::test
