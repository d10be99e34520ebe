// Written captures are nanosecond pcap of link type USER0 and read back the same.
#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>
#include <filesystem>
#include <limits>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "capture/CaptureReader.h"
#include "capture/CaptureWriter.h"
#include "support/FileLimit.h"
#include "support/ScratchFile.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using namespace capture;

bool sameEvent(const MetricEvent& left, const MetricEvent& right) {
  return left.metricID == right.metricID && left.profileID == right.profileID && left.payload == right.payload &&
         left.time == right.time;
}

std::vector<MetricEvent> eventsIn(const std::string& path) {
  std::vector<MetricEvent> events;
  auto reader = CaptureReader::open(path);
  EXPECT_TRUE(reader) << reader.reason();
  while (reader) {
    auto event = reader->next();
    EXPECT_TRUE(event) << event.reason();
    if (!event || !event->has_value()) break;
    events.push_back(std::move(**event));
  }
  return events;
}

MetricEvent smallEvent(std::int64_t time = 1'700'000'000'123'456'789) {
  return {3952132, 0, {0x10, 0x03}, std::chrono::nanoseconds(time)};
}

TEST(CaptureWriter, AFileIsNanosecondPcapOfLinkTypeUser0) {
  const ScratchFile file("a.pcap");
  {
    auto writer = CaptureWriter::create(file.path(), Flushing::inBlocks);
    ASSERT_TRUE(writer) << writer.reason();
    EXPECT_EQ(writer->write(smallEvent()), std::nullopt);
    EXPECT_EQ(writer->count(), 1U);
  }
  EXPECT_THAT(file.content(),
              testing::ElementsAre(
                  // magic number, version 2.4, time zone, accuracy, longest packet 262144, link type 147
                  0x4D, 0x3C, 0xB2, 0xA1, 2, 0, 4, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 4, 0, 147, 0, 0, 0,
                  // 1700000000 s, 123456789 ns, 11 of 11 bytes
                  0x00, 0xF1, 0x53, 0x65, 0x15, 0xCD, 0x5B, 0x07, 11, 0, 0, 0, 11, 0, 0, 0,
                  // metric_id 3952132, profile_id 0, payload of two bytes
                  0x08, 0x84, 0x9C, 0xF1, 0x01, 0x10, 0x00, 0x1A, 0x02, 0x10, 0x03));
}

TEST(CaptureWriter, WhatIsWrittenIsReadBack) {
  std::vector<MetricEvent> events = {
      smallEvent(),
      {0x3C40C2, -1, {}, std::chrono::nanoseconds(0)},
      {std::numeric_limits<std::int32_t>::max(), std::numeric_limits<std::int32_t>::min(), Bytes(200'000, 0xAB),
       std::chrono::nanoseconds(4'294'967'295'999'999'999)},
      {0, 1, {0}, std::chrono::nanoseconds(999'999'999)},
  };
  const ScratchFile file("a.pcap");
  {
    auto writer = CaptureWriter::create(file.path(), Flushing::inBlocks);
    ASSERT_TRUE(writer) << writer.reason();
    for (const MetricEvent& event : events) EXPECT_EQ(writer->write(event), std::nullopt);
    EXPECT_EQ(writer->flush(), std::nullopt);
    EXPECT_TRUE(std::ranges::equal(eventsIn(file.path()), events, sameEvent));
  }
  EXPECT_TRUE(std::ranges::equal(eventsIn(file.path()), events, sameEvent));
}

TEST(CaptureWriter, AnEmptyCaptureIsOneFromTheStart) {
  const ScratchFile file("a.pcap");
  auto writer = CaptureWriter::create(file.path(), Flushing::inBlocks);
  ASSERT_TRUE(writer) << writer.reason();
  EXPECT_TRUE(eventsIn(file.path()).empty());
}

TEST(CaptureWriter, AKillLosesNoPacketThatWasFlushed) {
  const ScratchFile file("a.pcap");
  const pid_t child = ::fork();
  if (child == 0) {
    auto writer = CaptureWriter::create(file.path(), Flushing::eachPacket);
    for (int count = 0; count < 3; ++count) {
      if (!writer || writer->write(smallEvent(count))) ::_exit(1);
    }
    ::kill(::getpid(), SIGKILL);
  }
  int status = 0;
  ASSERT_EQ(::waitpid(child, &status, 0), child);
  ASSERT_TRUE(WIFSIGNALED(status));
  EXPECT_EQ(eventsIn(file.path()).size(), 3U);
}

TEST(CaptureWriter, BlocksAreFlushedWhenAsked) {
  const ScratchFile file("a.pcap");
  auto writer = CaptureWriter::create(file.path(), Flushing::inBlocks);
  ASSERT_TRUE(writer) << writer.reason();
  EXPECT_EQ(writer->write(smallEvent()), std::nullopt);
  EXPECT_EQ(eventsIn(file.path()).size(), 0U);
  EXPECT_EQ(writer->flush(), std::nullopt);
  EXPECT_EQ(eventsIn(file.path()).size(), 1U);
}

TEST(CaptureWriter, AMinusIsStandardOutputWhichStaysOpen) {
  const ScratchFile file("a.pcap");
  const int target = ::open(file.path().c_str(), O_WRONLY | O_CLOEXEC);
  const int before = ::dup(STDOUT_FILENO);
  ::dup2(target, STDOUT_FILENO);
  {
    auto writer = CaptureWriter::create("-", Flushing::inBlocks);
    ASSERT_TRUE(writer) << writer.reason();
    EXPECT_EQ(writer->write(smallEvent()), std::nullopt);
  }
  EXPECT_NE(::fcntl(STDOUT_FILENO, F_GETFD), -1);
  ::dup2(before, STDOUT_FILENO);
  EXPECT_EQ(eventsIn(file.path()).size(), 1U);
}

TEST(CaptureWriter, AWholeCaptureTakesItsNameAtTheEnd) {
  const TemporaryFolder folder;
  auto writer = CaptureWriter::createWhole(folder / "a.pcap", Flushing::inBlocks, CaptureWriter::Existing::refuse);
  ASSERT_TRUE(writer) << writer.reason();
  EXPECT_TRUE(writer->isPartial());
  EXPECT_EQ(writer->write(smallEvent()), std::nullopt);
  EXPECT_FALSE(std::filesystem::exists(folder / "a.pcap"));
  EXPECT_EQ(writer->finish(), std::nullopt);
  EXPECT_FALSE(writer->isPartial());
  EXPECT_EQ(writer->leavePartial(), "");
  EXPECT_EQ(eventsIn(folder / "a.pcap").size(), 1U);
}

TEST(CaptureWriter, APartialCaptureStaysOnlyWithEvents) {
  const TemporaryFolder folder;
  const auto create = [&folder] {
    auto writer = CaptureWriter::createWhole(folder / "a.pcap", Flushing::inBlocks, CaptureWriter::Existing::refuse);
    EXPECT_TRUE(writer) << writer.reason();
    return std::move(*writer);
  };
  EXPECT_EQ(create().leavePartial(), "");
  EXPECT_TRUE(std::filesystem::is_empty(folder.path()));
  CaptureWriter writer = create();
  EXPECT_EQ(writer.write(smallEvent()), std::nullopt);
  EXPECT_EQ(writer.leavePartial(), "; 1 events are in " + (folder / "a.partial.pcap"));
  EXPECT_EQ(eventsIn(folder / "a.partial.pcap").size(), 1U);
}

TEST(CaptureWriter, AFolderThatIsNotThereIsNamed) {
  const auto writer = CaptureWriter::create("/nowhere/a.pcap", Flushing::inBlocks);
  ASSERT_FALSE(writer);
  EXPECT_EQ(writer.reason(), "/nowhere/a.pcap: cannot be created: No such file or directory");
}

TEST(CaptureWriter, AFullDiskIsReportedAtOnce) {
  const auto writer = CaptureWriter::create("/dev/full", Flushing::inBlocks);
  ASSERT_FALSE(writer);
  EXPECT_EQ(writer.reason(), "/dev/full: cannot be written: No space left on device");
}

TEST(CaptureWriter, ADiskThatFillsUpIsReportedWithThePacket) {
  const ScratchFile file("a.pcap");
  auto writer = CaptureWriter::create(file.path(), Flushing::eachPacket);
  ASSERT_TRUE(writer) << writer.reason();
  ASSERT_EQ(writer->write(smallEvent()), std::nullopt);
  const FileLimit limit(64);
  EXPECT_EQ(writer->write(smallEvent()), file.path() + ": packet 1: cannot be written: File too large");
  EXPECT_EQ(eventsIn(file.path()).size(), 1U);
}

TEST(CaptureWriter, TimesThatTheFormatCannotHoldAreRefused) {
  const ScratchFile file("a.pcap");
  auto writer = CaptureWriter::create(file.path(), Flushing::eachPacket);
  ASSERT_TRUE(writer) << writer.reason();
  EXPECT_EQ(writer->write(smallEvent(-1)), file.path() + ": packet 0: time out of range");
  EXPECT_EQ(writer->write(smallEvent(4'294'967'296'000'000'000)), file.path() + ": packet 0: time out of range");
  EXPECT_TRUE(eventsIn(file.path()).empty());
}

TEST(CaptureWriter, APacketThatNoReaderTakesIsRefused) {
  const ScratchFile file("a.pcap");
  auto writer = CaptureWriter::create(file.path(), Flushing::eachPacket);
  ASSERT_TRUE(writer) << writer.reason();
  MetricEvent event = smallEvent();
  // With 11 bytes for the event's other fields.
  event.payload.resize(262'144 - 11);
  EXPECT_EQ(writer->write(event), std::nullopt);
  event.payload.resize(262'144);
  EXPECT_EQ(writer->write(event), file.path() + ": packet 1: 262155 bytes where at most 262144 fit");
}

}  // namespace
}  // namespace vespscope::test
