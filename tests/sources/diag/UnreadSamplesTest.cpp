// Samples of records that are not read hold no identity and no place, wherever in the record these lie.
#include <algorithm>
#include <array>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "sources/diag/DiagStream.h"
#include "sources/diag/UnreadSamples.h"
#include "support/LogWriter.h"
#include "support/ScratchFile.h"
#include "support/SharedCaptures.h"

namespace vespscope::test {
namespace {

using namespace sources::diag;

constexpr std::chrono::seconds now{1'700'000'000};

// Identities and places as records and messages carry them.
struct Planted {
  const char* what;
  Bytes bytes;
};
const std::vector<Planted>& planted() {
  static const std::vector<Planted> all = {
      {"IMSI 001010123456789 in BCD", {0x08, 0x09, 0x10, 0x10, 0x10, 0x32, 0x54, 0x76, 0x98}},
      {"IMSI in text", {'0', '0', '1', '0', '1', '0', '1', '2', '3', '4', '5', '6', '7', '8', '9'}},
      {"IMEI 490154203237518 in BCD", {0x4A, 0x09, 0x51, 0x24, 0x30, 0x32, 0x57, 0x81}},
      {"GUTI", {0xF6, 0x00, 0xF1, 0x10, 0x80, 0x01, 0x2A, 0xC0, 0xDE, 0xBE, 0xEF}},
      {"TMSI", {0xC0, 0xDE, 0xBE, 0xEF}},
      {"phone number in BCD", {0x91, 0x94, 0x71, 0x10, 0x32, 0x54}},
      {"phone number in text", {'+', '4', '9', '1', '7', '0', '1', '2', '3', '4', '5'}},
      {"coordinates as doubles",
       {0x6D, 0xE7, 0xFB, 0xA9, 0xF1, 0x42, 0x4A, 0x40, 0x7F, 0x6A, 0xBC, 0x74, 0x93, 0xD8, 0x2A, 0x40}},
      {"coordinates in 1e-7 degrees", {0x15, 0xCD, 0x4E, 0x1F, 0x31, 0x02, 0xFE, 0x07}},
      {"cell identity and tracking area", {0x0A, 0x00, 0x01, 0x05, 0xE9, 0x1B}},
      {"network 262-01", {0x62, 0xF2, 0x10}},
      {"APN", {'i', 'n', 't', 'e', 'r', 'n', 'e', 't'}},
      {"address", {10, 64, 3, 77}},
      {"attach request", {0x07, 0x41, 0x71, 0x08, 0x09, 0x10, 0x10, 0x10, 0x32, 0x54, 0x76, 0x98, 0x02, 0xE0, 0xE0}},
  };
  return all;
}

// The samples that a log gives.
UnreadSamples samplesOf(const LogWriter& log) {
  const ScratchFile file("samples.mi2log", log.bytes());
  const auto stream = DiagStream::open(file.path());
  UnreadSamples samples;
  if (!stream) return samples;
  (*stream)->sampleUnread(samples);
  while ((*stream)->next()) {
  }
  return samples;
}

bool holds(const Bytes& bytes, const Bytes& part) {
  return std::search(bytes.begin(), bytes.end(), part.begin(), part.end()) != bytes.end();
}

std::vector<std::string> namesOf(const UnreadSamples& samples) {
  std::vector<std::string> names;
  for (const auto& [kind, log] : samples.samples()) names.push_back(fileNameOf(kind));
  return names;
}

TEST(UnreadSamples, AreOneOfEachUnknownCodeAndVersion) {
  LogWriter log;
  for (int i = 0; i < 2; ++i) {
    log.record(0xB0C2, now, {77, 1, 2, 3});
    log.record(0xB0C1, now, {4, 1, 2, 3});
    log.record(0xB0C1, now, {5, 1, 2, 3});
    log.record(0x1FFE, now, {4, 1});
    log.record(0x1FFE, now, {5, 1});
    log.record(0xB193, now, {1, 1, 0, 0, 26, 5, 8, 0, 1, 2, 3, 4});
    log.record(0xB0C2, now, {3, 1});
  }
  EXPECT_THAT(namesOf(samplesOf(log)), testing::UnorderedElementsAre("B0C2-v77", "B0C1-v4", "B0C1-v5", "1FFE",
                                                                     "B193-subpacket-26-v5", "B0C2-v3-refused"));
}

TEST(UnreadSamples, HoldNoPlantedIdentityWhereverItLies) {
  for (const std::uint16_t code :
       std::to_array<std::uint16_t>({0xB0FF, 0xB1FF, 0xB193, 0xB0C0, 0xB0C2, 0xB0EE, 0xB8FF, 0x1476, 0x50FF, 0x70FF})) {
    for (const Planted& identity : planted()) {
      for (std::size_t offset = 0; offset < 24; ++offset) {
        Bytes payload(offset, 0x5A);
        payload.insert(payload.end(), identity.bytes.begin(), identity.bytes.end());
        payload.resize(payload.size() + 7, 0x5A);
        LogRecord record;
        record.code = code;
        record.payload = payload;
        const Bytes kept = redactedPayload(record);
        ASSERT_EQ(kept.size(), payload.size());
        // No more than the first byte of an identity, where the version stands.
        const Bytes rest(identity.bytes.begin() + (offset == 0 ? 1 : 0), identity.bytes.end());
        EXPECT_FALSE(holds(kept, rest)) << identity.what << " in " << code << " at " << offset;
        const auto left = std::count_if(kept.begin() + 1, kept.end(), [](std::uint8_t byte) { return byte != 0; });
        EXPECT_EQ(left, 0) << identity.what << " in " << code << " at " << offset;
      }
    }
  }
}

TEST(UnreadSamples, HoldNoPlantedIdentityBehindALengthOrInASubpacket) {
  for (const Planted& identity : planted()) {
    LogWriter log;
    const auto length = static_cast<std::uint8_t>(identity.bytes.size());
    Bytes message = {99, 15, 4, 0, 0, 1, 0, length, 0};
    message.insert(message.end(), identity.bytes.begin(), identity.bytes.end());
    log.record(0xB0C0, now, message, 1);
    Bytes measured = {1, 1, 0xAA, 0xBB, 25, 99, static_cast<std::uint8_t>(length + 4), 0};
    measured.insert(measured.end(), identity.bytes.begin(), identity.bytes.end());
    log.record(0xB193, now, measured);
    const UnreadSamples samples = samplesOf(log);
    ASSERT_EQ(namesOf(samples), (std::vector<std::string>{"B0C0-v99", "B193-subpacket-25-v99"}));
    for (const auto& [kind, sample] : samples.samples()) {
      EXPECT_FALSE(holds(sample, identity.bytes)) << identity.what << " in " << fileNameOf(kind);
    }
  }
}

TEST(UnreadSamples, KeepTheVersionTheSubpacketsAndALengthThatReachesTheEnd) {
  LogRecord record;
  const Bytes measured = {1, 2, 7, 8, 25, 40, 6, 0, 0xAA, 0xBB, 26, 3, 5, 0, 0xCC};
  record.code = 0xB193;
  record.payload = measured;
  EXPECT_EQ(redactedPayload(record), (Bytes{1, 2, 0, 0, 25, 40, 6, 0, 0, 0, 26, 3, 5, 0, 0}));
  // One byte more than the subpackets use: nothing but the version is certain.
  const Bytes longer = {1, 2, 7, 8, 25, 40, 6, 0, 0xAA, 0xBB, 26, 3, 5, 0, 0xCC, 0xDD};
  record.payload = longer;
  EXPECT_EQ(redactedPayload(record), (Bytes{1, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0}));
  const Bytes message = {32, 15, 4, 9, 9, 5, 0, 1, 2, 3, 4, 5};
  record.code = 0xB0C0;
  record.payload = message;
  EXPECT_EQ(redactedPayload(record), (Bytes{32, 0, 0, 0, 0, 5, 0, 0, 0, 0, 0, 0}));
  // Of other families the first byte may be anything.
  record.code = 0x4FFF;
  EXPECT_EQ(redactedPayload(record), Bytes(message.size()));
}

TEST(UnreadSamples, AreLogsOfOneRecordAtTheBeginningOfTimeWithoutTheSimCard) {
  LogWriter log;
  log.record(0xB0C2, now, {77, 1, 2, 3}, 2);
  LogWriter expected;
  expected.record(0xB0C2, std::chrono::seconds(315'964'800), {77, 0, 0, 0});
  const UnreadSamples samples = samplesOf(log);
  ASSERT_EQ(samples.samples().size(), 1U);
  EXPECT_EQ(samples.samples().begin()->second, expected.bytes());
}

TEST(UnreadSamples, HaveABoundForALogOfUnknownKindsOnly) {
  LogWriter log;
  for (unsigned code = 0; code < 600; ++code) log.record(static_cast<std::uint16_t>(0x1000 + code), now, {1});
  const UnreadSamples samples = samplesOf(log);
  EXPECT_EQ(samples.samples().size(), UnreadSamples::maximum);
  EXPECT_EQ(samples.leftOut(), 600 - UnreadSamples::maximum);
}

TEST(UnreadSamples, OfARealLogReadBackAsTheSameKinds) {
  const std::string path = sharedCapture("lte-four-antennas.mi2log");
  SKIP_WITHOUT_CAPTURE(path);
  const auto stream = DiagStream::open(path);
  ASSERT_TRUE(stream);
  UnreadSamples samples;
  (*stream)->sampleUnread(samples);
  while ((*stream)->next()) {
  }
  ASSERT_GT(samples.samples().size(), 10U);
  for (const auto& [kind, log] : samples.samples()) {
    const ScratchFile file("sample.mi2log", log);
    const auto again = DiagStream::open(file.path());
    ASSERT_TRUE(again) << fileNameOf(kind);
    UnreadSamples second;
    (*again)->sampleUnread(second);
    while ((*again)->next()) {
    }
    ASSERT_EQ(namesOf(second), std::vector<std::string>{fileNameOf(kind)});
    EXPECT_EQ(second.samples().begin()->second, log);
  }
}

}  // namespace
}  // namespace vespscope::test
