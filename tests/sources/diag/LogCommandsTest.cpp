// The commands that turn a log on, and the answers to them.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Bytes.h"
#include "sources/diag/LogCommands.h"

namespace vespscope::test {
namespace {

using namespace sources::diag;

TEST(LogCommands, AreTheFramesThatModemsKnow) {
  EXPECT_EQ(askForCodeCounts(), frameOf(bytesOf("73 00 00 00 01 00 00 00")));
  EXPECT_EQ(turnAllOff(), frameOf(bytesOf("73 00 00 00 00 00 00 00")));
  const std::vector<std::uint16_t> codes = {0x5000, 0x5009, 0x500F, 0x5010};
  EXPECT_EQ(turnOn(5, 16, codes), frameOf(bytesOf("73 00 00 00 03 00 00 00 05 00 00 00 10 00 00 00 01 82")));
}

TEST(LogCommands, AskForEveryRecordThatIsRead) {
  EXPECT_THAT(mappedCodes(), testing::ElementsAre(0x4127, 0x412F, 0x512F, 0x7130, 0x7131, 0x7135, 0x713A, 0xB0C0,
                                                  0xB0C2, 0xB0E0, 0xB0E1, 0xB0E2, 0xB0E3, 0xB0E5, 0xB0EA, 0xB0EB,
                                                  0xB0EC, 0xB0ED, 0xB0EE, 0xB179, 0xB192, 0xB193, 0xB195, 0xB821));
}

TEST(LogCommands, OnlyAnswersAreTakenForAnswers) {
  EXPECT_EQ(logAnswerOf(bytesOf("73 00 00 00 00 00 00 00 00 00 00 00"))->kind, LogAnswer::Kind::turnedOff);
  EXPECT_EQ(logAnswerOf(bytesOf("73 00 00 00 03 00 00 00 00 00 00 00 0b 00 00 00"))->equipment, 11);
  EXPECT_EQ(logAnswerOf(bytesOf("73 00 00 00 03 00 00 00 02 00 00 00 0b 00 00 00"))->kind, LogAnswer::Kind::refused);
  EXPECT_EQ(logAnswerOf(bytesOf("13 73 00 00 00"))->kind, LogAnswer::Kind::refused);
  for (const char* dump : {"", "73", "13", "13 4b", "73 00 00 00 03 00 00 00 00 00 00 00",
                           "73 00 00 00 01 00 00 00 00 00 00 00 01", "73 00 00 00 04 00 00 00 00 00 00 00", "79 01"}) {
    EXPECT_FALSE(logAnswerOf(bytesOf(dump))) << dump;
  }
}

}  // namespace
}  // namespace vespscope::test
