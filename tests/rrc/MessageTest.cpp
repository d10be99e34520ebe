// The reader: every value of a message by its name, and a fault for anything that is not a message.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Captures.h"
#include "Messages.h"
#include "rrc/Message.h"

namespace vespscope::test {
namespace {

using namespace rrc;
using ::testing::ElementsAre;

TEST(Message, NamesEveryValueOfAMasterInformationBlock) {
  const ReadMessage message("mib");
  std::vector<std::string> names;
  for (const Node& node : message->nodes()) names.emplace_back(nameOf(node.name));
  EXPECT_THAT(names, ElementsAre("", "message", "dl-Bandwidth", "phich-Config", "phich-Duration", "phich-Resource",
                                 "systemFrameNumber", "schedulingInfoSIB1-BR-r13", "systemInfoUnchanged-BR-r15",
                                 "partEARFCN-r17", "spare", "spare"));
  const View block = message->body();
  EXPECT_EQ(block["dl-Bandwidth"].item(), "n50");
  EXPECT_EQ(block["dl-Bandwidth"].value(), 3);
  EXPECT_EQ(block["dl-Bandwidth"].bit(), 0U);
  EXPECT_EQ(block["dl-Bandwidth"].bits(), 3U);
  EXPECT_EQ(block["systemFrameNumber"].bit(), 6U);
  EXPECT_EQ(block["systemFrameNumber"].bits(), 8U);
  EXPECT_EQ(block["systemFrameNumber"].number(), 0xA5U);
  EXPECT_THAT(block["systemFrameNumber"].bytes(), ElementsAre(0xA5));
}

TEST(Message, GivesAnAbsentViewForWhatIsNotThere) {
  const ReadMessage message("release");
  const View absent = message->content()["redirectedCarrierInfo"];
  EXPECT_FALSE(absent);
  EXPECT_EQ(absent.value(), 0);
  EXPECT_EQ(absent.name(), "");
  EXPECT_EQ(absent.item(), "");
  EXPECT_FALSE(absent.number());
  EXPECT_TRUE(absent.bytes().empty());
  EXPECT_FALSE(absent.first());
  EXPECT_FALSE(absent.next());
  EXPECT_FALSE(absent["geran"]);
  EXPECT_EQ(absent.begin() != absent.end(), false);
}

TEST(Message, KeepsAnAdditionOfALaterReleaseByItsLength) {
  const ReadMessage message("sib2");
  std::vector<Node> unknown;
  for (const Node& node : message->nodes()) {
    if (grammar::types[node.type].kind() == Kind::unknown) unknown.push_back(node);
  }
  ASSERT_EQ(unknown.size(), 1U);
  EXPECT_EQ(unknown[0].bits, 16U);
}

TEST(Message, RefusesEveryCutOfEveryLiteral) {
  Message message;
  for (const Literal& literal : literals) {
    const std::vector<std::uint8_t> bytes = bytesOf(literal.hex);
    ASSERT_FALSE(message.read(literal.pdu, bytes)) << literal.name;
    const std::size_t needed = (message.root().bits() + 7) / 8;
    EXPECT_LE(needed, bytes.size());
    for (std::size_t length = 0; length < needed; ++length) {
      const auto fault = message.read(literal.pdu, std::span(bytes).first(length));
      ASSERT_TRUE(fault) << literal.name << " cut to " << length;
      EXPECT_EQ(fault->kind, FaultKind::truncated);
      EXPECT_LE(fault->bit, 8 * length);
      EXPECT_FALSE(message.root());
    }
  }
}

TEST(Message, RefusesAValueOutsideItsRange) {
  Message message;
  // The downlink bandwidth is one of six values in three bits.
  const std::vector<std::uint8_t> bytes = {0xE0, 0x00, 0x00};
  EXPECT_EQ(message.read(Pdu::lteBcchBch, bytes), (Fault{FaultKind::outOfRange, 0}));
  const std::vector<std::uint8_t> right = {0x60, 0x00, 0x00};
  EXPECT_FALSE(message.read(Pdu::lteBcchBch, right));
  EXPECT_TRUE(message.root());
}

TEST(Message, RefusesALengthOfFragments) {
  Message message;
  // A transfer of NAS whose length begins with 11.
  const std::vector<std::uint8_t> bytes = {0x08, 0x06, 0x00, 0x00, 0x00};
  EXPECT_EQ(message.read(Pdu::lteDlDcch, bytes), (Fault{FaultKind::fragmented, 15}));
}

TEST(Message, ReadsEveryMessageOfTheCaptures) {
  const auto files = captureFiles();
  if (files.empty()) GTEST_SKIP() << "the captures are missing: no real message has been read";
  std::size_t count = 0;
  Message message;
  for (const auto& file : files) {
    const Capture capture = readCapture(file);
    for (const CapturedMessage& captured : capture.messages) {
      const auto fault = message.read(captured.pdu, captured.bytes);
      ASSERT_FALSE(fault) << capture.name << ": " << textOf(fault->kind);
      for (const Node& node : message.nodes()) ASSERT_FALSE(node.unreadable) << capture.name;
      ++count;
    }
  }
  std::printf("%zu messages read\n", count);
  EXPECT_GT(count, 0U);
}

}  // namespace
}  // namespace vespscope::test
