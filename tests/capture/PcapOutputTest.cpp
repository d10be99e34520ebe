// A file contains whole packets after any failure.
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <filesystem>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "capture/PcapOutput.h"
#include "support/FileLimit.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using namespace capture;
using testing::HasSubstr;

constexpr std::uint64_t headerSize = 24;
constexpr std::uint64_t packetSize = 16 + 10;

PcapPacket packet(std::uint8_t content) {
  static std::vector<std::uint8_t> bytes;
  bytes.assign(10, content);
  return {bytes, std::chrono::seconds(1)};
}

PcapOutput open(const std::string& path, PcapOutput::Existing existing = PcapOutput::Existing::replace) {
  auto output = PcapOutput::create(path, existing);
  EXPECT_TRUE(output) << output.reason();
  return std::move(*output);
}

// The first bytes of the packets that a reader finds, as digits; "!" at the end if the file is invalid.
std::string packetsIn(const std::string& path) {
  auto input = PcapInput::open(path);
  if (!input) return input.reason();
  std::string found;
  while (true) {
    const auto next = input->next();
    if (!next) return found + "!";
    if (!next->has_value()) return found;
    found += std::to_string((*next)->bytes[0]);
  }
}

TEST(PcapOutputFile, OnADiskThatFillsUpEndsWithAWholePacketAndContinuesWhenThereIsSpace) {
  // The disk is full at every byte of the second packet.
  for (std::uint64_t more = 0; more < packetSize; ++more) {
    const TemporaryFolder folder;
    const std::string path = folder / "a.pcap";
    PcapOutput output = open(path);
    ASSERT_FALSE(output.write(packet(1)) || output.flush());
    {
      const FileLimit limit(headerSize + packetSize + more);
      ASSERT_FALSE(output.write(packet(2)));
      EXPECT_EQ(output.flush(), "cannot be written: File too large");
      EXPECT_TRUE(output.unwritable());
      EXPECT_FALSE(output.broken());
      EXPECT_EQ(output.packets(), 1U);
      EXPECT_EQ(std::filesystem::file_size(path), headerSize + packetSize);
      EXPECT_EQ(packetsIn(path), "1");
    }
    ASSERT_FALSE(output.write(packet(3)) || output.flush());
    EXPECT_EQ(output.packets(), 2U);
    EXPECT_EQ(output.size(), headerSize + 2 * packetSize);
    EXPECT_EQ(packetsIn(path), "13") << more;
  }
}

TEST(PcapOutputFile, OfABlockThatDoesNotFitKeepsThePacketsThatDo) {
  const TemporaryFolder folder;
  const std::string path = folder / "a.pcap";
  PcapOutput output = open(path);
  const FileLimit limit(headerSize + 3 * packetSize + 7);
  for (std::uint8_t number = 1; number < 9; ++number) ASSERT_FALSE(output.write(packet(number)));
  EXPECT_EQ(output.packets(), 8U);
  EXPECT_TRUE(output.flush());
  EXPECT_EQ(output.packets(), 3U);
  EXPECT_EQ(packetsIn(path), "123");
}

TEST(PcapOutputFile, WhoseHeaderDoesNotFitLeavesNoFile) {
  const TemporaryFolder folder;
  const FileLimit limit(headerSize - 1);
  const auto output = PcapOutput::create(folder / "a.pcap");
  ASSERT_FALSE(output);
  EXPECT_EQ(output.reason(), "cannot be written: File too large");
  EXPECT_FALSE(std::filesystem::exists(folder / "a.pcap"));
}

TEST(PcapOutputFile, ThatIsAppendedToAFileCutsOffItsOwnPartOnly) {
  const TemporaryFolder folder;
  const std::string path = folder.write("both", std::string(100, 'x'));
  const int before = ::dup(STDOUT_FILENO);
  const int file = ::open(path.c_str(), O_WRONLY | O_APPEND | O_CLOEXEC);
  ::dup2(file, STDOUT_FILENO);
  {
    PcapOutput output = open("-");
    const FileLimit limit(100 + headerSize + packetSize + 5);
    static_cast<void>(output.write(packet(1)));
    static_cast<void>(output.write(packet(2)));
    EXPECT_TRUE(output.flush());
    EXPECT_EQ(output.packets(), 1U);
  }
  ::dup2(before, STDOUT_FILENO);
  EXPECT_EQ(std::filesystem::file_size(path), 100 + headerSize + packetSize);
}

TEST(PcapOutputFile, WritesNothingMoreIntoAPipeThatHoldsAPartOfAPacket) {
  int ends[2];
  ASSERT_EQ(::pipe2(ends, O_CLOEXEC | O_NONBLOCK), 0);
  ASSERT_EQ(::fcntl(ends[1], F_SETPIPE_SZ, 4096), 4096);
  const int before = ::dup(STDOUT_FILENO);
  ::dup2(ends[1], STDOUT_FILENO);
  {
    PcapOutput output = open("-");
    ::dup2(before, STDOUT_FILENO);
    const std::vector<std::uint8_t> large(6000, 1);
    ASSERT_FALSE(output.write({large, {}}));
    EXPECT_EQ(output.flush(), "cannot be written: Resource temporarily unavailable");
    EXPECT_TRUE(output.broken());
    std::vector<char> sink(8192);
    EXPECT_GT(::read(ends[0], sink.data(), sink.size()), 24);  // the header and a part of the packet
    ASSERT_FALSE(output.write(packet(2)));
    EXPECT_EQ(output.flush(), "cannot be written: Input/output error");
  }
  char byte = 0;
  EXPECT_EQ(::read(ends[0], &byte, 1), -1);
  ::close(ends[0]);
  ::close(ends[1]);
}

TEST(PcapOutputFile, IsOpenToItsOwnerAlone) {
  const TemporaryFolder folder;
  const mode_t before = ::umask(0);
  const PcapOutput output = open(folder / "a.pcap");
  ::umask(before);
  struct stat file {};
  ASSERT_EQ(::stat((folder / "a.pcap").c_str(), &file), 0);
  EXPECT_EQ(file.st_mode & 07777, 0600U);
}

TEST(PcapOutputFile, ReplacesAFileOrRefusesTo) {
  const TemporaryFolder folder;
  const std::string path = folder.write("a.pcap", "precious");
  const auto refused = PcapOutput::create(path, PcapOutput::Existing::refuse);
  ASSERT_FALSE(refused);
  EXPECT_EQ(refused.reason(), "cannot be created: File exists");
  EXPECT_EQ(std::filesystem::file_size(path), 8U);
  EXPECT_EQ(open(folder / "b.pcap", PcapOutput::Existing::refuse).size(), headerSize);
  EXPECT_EQ(packetsIn(folder / "b.pcap"), "");
  EXPECT_EQ(std::distance(std::filesystem::directory_iterator(folder.path()), {}), 2);
  EXPECT_EQ(open(path).size(), headerSize);
  EXPECT_EQ(packetsIn(path), "");
}

TEST(PcapOutputFile, KnowsWhetherItsFileIsStillThere) {
  const TemporaryFolder folder;
  const std::string path = folder / "a.pcap";
  const PcapOutput output = open(path);
  EXPECT_TRUE(output.isAt(path));
  std::filesystem::rename(path, folder / "b.pcap");
  EXPECT_FALSE(output.isAt(path));
  const PcapOutput other = open(path);
  EXPECT_FALSE(output.isAt(path));
  EXPECT_TRUE(output.isAt(folder / "b.pcap"));
}

TEST(PcapOutputCutting, WorksForAFileThatEndsAtAnyByte) {
  for (std::uint64_t size = 0; size <= headerSize + 2 * packetSize; ++size) {
    const TemporaryFolder folder;
    const std::string path = folder / "a.pcap";
    {
      PcapOutput output = open(path);
      ASSERT_FALSE(output.write(packet(1)) || output.write(packet(2)));
    }
    std::filesystem::resize_file(path, size);
    const std::uint64_t whole = size < headerSize ? 0 : headerSize + (size - headerSize) / packetSize * packetSize;
    const auto cut = cutToWholePackets(path);
    ASSERT_TRUE(cut) << cut.reason();
    EXPECT_EQ(cut->bytes, whole);
    EXPECT_EQ(cut->packets, whole == 0 ? 0 : (whole - headerSize) / packetSize);
    if (whole == 0) continue;
    EXPECT_EQ(std::filesystem::file_size(path), whole);
    EXPECT_EQ(packetsIn(path), std::string("12").substr(0, (whole - headerSize) / packetSize)) << size;
  }
}

TEST(PcapOutputFile, DoesNotWriteBehindWhatAnotherProgramHasCutOffOrAdded) {
  const TemporaryFolder folder;
  const std::string path = folder / "a.pcap";
  for (const std::uint64_t size : {std::uint64_t{0}, headerSize + 3, headerSize + 3 * packetSize}) {
    PcapOutput output = open(path);
    ASSERT_FALSE(output.write(packet(1)) || output.flush());
    EXPECT_FALSE(output.wasChanged());
    std::filesystem::resize_file(path, size);
    EXPECT_TRUE(output.wasChanged());
    ASSERT_FALSE(output.write(packet(2)));
    EXPECT_EQ(output.flush(), "has been changed by another program");
    EXPECT_TRUE(output.broken());
    EXPECT_EQ(std::filesystem::file_size(path), size);
  }
}

TEST(PcapOutputFile, DoesNotWaitForTheReaderOfANamedPipe) {
  const TemporaryFolder folder;
  ASSERT_EQ(::mkfifo((folder / "pipe").c_str(), 0600), 0);
  EXPECT_EQ(PcapOutput::create(folder / "pipe").reason(), "cannot be created: No such device or address");
}

TEST(PcapOutputCutting, CutsOffTheZerosOfAPowerCut) {
  // Also as a hole, which would take hours to read.
  for (const std::uint64_t zeros : {std::uint64_t{16}, std::uint64_t{4096}, std::uint64_t{1} << 40}) {
    const TemporaryFolder folder;
    const std::string path = folder / "a.pcap";
    {
      PcapOutput output = open(path);
      ASSERT_FALSE(output.write(packet(1)) || output.write(packet(2)));
    }
    std::filesystem::resize_file(path, headerSize + 2 * packetSize + zeros);
    const auto cut = cutToWholePackets(path);
    ASSERT_TRUE(cut) << cut.reason();
    EXPECT_EQ(cut->packets, 2U);
    EXPECT_EQ(std::filesystem::file_size(path), headerSize + 2 * packetSize);
    EXPECT_EQ(packetsIn(path), "12");
  }
  const TemporaryFolder folder;
  const std::string path = folder.write("a.pcap", std::string(4096, '\0'));
  EXPECT_EQ(cutToWholePackets(path)->bytes, 0U);
  // Zeros in the middle are another kind of damage: what follows may be valid.
  { ASSERT_FALSE(open(path).write(packet(1))); }
  std::filesystem::resize_file(path, headerSize + packetSize + 16);
  const int file = ::open(path.c_str(), O_WRONLY | O_APPEND | O_CLOEXEC);
  ASSERT_EQ(::write(file, "more", 4), 4);
  ::close(file);
  EXPECT_EQ(cutToWholePackets(path).reason(), "damaged at byte " + std::to_string(headerSize + packetSize));
}

TEST(PcapOutputCutting, LeavesFilesOfOtherKindsAlone) {
  const TemporaryFolder folder;
  EXPECT_EQ(cutToWholePackets(folder / "none").reason(), "cannot be opened: No such file or directory");
  EXPECT_EQ(cutToWholePackets(folder.write("text", std::string(99, 'x'))).reason(), "not a recording of this program");
  EXPECT_EQ(std::filesystem::file_size(folder / "text"), 99U);
  std::filesystem::create_symlink(folder / "text", folder / "link");
  EXPECT_THAT(cutToWholePackets(folder / "link").reason(), HasSubstr("cannot be opened"));
  ASSERT_EQ(::mkfifo((folder / "pipe").c_str(), 0600), 0);
  EXPECT_EQ(cutToWholePackets(folder / "pipe").reason(), "not a regular file");
  // An impossible packet length: what follows may be valid.
  const std::string path = folder / "a.pcap";
  { static_cast<void>(open(path)); }
  const std::vector<std::uint8_t> damage(40, 0xFF);
  const int file = ::open(path.c_str(), O_WRONLY | O_APPEND | O_CLOEXEC);
  ASSERT_EQ(::write(file, damage.data(), damage.size()), 40);
  ::close(file);
  EXPECT_EQ(cutToWholePackets(path).reason(), "damaged at byte 24");
  EXPECT_EQ(std::filesystem::file_size(path), headerSize + 40);
}

}  // namespace
}  // namespace vespscope::test
