// Every value of every message compared with TShark's output: for the literals of these tests, and for captures if
// available.
#include <cstdio>
#include <cstdlib>
#include <map>

#include <gtest/gtest.h>

#include "Captures.h"
#include "Dissection.h"
#include "Messages.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using rrc::Pdu;
using Bytes = std::vector<std::uint8_t>;
// Each message with its number of occurrences.
using Messages = std::map<std::pair<Pdu, Bytes>, std::size_t>;

struct Counts {
  std::size_t messages = 0;
  std::size_t distinct = 0;
  std::size_t values = 0;
  std::size_t abandoned = 0;  // TShark stops before the end
  std::map<std::string, std::size_t> differences;
};

bool hasTShark() { return std::system("tshark --version >/dev/null 2>&1") == 0; }

// TShark has no dissector for the separate answer to an NR configuration: it is passed as a message of the uplink.
std::pair<Pdu, Bytes> dissectable(Pdu pdu, const Bytes& bytes) {
  if (pdu != Pdu::nrReconfigurationComplete) return {pdu, bytes};
  // c1, rrcReconfigurationComplete: five preceding bits.
  Bytes shifted = {0x08};
  for (const std::uint8_t byte : bytes) {
    shifted.back() |= static_cast<std::uint8_t>(byte >> 5);
    shifted.push_back(static_cast<std::uint8_t>(byte << 3));
  }
  return {Pdu::nrUlDcch, shifted};
}

void add(Messages& messages, Pdu pdu, const Bytes& bytes) { ++messages[dissectable(pdu, bytes)]; }

void compare(const Messages& messages, Counts& counts) {
  const TemporaryFolder folder;
  std::vector<std::pair<Pdu, Bytes>> list;
  for (const auto& [message, times] : messages) list.push_back(message);
  writeCapture(folder / "messages.pcap", list);
  const std::string command = "WIRESHARK_CONFIG_DIR=" + folder.path().string() + " tshark -r " +
                              (folder / "messages.pcap") + " -T pdml >" + (folder / "messages.pdml") + " 2>/dev/null";
  ASSERT_EQ(std::system(command.c_str()), 0);
  const auto dissections = readPdml(folder / "messages.pdml");
  ASSERT_EQ(dissections.size(), list.size());
  rrc::Message message;
  for (std::size_t index = 0; index < list.size(); ++index) {
    const auto& [pdu, bytes] = list[index];
    const auto fault = message.read(pdu, bytes);
    ASSERT_FALSE(fault) << textOf(fault->kind);
    const std::string text = difference(valuesOf(message), dissections[index], counts.values);
    const std::size_t times = messages.at(list[index]);
    counts.messages += times;
    ++counts.distinct;
    if (!dissections[index].complete) counts.abandoned += times;
    if (!text.empty()) counts.differences[text] += times;
  }
}

void report(const Counts& counts) {
  std::printf("%zu messages (%zu distinct), %zu values the same, TShark gave up in %zu\n", counts.messages,
              counts.distinct, counts.values, counts.abandoned);
  for (const auto& [text, times] : counts.differences) ADD_FAILURE() << times << " times: " << text;
}

TEST(MessageTShark, AgreesAboutEveryLiteral) {
  if (!hasTShark()) GTEST_SKIP() << "tshark is missing: no literal has been compared";
  Messages messages;
  for (const Literal& literal : literals) add(messages, literal.pdu, bytesOf(literal.hex));
  Counts counts;
  compare(messages, counts);
  report(counts);
  EXPECT_EQ(counts.abandoned, 0U);
}

TEST(MessageTShark, AgreesAboutEveryMessageOfTheCaptures) {
  const auto files = captureFiles();
  if (files.empty()) GTEST_SKIP() << "the captures are missing: no real message has been compared";
  if (!hasTShark()) GTEST_SKIP() << "tshark is missing: no real message has been compared";
  Messages messages;
  for (const auto& file : files) {
    for (const CapturedMessage& message : readCapture(file).messages) add(messages, message.pdu, message.bytes);
  }
  Counts counts;
  compare(messages, counts);
  report(counts);
  EXPECT_GT(counts.messages, 0U);
}

}  // namespace
}  // namespace vespscope::test
