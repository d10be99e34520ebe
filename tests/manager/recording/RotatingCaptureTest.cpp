// The folder of recordings: when files begin and are removed, and what happens when the disk or the folder fails.
#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <ctime>
#include <filesystem>
#include <fstream>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "capture/CaptureReader.h"
#include "manager/recording/RotatingCapture.h"
#include "platform/log/Log.h"
#include "support/FileLimit.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using namespace manager;
using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::StartsWith;

constexpr std::uint64_t headerSize = 24;
constexpr std::uint64_t packetSize = 16 + 5 + 2 + 3 + 200;  // of event() below

class RotatingCaptureFolder : public testing::Test {
 protected:
  RotatingCaptureFolder() { log::discardOutputs(); }

  std::unique_ptr<RotatingCapture> open(const RecordingLimits& limits = {}) {
    auto capture = RotatingCapture::open(folder / "rec", limits,
                                         {.now = [this] { return now; }, .steady = [this] { return steady; }});
    EXPECT_TRUE(capture) << capture.reason();
    return std::move(*capture);
  }
  void pass(std::chrono::milliseconds time) {
    now += time;
    steady += time;
  }
  static SharedEvent event(int number, std::size_t payload = 200) {
    return std::make_shared<const MetricEvent>(
        MetricEvent{0x3C4E04, 0, Bytes(payload, static_cast<std::uint8_t>(number)), std::chrono::seconds(number)});
  }
  static RecordingOutcome write(RotatingCapture& capture, int first, int last) {
    std::vector<SharedEvent> events;
    for (int number = first; number <= last; ++number) events.push_back(event(number));
    return capture.write(events);
  }
  [[nodiscard]] std::vector<std::string> names() const {
    std::vector<std::string> found;
    for (const auto& entry : std::filesystem::directory_iterator(folder / "rec")) {
      found.push_back(entry.path().filename().string());
    }
    std::sort(found.begin(), found.end());
    return found;
  }
  [[nodiscard]] std::string path(const std::string& name) const { return folder / ("rec/" + name); }
  // The times, in seconds, of the events of a file or of the whole folder.
  [[nodiscard]] std::vector<int> events(const std::string& file = "") const {
    std::vector<int> found;
    auto reader = capture::CaptureReader::open(path(file));
    EXPECT_TRUE(reader) << reader.reason();
    while (reader) {
      const auto next = reader->next();
      EXPECT_TRUE(next) << next.reason();
      if (!next || !next->has_value()) break;
      found.push_back(static_cast<int>((*next)->time / 1s));
    }
    return found;
  }
  std::vector<std::string> lines() {
    const std::lock_guard lock(mutex);
    return lines_;
  }

  TemporaryFolder folder;
  std::chrono::system_clock::time_point now =
      std::chrono::sys_days(std::chrono::year(2026) / 11 / 21) + 13h + 25min + 1s + 42ms;
  std::chrono::steady_clock::time_point steady{};

 private:
  std::mutex mutex;
  std::vector<std::string> lines_;
  log::Observation observation{[this](log::Channel, std::string_view line) {
    const std::lock_guard lock(mutex);
    lines_.emplace_back(line);
  }};
};

TEST_F(RotatingCaptureFolder, BelongsToItsOwnerAloneAndSoDoItsFiles) {
  const mode_t before = ::umask(0);
  const auto capture = open();
  EXPECT_THAT(names(), IsEmpty());  // the file is created with the first event
  write(*capture, 1, 2);
  ::umask(before);
  ASSERT_THAT(names(), ElementsAre("vespscope-20261121T132501.042Z.pcap"));
  struct stat status {};
  ASSERT_EQ(::stat(path("").c_str(), &status), 0);
  EXPECT_EQ(status.st_mode & 07777, 0700U);
  ASSERT_EQ(::stat(path(names()[0]).c_str(), &status), 0);
  EXPECT_EQ(status.st_mode & 07777, 0600U);
}

TEST_F(RotatingCaptureFolder, WhatIsWrittenIsInTheFileAtOnce) {
  const auto capture = open();
  const RecordingOutcome outcome = write(*capture, 1, 3);
  EXPECT_EQ(outcome.taken, 3U);
  EXPECT_EQ(outcome.refused, 0U);
  EXPECT_FALSE(outcome.problem);
  EXPECT_THAT(events(), ElementsAre(1, 2, 3));
}

TEST_F(RotatingCaptureFolder, ANewFileBeginsBeforeOneIsLargerThanItMay) {
  const auto capture = open({.fileSize = headerSize + 3 * packetSize + 64});
  write(*capture, 1, 8);
  pass(1s);
  write(*capture, 9, 10);
  ASSERT_THAT(names(), ElementsAre("vespscope-20261121T132501.042Z.pcap", "vespscope-20261121T132501.043Z.pcap",
                                   "vespscope-20261121T132501.044Z.pcap", "vespscope-20261121T132502.042Z.pcap"));
  EXPECT_THAT(events(names()[0]), ElementsAre(1, 2, 3));
  EXPECT_THAT(events(names()[3]), ElementsAre(10));
  EXPECT_THAT(events(), ElementsAre(1, 2, 3, 4, 5, 6, 7, 8, 9, 10));
  for (const std::string& name : names())
    EXPECT_LE(std::filesystem::file_size(path(name)), headerSize + 3 * packetSize);
}

TEST_F(RotatingCaptureFolder, AnEventLargerThanAFileMayBeHasAFileOfItsOwn) {
  const auto capture = open({.fileSize = 1000, .totalSize = 1'000'000});
  capture->write(std::vector{event(1), event(2, 5000), event(3)});
  EXPECT_EQ(names().size(), 3U);
  EXPECT_THAT(events(), ElementsAre(1, 2, 3));
}

TEST_F(RotatingCaptureFolder, ANewFileBeginsWhenOneIsOldEnough) {
  const auto capture = open({.fileAge = 60s});
  write(*capture, 1, 1);
  pass(59s);
  write(*capture, 2, 2);
  EXPECT_EQ(names().size(), 1U);
  pass(1s);
  write(*capture, 3, 3);
  ASSERT_THAT(names(), ElementsAre("vespscope-20261121T132501.042Z.pcap", "vespscope-20261121T132601.042Z.pcap"));
  EXPECT_THAT(events(names()[1]), ElementsAre(3));
}

TEST_F(RotatingCaptureFolder, AClockThatIsSetBackNeitherEndsAFileNorMakesTheNextOneLookOlder) {
  const auto capture = open({.fileAge = 60s});
  write(*capture, 1, 1);
  now -= 24h * 365;
  write(*capture, 2, 2);
  EXPECT_EQ(names().size(), 1U);
  pass(60s);
  write(*capture, 3, 3);
  EXPECT_THAT(names(), ElementsAre("vespscope-20261121T132501.042Z.pcap", "vespscope-20261121T132501.043Z.pcap"));
  EXPECT_THAT(events(), ElementsAre(1, 2, 3));
}

TEST_F(RotatingCaptureFolder, TheOldestFilesGoWhenAllTogetherAreTooLarge) {
  constexpr std::uint64_t fileSize = headerSize + 3 * packetSize + 64;
  const auto capture = open({.fileSize = fileSize, .totalSize = 3 * fileSize});
  for (int number = 1; number <= 30; ++number) {
    pass(1s);
    write(*capture, number, number);
    std::uint64_t total = 0;
    for (const std::string& name : names()) total += std::filesystem::file_size(path(name));
    EXPECT_LE(total, 3 * fileSize);
  }
  EXPECT_THAT(events(), ElementsAre(22, 23, 24, 25, 26, 27, 28, 29, 30));
}

TEST_F(RotatingCaptureFolder, FilesOfAnEarlierRunCountToo) {
  constexpr std::uint64_t fileSize = headerSize + 3 * packetSize + 64;
  for (int run = 0; run < 5; ++run) {
    const auto capture = open({.fileSize = fileSize, .totalSize = 2 * fileSize});
    pass(1s);
    write(*capture, 10 * run, 10 * run + 2);
  }
  EXPECT_THAT(events(), ElementsAre(30, 31, 32, 40, 41, 42));
}

TEST_F(RotatingCaptureFolder, FilesThatAreTooOldGo) {
  const auto capture = open({.fileAge = 60s, .keep = 150s});
  now = std::chrono::system_clock::now();  // the system stamps the file
  write(*capture, 1, 1);
  pass(100s);
  write(*capture, 2, 2);
  EXPECT_THAT(events(), ElementsAre(1, 2));
  pass(100s);
  write(*capture, 3, 3);
  EXPECT_THAT(events(), ElementsAre(3));  // all were written at the real time, 200 s ago
}

TEST_F(RotatingCaptureFolder, FilesThatAreNotItsOwnStay) {
  constexpr std::uint64_t fileSize = headerSize + 3 * packetSize + 64;
  std::filesystem::create_directories(path(""));
  const std::vector<std::string> others = {"drive.pcap", "notes.txt", "vespscope-20001121T132501.042Z.pcap.bak",
                                           "vespscope-20001121.pcap"};
  for (const std::string& name : others) std::ofstream(path(name)) << std::string(100'000, 'x');
  // Names like those of recordings, but of a folder, a link and another user's file.
  std::filesystem::create_directories(path("vespscope-20000101T000000.000Z.pcap/in"));
  std::filesystem::create_symlink(path("drive.pcap"), path("vespscope-20000102T000000.000Z.pcap"));
  std::vector<std::string> kept = others;
  kept.insert(kept.end(), {"vespscope-20000101T000000.000Z.pcap", "vespscope-20000102T000000.000Z.pcap"});
  if (::geteuid() == 0) {
    std::ofstream(path("vespscope-20000103T000000.000Z.pcap")) << std::string(100'000, 'x');
    ASSERT_EQ(::chown(path("vespscope-20000103T000000.000Z.pcap").c_str(), 65534, 65534), 0);
    kept.emplace_back("vespscope-20000103T000000.000Z.pcap");
  }
  const auto capture = open({.fileSize = fileSize, .totalSize = fileSize, .keep = 1s});
  for (int number = 1; number <= 9; ++number) {
    pass(1h);
    write(*capture, number, number);
  }
  const std::vector<std::string> left = names();
  for (const std::string& name : kept) EXPECT_THAT(left, testing::Contains(name));
  EXPECT_EQ(left.size(), kept.size() + 1);
  EXPECT_EQ(std::filesystem::file_size(path("drive.pcap")), 100'000U);
}

TEST_F(RotatingCaptureFolder, ADiskThatFillsUpLeavesWholePacketsAndIsWrittenToAgainWhenThereIsRoom) {
  for (std::uint64_t part = 0; part < packetSize; part += 45) {
    const auto capture = open();
    const FileLimit limit(headerSize + 2 * packetSize + part);
    RecordingOutcome outcome = write(*capture, 1, 5);
    EXPECT_EQ(outcome.taken, 2U);
    ASSERT_TRUE(outcome.problem);
    EXPECT_THAT(*outcome.problem, EndsWith("cannot be written: File too large"));
    EXPECT_THAT(events(), ElementsAre(1, 2));
    outcome = write(*capture, 3, 5);
    EXPECT_EQ(outcome.taken, 0U);
    EXPECT_TRUE(outcome.problem);
    EXPECT_THAT(events(), ElementsAre(1, 2));
    limit.set(1'000'000);
    outcome = write(*capture, 3, 5);
    EXPECT_EQ(outcome.taken, 3U);
    EXPECT_FALSE(outcome.problem);
    EXPECT_THAT(events(), ElementsAre(1, 2, 3, 4, 5));
    std::filesystem::remove_all(path(""));
  }
}

TEST_F(RotatingCaptureFolder, OnADiskWithoutRoomForANewFileNoneIsLeftBehind) {
  const auto capture = open();
  {
    const FileLimit limit(headerSize - 1);
    const RecordingOutcome outcome = write(*capture, 1, 2);
    EXPECT_EQ(outcome.taken, 0U);
    ASSERT_TRUE(outcome.problem);
    EXPECT_THAT(*outcome.problem, EndsWith("132501.042Z.pcap: cannot be written: File too large"));
    EXPECT_THAT(names(), IsEmpty());
  }
  EXPECT_EQ(write(*capture, 1, 2).taken, 2U);
  EXPECT_THAT(events(), ElementsAre(1, 2));
}

TEST_F(RotatingCaptureFolder, EventsThatNoFileCanHoldAreLeftOut) {
  const auto capture = open();
  const auto early = std::make_shared<const MetricEvent>(MetricEvent{1, 0, {}, -1s});
  RecordingOutcome outcome = capture->write(std::vector{event(1), event(2, 300'000), event(3), early});
  EXPECT_EQ(outcome.taken, 4U);
  EXPECT_EQ(outcome.refused, 2U);
  EXPECT_FALSE(outcome.problem);
  EXPECT_THAT(events(), ElementsAre(1, 3));
  const FileLimit limit(headerSize + 2 * packetSize + 10);
  outcome = capture->write(std::vector{early, event(4)});
  EXPECT_TRUE(outcome.problem);
  EXPECT_EQ(outcome.taken, 0U);
  EXPECT_EQ(outcome.refused, 0U);
}

TEST_F(RotatingCaptureFolder, AFileThatIsRemovedOrMovedIsFollowedByAnother) {
  const auto capture = open();
  write(*capture, 1, 1);
  std::filesystem::remove(path(names()[0]));
  pass(1s);
  write(*capture, 2, 2);
  EXPECT_THAT(events(), ElementsAre(2));
  ASSERT_EQ(lines().size(), 1U);
  EXPECT_THAT(lines()[0], EndsWith("132501.042Z.pcap: has been removed; a new recording begins"));
  std::filesystem::rename(path(names()[0]), path("mine.pcap"));
  pass(1s);
  write(*capture, 3, 3);
  EXPECT_THAT(events("mine.pcap"), ElementsAre(2));
  EXPECT_THAT(events(names()[1]), ElementsAre(3));
}

TEST_F(RotatingCaptureFolder, WhenItIsRemovedIsMadeAgain) {
  const auto capture = open();
  write(*capture, 1, 1);
  std::filesystem::remove_all(path(""));
  write(*capture, 2, 3);
  EXPECT_THAT(events(), ElementsAre(2, 3));
  struct stat status {};
  ASSERT_EQ(::stat(path("").c_str(), &status), 0);
  EXPECT_EQ(status.st_mode & 07777, 0700U);
  // Moved away, and replaced.
  std::filesystem::rename(path(""), folder / "moved");
  std::ofstream(folder / "rec") << "in the way";
  const RecordingOutcome outcome = write(*capture, 4, 4);
  EXPECT_EQ(outcome.taken, 0U);
  EXPECT_EQ(outcome.problem, (folder / "rec") + ": cannot record into this folder: Not a directory");
  std::filesystem::remove(folder / "rec");
  EXPECT_EQ(write(*capture, 4, 4).taken, 1U);
  EXPECT_THAT(events(), ElementsAre(4));
}

TEST_F(RotatingCaptureFolder, IsForOneRecorderAtATime) {
  auto first = open();
  const auto second = RotatingCapture::open(folder / "rec", {});
  ASSERT_FALSE(second);
  EXPECT_EQ(second.reason(), (folder / "rec") + ": another program is recording into it");
  first.reset();
  EXPECT_TRUE(RotatingCapture::open(folder / "rec", {}));
}

TEST_F(RotatingCaptureFolder, ThatCannotBeMadeIsReportedAtOnce) {
  const auto inFile = RotatingCapture::open(folder.write("file", "") + "/rec", {});
  ASSERT_FALSE(inFile);
  EXPECT_EQ(inFile.reason(), (folder / "file/rec") + ": cannot record into this folder: Not a directory");
}

TEST_F(RotatingCaptureFolder, TheLastFileOfAKilledRunIsMadeWhole) {
  std::string name;
  {
    const auto capture = open();
    write(*capture, 1, 3);
    name = names()[0];
  }
  std::filesystem::resize_file(path(name), std::filesystem::file_size(path(name)) - 1);
  const auto capture = open();
  EXPECT_EQ(std::filesystem::file_size(path(name)), headerSize + 2 * packetSize);
  EXPECT_THAT(lines(), ElementsAre(EndsWith(name + ": removed 225 bytes after the last whole packet")));
  pass(1s);
  write(*capture, 4, 4);
  EXPECT_THAT(events(), ElementsAre(1, 2, 4));
}

TEST_F(RotatingCaptureFolder, TheLastFileOfAPowerCutIsMadeWhole) {
  {
    const auto capture = open();
    write(*capture, 1, 3);
  }
  const std::string file = path(names()[0]);
  std::filesystem::resize_file(file, std::filesystem::file_size(file) + 4096);
  const auto capture = open();
  EXPECT_THAT(lines(), ElementsAre(EndsWith(": removed 4096 bytes after the last whole packet")));
  EXPECT_THAT(events(), ElementsAre(1, 2, 3));
}

TEST_F(RotatingCaptureFolder, AFileThatAnotherProgramCutsIsFollowedByAnotherAndItsEventsAreCounted) {
  const auto capture = open();
  write(*capture, 1, 3);
  const std::string name = names()[0];
  std::filesystem::resize_file(path(name), headerSize + packetSize + 7);
  pass(1s);
  const RecordingOutcome outcome = write(*capture, 4, 5);
  EXPECT_EQ(outcome.taken, 2U);
  EXPECT_EQ(outcome.removed, 2U);
  EXPECT_FALSE(outcome.problem);
  EXPECT_THAT(lines(), ElementsAre(EndsWith(name + ": was changed by another program, 2 of its events are lost; "
                                                   "a new recording begins")));
  EXPECT_EQ(names().size(), 2U);
  EXPECT_THAT(events(), ElementsAre(1, 4, 5));
}

TEST_F(RotatingCaptureFolder, ANameFromTheEndOfTimeDoesNotEndRecording) {
  std::filesystem::create_directories(path(""));
  for (const char* name : {"vespscope-99991231T235959.999Z.pcap", "vespscope-99981231T235959.999Z.pcap"}) {
    auto file = capture::CaptureWriter::create(path(name), capture::Flushing::inBlocks);
    ASSERT_TRUE(file && !file->write(*event(0)) && !file->flush());
  }
  const auto capture = open({.fileAge = 60s});
  for (int number = 1; number <= 3; ++number) {
    const RecordingOutcome outcome = write(*capture, number, number);
    EXPECT_EQ(outcome.taken, 1U) << outcome.problem.value_or("");
    pass(60s);
  }
  EXPECT_THAT(events(), ElementsAre(1, 2, 3, 0, 0));
}

TEST_F(RotatingCaptureFolder, OfManyFilesIsReadOnceAndOnlyAgainWhenAnotherProgramChangesIt) {
  constexpr int many = 5'000;
  std::filesystem::create_directories(path(""));
  for (int number = 0; number < many; ++number) {
    const auto name = recordingName(std::chrono::floor<std::chrono::milliseconds>(now) - 24h + number * 1ms);
    std::ofstream(path(name)) << std::string(24, 'x');
  }
  const auto capture = open({.fileSize = headerSize + packetSize + 64});
  const std::clock_t begin = std::clock();
  for (int number = 1; number <= 500; ++number) {
    pass(1s);
    write(*capture, number, number);
  }
  // Processor time: reading all names for every file would take several times as much.
  EXPECT_LT((std::clock() - begin) / CLOCKS_PER_SEC, 5);
  EXPECT_EQ(names().size(), many + 500U);
}

TEST_F(RotatingCaptureFolder, AFileOfAKilledRunThatHoldsNothingGoes) {
  std::filesystem::create_directories(path(""));
  std::ofstream(path("vespscope-20201121T132501.042Z.pcap")) << "";
  std::ofstream(path("vespscope-20201121T132501.043Z.pcap.new")) << "";
  const auto capture = open();
  EXPECT_THAT(names(), IsEmpty());
}

TEST_F(RotatingCaptureFolder, AFileOfItsNameWithOtherContentsIsLeftAloneAndNamed) {
  std::filesystem::create_directories(path(""));
  std::ofstream(path("vespscope-20201121T132501.042Z.pcap")) << std::string(50, 'x');
  const auto capture = open();
  EXPECT_EQ(std::filesystem::file_size(path("vespscope-20201121T132501.042Z.pcap")), 50U);
  EXPECT_THAT(lines(), ElementsAre(EndsWith("not a recording of this program")));
}

}  // namespace
}  // namespace vespscope::test
