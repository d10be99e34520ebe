// What a modem's log port answers to the question that changes nothing.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "sources/diag/PortProbe.h"
#include "support/FakeLogPort.h"
#include "support/LogWriter.h"

namespace vespscope::test {
namespace {

using sources::diag::askPort;
using sources::diag::PortAnswer;
using Kind = PortAnswer::Kind;
using namespace std::chrono_literals;

PortAnswer answerOf(FakeLogPort::Line line, FakeLogPort::Manner manner, const Bytes& log = {}) {
  const FakeLogPort port(line, manner, log);
  return askPort(port.name(), 500ms, 50ms);
}

class PortProbe : public ::testing::TestWithParam<FakeLogPort::Line> {};

TEST_P(PortProbe, HearsThatAModemAnswers) {
  const FakeLogPort port(GetParam(), FakeLogPort::Manner::proper, {});
  EXPECT_EQ(askPort(port.name(), 5s, 50ms).kind, Kind::answers);
  // Nothing was turned on or off.
  EXPECT_THAT(port.commands(), testing::ElementsAre("counts"));
}

TEST_P(PortProbe, CountsTheRecordsOfALogThatIsOn) {
  LogWriter log;
  for (int i = 0; i < 3; ++i) log.record(0xB0C2, std::chrono::seconds(1'700'000'000), {3});
  const PortAnswer answer = answerOf(GetParam(), FakeLogPort::Manner::already, log.bytes());
  EXPECT_EQ(answer.kind, Kind::logging);
  EXPECT_EQ(answer.records, 3U);
}

TEST_P(PortProbe, HearsARefusalNonsenseOrNothing) {
  EXPECT_EQ(answerOf(GetParam(), FakeLogPort::Manner::refusing).kind, Kind::refuses);
  EXPECT_EQ(answerOf(GetParam(), FakeLogPort::Manner::nonsense).kind, Kind::garbled);
  EXPECT_EQ(answerOf(GetParam(), FakeLogPort::Manner::silent).kind, Kind::silent);
}

INSTANTIATE_TEST_SUITE_P(Lines, PortProbe, ::testing::Values(FakeLogPort::Line::terminal, FakeLogPort::Line::tcp),
                         [](const auto& line) {
                           return line.param == FakeLogPort::Line::tcp ? "OverTcp" : "OnATerminal";
                         });

TEST(PortProbeOfNothing, StatesWhyThePortCannotBeOpened) {
  const PortAnswer answer = askPort("/dev/none", 500ms, 50ms);
  EXPECT_EQ(answer.kind, Kind::failed);
  EXPECT_EQ(answer.reason, "No such file or directory");
}

}  // namespace
}  // namespace vespscope::test
