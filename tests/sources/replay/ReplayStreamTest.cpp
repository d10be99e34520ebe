// Captures, and folders of them, as streams of events.
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <filesystem>
#include <thread>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "capture/CaptureWriter.h"
#include "sources/replay/ReplayStream.h"
#include "support/ScratchFile.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using sources::EventStream;
using sources::openReplayStream;

constexpr std::int32_t simMetric = 0x3C0013;
constexpr std::int32_t stateMetric = 0x3C4E04;

void writeCapture(const std::string& path, const std::vector<MetricEvent>& events) {
  auto writer = capture::CaptureWriter::create(path, capture::Flushing::inBlocks);
  ASSERT_TRUE(writer) << writer.reason();
  for (const MetricEvent& event : events) ASSERT_EQ(writer->write(event), std::nullopt);
}

std::vector<MetricEvent> drive() {
  using std::chrono::milliseconds;
  return {{stateMetric, 0, {1}, milliseconds(1000)},
          {simMetric, 0, {2}, milliseconds(1100)},
          {simMetric, 0, {3}, milliseconds(1200)},
          {stateMetric, 0, {4}, milliseconds(1050)}};
}

std::string payloadsOf(EventStream& stream) {
  std::string payloads;
  while (const auto event = stream.next()) payloads += std::to_string(event->payload.at(0));
  return payloads;
}

TEST(ReplayStream, EventsComeAsTheyWereCaptured) {
  const ScratchFile file("drive.pcap");
  writeCapture(file.path(), drive());
  auto stream = openReplayStream(file.path());
  ASSERT_TRUE(stream) << stream.reason();
  EXPECT_EQ((*stream)->label(), "drive.pcap");
  EXPECT_EQ((*stream)->kind(), SourceKind::recorded);
  const auto first = (*stream)->next();
  ASSERT_TRUE(first);
  EXPECT_EQ(first->metricID, stateMetric);
  EXPECT_EQ(first->time, std::chrono::seconds(1));
  EXPECT_EQ(payloadsOf(**stream), "234");
  EXPECT_FALSE((*stream)->next());
  EXPECT_FALSE((*stream)->failure());
  EXPECT_EQ((*stream)->summary(), "4 events");
}

TEST(ReplayStream, AfterARewindTheSameEventsComeAgain) {
  const ScratchFile file("drive.pcap");
  writeCapture(file.path(), drive());
  auto stream = openReplayStream(file.path());
  ASSERT_TRUE(stream) << stream.reason();
  ASSERT_TRUE((*stream)->canRewind());
  for (int round = 0; round < 3; ++round) {
    EXPECT_EQ(payloadsOf(**stream), "1234");
    (*stream)->rewind();
  }
}

TEST(ReplayStream, TheLastSimCardFilesOfTheFileAreThoseOfTheCard) {
  const ScratchFile file("drive.pcap");
  writeCapture(file.path(), drive());
  auto stream = openReplayStream(file.path());
  ASSERT_TRUE(stream) << stream.reason();
  const auto sim = (*stream)->simCardFiles({});
  ASSERT_TRUE(sim);
  EXPECT_EQ(sim->metricID, simMetric);
  EXPECT_EQ(sim->payload, Bytes{3});
  EXPECT_EQ(payloadsOf(**stream), "1234");
}

TEST(ReplayStream, AFolderOfCapturesIsOneRecording) {
  const TemporaryFolder folder;
  const std::vector<MetricEvent> events = drive();
  writeCapture(folder / "a.pcap", {events[0], events[1]});
  writeCapture(folder / "b.pcap", {events[2]});
  writeCapture(folder / "c.pcap", {events[3]});
  for (const std::string end : {"", "/", "/."}) {
    auto stream = openReplayStream(folder.path().string() + end);
    ASSERT_TRUE(stream) << stream.reason();
    EXPECT_EQ((*stream)->label(), folder.path().filename().string());
    EXPECT_EQ((*stream)->simCardFiles({})->payload, Bytes{3});
    ASSERT_TRUE((*stream)->canRewind());
    for (int round = 0; round < 3; ++round) {
      EXPECT_EQ(payloadsOf(**stream), "1234");
      EXPECT_EQ((*stream)->summary(), "4 events");
      (*stream)->rewind();
    }
  }
}

TEST(ReplayStream, ACaptureWithoutSimCardFilesHasNone) {
  const ScratchFile file("drive.pcap");
  writeCapture(file.path(), {{stateMetric, 0, {1}, std::chrono::seconds(1)}});
  auto stream = openReplayStream(file.path());
  ASSERT_TRUE(stream) << stream.reason();
  EXPECT_FALSE((*stream)->simCardFiles({}));
}

TEST(ReplayStream, MeasuresItsLengthBesideReading) {
  const ScratchFile file("drive.pcap");
  writeCapture(file.path(), drive());
  auto stream = openReplayStream(file.path());
  ASSERT_TRUE(stream) << stream.reason();
  ASSERT_TRUE((*stream)->next());
  EXPECT_EQ((*stream)->length({}), std::chrono::milliseconds(200));  // the last event's time runs backwards
  EXPECT_EQ(payloadsOf(**stream), "234");
  std::stop_source stop;
  stop.request_stop();
  EXPECT_EQ((*stream)->length(stop.get_token()), std::nullopt);
}

TEST(ReplayStream, ASearchThatWasStoppedIsMadeAgain) {
  const ScratchFile file("drive.pcap");
  writeCapture(file.path(), drive());
  auto stream = openReplayStream(file.path());
  ASSERT_TRUE(stream) << stream.reason();
  std::stop_source stop;
  stop.request_stop();
  EXPECT_FALSE((*stream)->simCardFiles(stop.get_token()));
  EXPECT_EQ((*stream)->simCardFiles({})->payload, Bytes{3});
}

TEST(ReplayStream, ACutCaptureGivesItsWholePacketsAndSaysWhyItEnds) {
  const ScratchFile file("drive.pcap");
  writeCapture(file.path(), drive());
  std::filesystem::resize_file(file.path(), std::filesystem::file_size(file.path()) - 1);
  auto stream = openReplayStream(file.path());
  ASSERT_TRUE(stream) << stream.reason();
  for (int round = 0; round < 2; ++round) {
    EXPECT_EQ(payloadsOf(**stream), "123");
    ASSERT_TRUE((*stream)->failure());
    EXPECT_THAT(*(*stream)->failure(), testing::StartsWith(file.path() + ": packet 3: truncated"));
    (*stream)->rewind();
    EXPECT_FALSE((*stream)->failure());
  }
  EXPECT_EQ((*stream)->simCardFiles({})->payload, Bytes{3});
}

TEST(ReplayStream, AFileThatIsGoneOnRewindEndsTheRun) {
  const ScratchFile file("drive.pcap");
  writeCapture(file.path(), drive());
  auto stream = openReplayStream(file.path());
  ASSERT_TRUE(stream) << stream.reason();
  std::filesystem::remove(file.path());
  EXPECT_EQ(payloadsOf(**stream), "1234");
  (*stream)->rewind();
  EXPECT_FALSE((*stream)->next());
  EXPECT_EQ((*stream)->failure(), file.path() + ": cannot be opened: No such file or directory");
}

TEST(ReplayStream, BadFilesAreNamed) {
  const auto missing = openReplayStream("/nowhere/drive.pcap");
  ASSERT_FALSE(missing);
  EXPECT_EQ(missing.reason(), "/nowhere/drive.pcap: cannot be opened: No such file or directory");
  const ScratchFile file("letter.txt", Bytes(100, 'a'));
  const auto letter = openReplayStream(file.path());
  ASSERT_FALSE(letter);
  EXPECT_EQ(letter.reason(), file.path() + ": not a capture: it is text");
}

TEST(ReplayStream, StandardInputIsReadOnceAndRemembersTheCard) {
  const ScratchFile file("drive.pcap");
  writeCapture(file.path(), drive());
  ASSERT_EQ(::dup2(::open(file.path().c_str(), O_RDONLY | O_CLOEXEC), STDIN_FILENO), STDIN_FILENO);
  auto stream = openReplayStream("-");
  ASSERT_TRUE(stream) << stream.reason();
  EXPECT_EQ((*stream)->label(), "standard input");
  EXPECT_FALSE((*stream)->canRewind());
  EXPECT_FALSE((*stream)->simCardFiles({}));
  EXPECT_EQ(payloadsOf(**stream), "1234");
  EXPECT_EQ((*stream)->simCardFiles({})->payload, Bytes{3});
  EXPECT_DEATH((*stream)->rewind(), "cannot be rewound");
}

TEST(ReplayStream, OpensAPipeBeforeItsFirstByteAndExaminesWhatComes) {
  std::array<int, 2> ends{};
  ASSERT_EQ(::pipe(ends.data()), 0);
  ASSERT_EQ(::dup2(ends[0], STDIN_FILENO), STDIN_FILENO);
  auto stream = openReplayStream("-");
  ASSERT_TRUE(stream) << stream.reason();
  ASSERT_EQ(::write(ends[1], "letter", 6), 6);
  ::close(ends[1]);
  EXPECT_FALSE((*stream)->next());
  EXPECT_THAT((*stream)->failure().value_or(""), testing::StartsWith("standard input: not a capture: "));
  EXPECT_FALSE((*stream)->next());
}

TEST(ReplayStream, AnInheritedPipeIsReadOnceToo) {
  const ScratchFile file("drive.pcap");
  writeCapture(file.path(), drive());
  const Bytes content = file.content();
  std::array<int, 2> ends{};
  ASSERT_EQ(::pipe(ends.data()), 0);
  ASSERT_EQ(::write(ends[1], content.data(), content.size()), static_cast<ssize_t>(content.size()));
  ::close(ends[1]);
  auto stream = openReplayStream("/dev/fd/" + std::to_string(ends[0]));
  ASSERT_TRUE(stream) << stream.reason();
  EXPECT_FALSE((*stream)->canRewind());
  EXPECT_FALSE((*stream)->simCardFiles({}));
  EXPECT_EQ(payloadsOf(**stream), "1234");
  ::close(ends[0]);
}

TEST(ReplayStream, ReadsOnBehindDamagedFilesOfAFolderAndNamesThem) {
  const TemporaryFolder folder;
  const std::vector<MetricEvent> events = drive();
  writeCapture(folder / "a.pcap", {events[0], events[1]});
  static_cast<void>(folder.write("b.pcap", "a letter"));
  ASSERT_EQ(::mkfifo((folder / "c.pcap").c_str(), 0600), 0);
  writeCapture(folder / "d.pcap", {events[2]});
  auto stream = openReplayStream(folder.path().string());
  ASSERT_TRUE(stream) << stream.reason();
  EXPECT_EQ(payloadsOf(**stream), "123");
  EXPECT_EQ((*stream)->simCardFiles({})->payload, Bytes{3});
  const std::string failure = (*stream)->failure().value_or("");
  EXPECT_THAT(failure, testing::StartsWith((folder / "b.pcap") + ": not a capture: "));
  EXPECT_THAT(failure, testing::HasSubstr("; " + (folder / "c.pcap") + ": is a pipe, not a file"));
}

TEST(ReplayStream, ReturnsFromASilentPipeWhenInterrupted) {
  const ScratchFile file("drive.pcap");
  writeCapture(file.path(), drive());
  const Bytes content = file.content();
  std::array<int, 2> ends{};
  ASSERT_EQ(::pipe(ends.data()), 0);
  ASSERT_EQ(::dup2(ends[0], STDIN_FILENO), STDIN_FILENO);
  ASSERT_EQ(::write(ends[1], content.data(), content.size()), static_cast<ssize_t>(content.size()));
  auto stream = openReplayStream("-");
  ASSERT_TRUE(stream) << stream.reason();
  const std::jthread other([&stream] {
    std::this_thread::sleep_for(std::chrono::milliseconds(50));
    (*stream)->interrupt();
  });
  EXPECT_EQ(payloadsOf(**stream), "1234");
  EXPECT_FALSE((*stream)->failure());
}

}  // namespace
}  // namespace vespscope::test
