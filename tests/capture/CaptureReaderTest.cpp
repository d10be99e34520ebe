// Captures are read completely, damaged ones up to the damage, with an error.
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <thread>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "capture/CaptureReader.h"
#include "capture/CaptureWriter.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using namespace capture;

const std::filesystem::path samples = std::filesystem::path(VESPSCOPE_SOURCE_DIR) / "tests" / "capture";

std::vector<std::string> filesIn(const std::string& folder) {
  std::vector<std::string> files;
  for (const auto& entry : std::filesystem::directory_iterator(samples / folder)) {
    if (entry.path().extension() != ".expected") files.push_back(entry.path().filename());
  }
  std::sort(files.begin(), files.end());
  return files;
}

std::string testNameOf(const testing::TestParamInfo<std::string>& parameter) {
  std::string name = parameter.param;
  for (char& character : name) {
    if (std::isalnum(static_cast<unsigned char>(character)) == 0) character = '_';
  }
  return name;
}

void expectTheThreeEvents(CaptureReader& reader, std::chrono::nanoseconds resolution) {
  using std::chrono::nanoseconds;
  const auto read = [&reader] {
    auto event = reader.next();
    EXPECT_TRUE(event) << event.reason();
    return event && event->has_value() ? **event : MetricEvent{};
  };
  const MetricEvent first = read();
  EXPECT_EQ(first.metricID, 3952132);
  EXPECT_EQ(first.profileID, 0);
  EXPECT_EQ(first.payload, (Bytes{0x10, 0x03}));
  EXPECT_EQ(first.time, nanoseconds(1'700'000'000'123'456'789) / resolution * resolution);
  const MetricEvent second = read();
  EXPECT_EQ(second.metricID, 3948738);
  EXPECT_EQ(second.profileID, -1);
  EXPECT_TRUE(second.payload.empty());
  EXPECT_EQ(second.time, nanoseconds(1'700'000'001'000'000'000));
  // An unknown field, no profile, no payload; the last time in 32 bits of seconds.
  const MetricEvent third = read();
  EXPECT_EQ(third.metricID, 3932179);
  EXPECT_EQ(third.profileID, 0);
  EXPECT_TRUE(third.payload.empty());
  EXPECT_EQ(third.time, nanoseconds(4'294'967'295'999'999'999) / resolution * resolution);
  EXPECT_EQ(reader.count(), 3U);
  for (int again = 0; again < 2; ++again) {
    const auto end = reader.next();
    ASSERT_TRUE(end) << end.reason();
    EXPECT_FALSE(end->has_value());
  }
}

class CaptureReaderValid : public testing::TestWithParam<std::string> {};

TEST_P(CaptureReaderValid, GivesItsEvents) {
  auto reader = CaptureReader::open(samples / "valid" / GetParam());
  ASSERT_TRUE(reader) << reader.reason();
  if (GetParam() == "no-packets.pcap") {
    const auto end = reader->next();
    ASSERT_TRUE(end) << end.reason();
    EXPECT_FALSE(end->has_value());
    return;
  }
  expectTheThreeEvents(*reader, std::chrono::nanoseconds(GetParam() == "microseconds.pcap" ? 1000 : 1));
}

INSTANTIATE_TEST_SUITE_P(Samples, CaptureReaderValid, testing::ValuesIn(filesIn("valid")), testNameOf);

class CaptureReaderInvalid : public testing::TestWithParam<std::string> {};

TEST_P(CaptureReaderInvalid, GivesWhatComesBeforeTheFailureAndItsReason) {
  const std::string path = samples / "invalid" / GetParam();
  std::ifstream expectation(path + ".expected");
  std::string count;
  std::string reason;
  ASSERT_TRUE(std::getline(expectation, count) && std::getline(expectation, reason));
  auto reader = CaptureReader::open(path);
  if (count == "none") {
    ASSERT_FALSE(reader);
    EXPECT_THAT(reader.reason(), testing::StartsWith(path + ": " + reason));
    return;
  }
  ASSERT_TRUE(reader) << reader.reason();
  for (int good = std::stoi(count); good > 0; --good) {
    const auto event = reader->next();
    ASSERT_TRUE(event) << event.reason();
    EXPECT_TRUE(event->has_value());
  }
  const auto failure = reader->next();
  ASSERT_FALSE(failure);
  EXPECT_THAT(failure.reason(), testing::StartsWith(path + ": " + reason));
  EXPECT_THAT(failure.reason(), testing::Not(testing::HasSubstr("\n")));
  const auto end = reader->next();
  ASSERT_TRUE(end);
  EXPECT_FALSE(end->has_value());
}

INSTANTIATE_TEST_SUITE_P(Samples, CaptureReaderInvalid, testing::ValuesIn(filesIn("invalid")), testNameOf);

TEST(CaptureReader, AFileThatIsNotThereIsNamed) {
  const auto reader = CaptureReader::open("/nowhere/drive.pcap");
  ASSERT_FALSE(reader);
  EXPECT_EQ(reader.reason(), "/nowhere/drive.pcap: cannot be opened: No such file or directory");
}

TEST(CaptureReader, AMinusIsStandardInput) {
  const std::string path = samples / "valid" / "nanoseconds.pcap";
  const int file = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
  ASSERT_EQ(::dup2(file, STDIN_FILENO), STDIN_FILENO);
  auto reader = CaptureReader::open("-");
  ASSERT_TRUE(reader) << reader.reason();
  expectTheThreeEvents(*reader, std::chrono::nanoseconds(1));
}

TEST(CaptureReader, ReasonsNameStandardInputByWords) {
  const int file = ::open("/dev/null", O_RDONLY | O_CLOEXEC);
  ASSERT_EQ(::dup2(file, STDIN_FILENO), STDIN_FILENO);
  const auto reader = CaptureReader::open("-");
  ASSERT_FALSE(reader);
  EXPECT_EQ(reader.reason(), "standard input: is empty");
}

TEST(CaptureReader, RefusesANamedPipeWithoutWaitingForItsWriter) {
  const TemporaryFolder folder;
  ASSERT_EQ(::mkfifo((folder / "a.pcap").c_str(), 0600), 0);
  const auto reader = CaptureReader::open(folder / "a.pcap");
  ASSERT_FALSE(reader);
  EXPECT_EQ(reader.reason(), (folder / "a.pcap") + ": is a pipe, not a file; read it through standard input (-)");
}

TEST(CaptureReader, ReturnsTheEndOfASilentPipeWhenInterrupted) {
  std::ifstream file(samples / "valid" / "nanoseconds.pcap", std::ios::binary);
  const std::string whole{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
  std::array<int, 2> ends{};
  ASSERT_EQ(::pipe(ends.data()), 0);
  ASSERT_EQ(::dup2(ends[0], STDIN_FILENO), STDIN_FILENO);
  // The header, the first packet and the beginning of the second.
  ASSERT_EQ(::write(ends[1], whole.data(), 60), 60);
  const auto interruption = std::make_shared<const dispatch::WakeDescriptor>();
  auto reader = CaptureReader::open("-", interruption);
  ASSERT_TRUE(reader) << reader.reason();
  EXPECT_TRUE(reader->next()->has_value());
  const std::jthread other([&interruption] {
    std::this_thread::sleep_for(std::chrono::milliseconds(50));
    interruption->wake();
  });
  const auto end = reader->next();
  ASSERT_TRUE(end) << end.reason();
  EXPECT_FALSE(end->has_value());
}

// The same file truncated at every byte: all whole packets are read, then the end or one error.
TEST(CaptureReader, ACaptureCutAnywhereGivesItsWholePackets) {
  std::ifstream file(samples / "valid" / "nanoseconds.pcap", std::ios::binary);
  const std::string whole{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
  constexpr std::array<std::size_t, 4> packetEnds = {24, 24 + 27, 24 + 27 + 34, 24 + 27 + 34 + 25};
  ASSERT_EQ(whole.size(), packetEnds.back());
  const auto path = std::filesystem::temp_directory_path() / ("vespscope-cut-" + std::to_string(::getpid()) + ".pcap");
  for (std::size_t length = 24; length < whole.size(); ++length) {
    std::ofstream(path, std::ios::binary | std::ios::trunc) << whole.substr(0, length);
    auto reader = CaptureReader::open(path);
    ASSERT_TRUE(reader) << reader.reason();
    bool failed = false;
    while (true) {
      const auto event = reader->next();
      failed = !event;
      if (failed || !event->has_value()) break;
    }
    std::uint64_t whole_packets = 0;
    while (packetEnds[whole_packets + 1] <= length) ++whole_packets;
    EXPECT_EQ(reader->count(), whole_packets) << length;
    EXPECT_EQ(failed, length != packetEnds[whole_packets]) << length;
  }
  std::filesystem::remove(path);
}

class CaptureReaderOfAFolder : public testing::Test {
 protected:
  void write(const std::string& name, std::initializer_list<int> metrics) const {
    auto writer = CaptureWriter::create(folder / name, Flushing::inBlocks);
    ASSERT_TRUE(writer) << writer.reason();
    for (const int metric : metrics) ASSERT_EQ(writer->write({metric, 0, {1, 2, 3}, {}}), std::nullopt);
  }
  // The metrics that are read and the errors of the others, in order.
  [[nodiscard]] std::string read() const {
    auto reader = CaptureReader::open(folder.path().string());
    if (!reader) return reader.reason();
    std::string found;
    std::uint64_t events = 0;
    while (true) {
      const auto event = reader->next();
      if (event && !event->has_value()) break;
      found += event ? std::to_string((*event)->metricID) + " " : "(" + event.reason() + ") ";
      events += event ? 1 : 0;
      EXPECT_EQ(reader->count(), events);
    }
    EXPECT_FALSE(reader->next()->has_value());
    EXPECT_EQ(reader->bytesRead(), reader->bytesInAll());
    return found;
  }

  TemporaryFolder folder;
};

TEST_F(CaptureReaderOfAFolder, IsReadAsOneInTheOrderOfNames) {
  write("b.pcap", {3, 4});
  write("a.pcap", {1, 2});
  write("c.pcap", {});
  write("d.pcapng", {5});  // libpcap detects the format by the contents
  static_cast<void>(folder.write("notes.txt", "not a capture"));
  EXPECT_EQ(read(), "1 2 3 4 5 ");
}

TEST_F(CaptureReaderOfAFolder, IsReadWhereItsFilesAreCompressed) {
  write("a.pcap", {1, 2});
  write("b.pcap", {3, 4});
  write("c.pcap", {5});
  ASSERT_EQ(std::system(("gzip " + (folder / "a.pcap") + " && xz " + (folder / "b.pcap")).c_str()), 0);
  static_cast<void>(folder.write("notes.txt.gz", "not a capture"));
  EXPECT_EQ(read(), "1 2 3 4 5 ");
}

TEST_F(CaptureReaderOfAFolder, IsReadOnBehindADamagedFile) {
  write("a.pcap", {1, 2});
  write("b.pcap", {3, 4});
  write("c.pcap", {5});
  const std::string damaged = folder / "b.pcap";
  std::filesystem::resize_file(damaged, std::filesystem::file_size(damaged) - 1);
  EXPECT_THAT(read(), testing::MatchesRegex("1 2 3 ." + damaged +
                                            ": packet 1: truncated.*; the rest of the file is skipped. 5 "));
  static_cast<void>(folder.write("b.pcap", "a letter"));
  EXPECT_THAT(read(), testing::MatchesRegex("1 2 ." + damaged + ": not a capture: .*; the file is skipped. 5 "));
  static_cast<void>(folder.write("b.pcap", ""));
  EXPECT_EQ(read(), "1 2 (" + damaged + ": is empty; the file is skipped) 5 ");
}

// A power failure can leave this after the last write.
TEST_F(CaptureReaderOfAFolder, IsReadOnBehindAFileThatEndsInZeros) {
  write("a.pcap", {1, 2});
  write("b.pcap", {3});
  std::ofstream(folder / "a.pcap", std::ios::binary | std::ios::app) << std::string(4096, '\0');
  EXPECT_EQ(read(),
            "1 2 (" + (folder / "a.pcap") +
                ": packet 2: a packet without bytes: the recording is damaged here, for example by a power failure; "
                "the rest of the file is skipped) 3 ");
}

TEST_F(CaptureReaderOfAFolder, IsReadOnBehindAPipeWithoutWaitingForItsWriter) {
  write("a.pcap", {1});
  ASSERT_EQ(::mkfifo((folder / "b.pcap").c_str(), 0600), 0);
  write("c.pcap", {2});
  EXPECT_EQ(read(), "1 (" + (folder / "b.pcap") +
                        ": is a pipe, not a file; read it through standard input (-); the file is skipped) 2 ");
}

TEST_F(CaptureReaderOfAFolder, WithoutACaptureIsReportedAsSuch) {
  EXPECT_EQ(read(), folder.path().string() + ": contains no captures (*.pcap, *.pcap.gz, *.pcap.xz)");
}

}  // namespace
}  // namespace vespscope::test
