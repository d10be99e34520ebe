// A modem's log as a stream of events.
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <chrono>
#include <cstdlib>
#include <filesystem>
#include <map>
#include <thread>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Bytes.h"
#include "LiteralRecords.h"
#include "sources/diag/DecodedMetrics.h"
#include "sources/diag/DiagStream.h"
#include "sources/diag/LogCommands.h"
#include "support/ScratchFile.h"

namespace vespscope::test {
namespace {

using namespace sources;

std::vector<MetricEvent> eventsOf(EventStream& stream) {
  std::vector<MetricEvent> events;
  while (auto event = stream.next()) events.push_back(std::move(*event));
  return events;
}

// A description of the serving cell, 1.25 seconds after the modem's clock began, and a measurement 10 ms later.
Bytes smallLog() {
  Bytes log = frameOf(recordOf(0xB0C2, 1250, bytesOf(literal::servingCellV3)));
  append(log, frameOf(recordOf(0xB193, 1260, bytesOf(literal::measurementV19))));
  return log;
}
constexpr std::array<std::int32_t, 3> smallLogMetrics = {0x3C40C2, 0x3CD30B, 0x3C4F6A};

std::vector<std::int32_t> metricsOf(const std::vector<MetricEvent>& events) {
  std::vector<std::int32_t> metrics;
  for (const MetricEvent& event : events) metrics.push_back(event.metricID);
  return metrics;
}

TEST(DiagStream, EventsCarryTheTimesOfTheirRecords) {
  const ScratchFile file("small.log", smallLog());
  auto stream = openDiagStream(file.path());
  ASSERT_TRUE(stream) << stream.reason();
  const auto events = eventsOf(**stream);
  EXPECT_THAT(metricsOf(events), testing::ElementsAreArray(smallLogMetrics));
  EXPECT_EQ(events[0].time, std::chrono::milliseconds(315'964'801'250));
  EXPECT_EQ(events[2].time, std::chrono::milliseconds(315'964'801'260));
  EXPECT_EQ(events[0].profileID, 0);
  EXPECT_EQ(recordOf(events[0]).find("timestamp")->asInteger(), 315'964'801'250);
  EXPECT_FALSE((*stream)->failure());
}

TEST(DiagStream, ALogIsARecordingNamedAfterItsFile) {
  const ScratchFile file("drive home.mi2log", smallLog());
  auto stream = openDiagStream(file.path());
  ASSERT_TRUE(stream) << stream.reason();
  EXPECT_EQ((*stream)->label(), "drive home.mi2log");
  EXPECT_EQ((*stream)->kind(), SourceKind::recorded);
  EXPECT_FALSE((*stream)->simCardFiles({}));
}

TEST(DiagStream, AfterARewindTheSameEventsComeAgain) {
  const ScratchFile file("small.log", smallLog());
  auto stream = openDiagStream(file.path());
  ASSERT_TRUE(stream) << stream.reason();
  ASSERT_TRUE((*stream)->canRewind());
  // In the middle of a record's events, at the end, and before the first event.
  ASSERT_TRUE((*stream)->next());
  ASSERT_TRUE((*stream)->next());
  for (int round = 0; round < 3; ++round) {
    (*stream)->rewind();
    if (round == 2) (*stream)->rewind();
    const auto events = eventsOf(**stream);
    EXPECT_THAT(metricsOf(events), testing::ElementsAreArray(smallLogMetrics));
    EXPECT_EQ((*stream)->summary(), "2 frames, 2 records read, 0 skipped");
  }
}

TEST(DiagStream, MeasuresItsLengthBesideReading) {
  const ScratchFile file("small.log", smallLog());
  auto stream = openDiagStream(file.path());
  ASSERT_TRUE(stream) << stream.reason();
  ASSERT_TRUE((*stream)->next());
  EXPECT_EQ((*stream)->length({}), std::chrono::milliseconds(10));
  EXPECT_EQ(eventsOf(**stream).size(), smallLogMetrics.size() - 1);
}

TEST(DiagStream, DamageCostsOnlyTheFramesItIsIn) {
  Bytes log = bytesOf("aa bb cc 7e");
  append(log, frameOf(bytesOf("79 01 02")));
  append(log, frameOf(bytesOf("10 00 ff 00 ff 00")));
  append(log, smallLog());
  append(log, bytesOf("10 00 0e"));
  const ScratchFile file("damaged.log", log);
  auto stream = openDiagStream(file.path());
  ASSERT_TRUE(stream) << stream.reason();
  EXPECT_THAT(metricsOf(eventsOf(**stream)), testing::ElementsAreArray(smallLogMetrics));
  EXPECT_EQ((*stream)->summary(),
            "4 frames, 2 records read, 0 skipped, 1 frames of another kind, 1 malformed frames, 1 frames with a bad "
            "checksum, 1 frame cut at the end");
}

TEST(DiagStream, EachRadioHasACellOfItsOwn) {
  Bytes log;
  for (const std::uint8_t radio : Bytes{1, 2, 1, 2}) {
    Bytes record = bytesOf("98 01 00 00 00 00 00 00");
    record[4] = radio;
    Bytes measurement = bytesOf(literal::measurementV19);
    measurement[16] = radio;  // the physical identity
    append(record, recordOf(0xB193, 1000, measurement));
    append(log, frameOf(record));
  }
  const ScratchFile file("two.log", log);
  auto stream = openDiagStream(file.path());
  ASSERT_TRUE(stream) << stream.reason();
  std::vector<std::int32_t> profiles;
  for (const MetricEvent& event : eventsOf(**stream)) {
    if (event.metricID == 0x3C40C2) profiles.push_back(event.profileID);
  }
  EXPECT_THAT(profiles, testing::ElementsAre(1, 2));
}

TEST(DiagStream, MoreRadiosThanAPhoneHasAreCounted) {
  Bytes log;
  for (std::uint8_t radio = 1; radio <= 6; ++radio) {
    Bytes record = bytesOf("98 01 00 00 00 00 00 00");
    record[7] = radio;
    append(record, recordOf(0xB193, 1000, bytesOf(literal::measurementV19)));
    append(log, frameOf(record));
  }
  const ScratchFile file("many.log", log);
  auto stream = openDiagStream(file.path());
  ASSERT_TRUE(stream) << stream.reason();
  eventsOf(**stream);
  EXPECT_EQ((*stream)->summary(), "6 frames, 4 records read, 0 skipped, 2 records of other radios");
}

TEST(DiagStream, AFileThatIsNotThereIsNamed) {
  auto stream = openDiagStream("/nowhere/drive.log");
  ASSERT_FALSE(stream);
  EXPECT_EQ(stream.reason(), "/nowhere/drive.log: cannot be opened: No such file or directory");
}

TEST(DiagStream, AFolderCannotBeRead) {
  auto stream = openDiagStream("/");
  ASSERT_FALSE(stream);
  EXPECT_EQ(stream.reason(), "/: is a folder, not a file");
}

TEST(DiagStream, ANamedPipeIsRefusedWithoutWaitingForItsWriter) {
  const std::string pipe = ScratchFile("log").path() + ".pipe";
  std::filesystem::create_directories(std::filesystem::path(pipe).parent_path());
  ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
  auto stream = openDiagStream(pipe);
  ASSERT_FALSE(stream);
  EXPECT_EQ(stream.reason(), pipe + ": is a pipe, not a file; read it through standard input (-)");
  std::filesystem::remove(pipe);
}

TEST(DiagStream, AnEmptyLogIsNamedAsSuch) {
  const ScratchFile file("empty.log");
  EXPECT_EQ(openDiagStream(file.path()).reason(), file.path() + ": is empty");
}

TEST(DiagStream, ReturnsFromASilentPipeWhenInterrupted) {
  std::array<int, 2> ends{};
  ASSERT_EQ(::pipe(ends.data()), 0);
  const Bytes log = smallLog();
  ASSERT_EQ(::write(ends[1], log.data(), log.size()), static_cast<ssize_t>(log.size()));
  ASSERT_EQ(::dup2(ends[0], STDIN_FILENO), STDIN_FILENO);
  auto stream = openDiagStream("-");
  ASSERT_TRUE(stream) << stream.reason();
  const std::jthread other([&stream] {
    std::this_thread::sleep_for(std::chrono::milliseconds(50));
    (*stream)->interrupt();
  });
  eventsOf(**stream);
  EXPECT_FALSE((*stream)->failure());
}

TEST(DiagStream, AFileOfAnUnknownFormatHasNoGoodFrame) {
  const ScratchFile file("noise", Bytes(3U << 20, 0x01));
  EXPECT_EQ(openDiagStream(file.path()).reason(),
            file.path() + ": not a modem log: no frame with a valid checksum in its first MiB");
}

TEST(DiagStream, ReadsALogThatIsCompressedWithGzip) {
  // The bytes of smallLog(), compressed at run time by the program gzip.
  const ScratchFile file("small.log", smallLog());
  const std::string packed = file.path() + ".gz";
  ASSERT_EQ(std::system(("gzip < '" + file.path() + "' > '" + packed + "'").c_str()), 0);
  auto stream = openDiagStream(packed);
  ASSERT_TRUE(stream) << stream.reason();
  EXPECT_TRUE((*stream)->canRewind());
  for (int round = 0; round < 2; ++round) {
    EXPECT_THAT(metricsOf(eventsOf(**stream)), testing::ElementsAreArray(smallLogMetrics));
    (*stream)->rewind();
  }
  EXPECT_EQ((*stream)->length({}), std::chrono::milliseconds(10));
  std::filesystem::remove(packed);
}

TEST(DiagStream, OpensAPipeBeforeItsFirstByteAndExaminesWhatComes) {
  std::array<int, 2> ends{};
  ASSERT_EQ(::pipe(ends.data()), 0);
  ASSERT_EQ(::dup2(ends[0], STDIN_FILENO), STDIN_FILENO);
  auto stream = openDiagStream("-");
  ASSERT_TRUE(stream) << stream.reason();
  ASSERT_EQ(::write(ends[1], "letter", 6), 6);
  ::close(ends[1]);
  EXPECT_FALSE((*stream)->next());
  EXPECT_EQ((*stream)->failure(), "standard input: not a modem log: it is text");
}

TEST(DiagStream, AFileWithoutAGoodFrameIsNoLog) {
  const ScratchFile file("letter.txt", Bytes(3U << 20, 'a'));
  auto stream = openDiagStream(file.path());
  ASSERT_FALSE(stream);
  EXPECT_EQ(stream.reason(), file.path() + ": not a modem log: it is text");
}

TEST(DiagStream, AMinusIsStandardInputWhichCannotBeRewound) {
  std::array<int, 2> ends{};
  ASSERT_EQ(::pipe(ends.data()), 0);
  const Bytes log = smallLog();
  ASSERT_EQ(::write(ends[1], log.data(), log.size()), static_cast<ssize_t>(log.size()));
  ::close(ends[1]);
  ASSERT_EQ(::dup2(ends[0], STDIN_FILENO), STDIN_FILENO);
  auto stream = openDiagStream("-");
  ASSERT_TRUE(stream) << stream.reason();
  EXPECT_EQ((*stream)->label(), "standard input");
  EXPECT_FALSE((*stream)->canRewind());
  EXPECT_THAT(metricsOf(eventsOf(**stream)), testing::ElementsAreArray(smallLogMetrics));
  EXPECT_DEATH((*stream)->rewind(), "cannot be rewound");
}

// For any file, reading ends and every event can be decoded.
TEST(DiagStream, RandomRecordsInGoodFramesDoNoHarm) {
  std::uint32_t state = 1;
  const auto random = [&state] {
    state = state * 1664525 + 1013904223;
    return state >> 16;
  };
  const std::span<const std::uint16_t> codes = diag::mappedCodes();
  // Headers that reach further into the record than random ones.
  const std::map<std::uint16_t, const char*> heads = {
      {0xB0C2, "03"},
      {0xB193, "01 01 00 00 19 13 50 00"},
      {0xB192, "01 01 00 00 1b 04 80 00"},
      {0xB179, "04"},
      {0xB195, "01 01 00 00 1f 04 80 00"},
      {0xB0EE, "02"},
      {0xB0E5, "01 00 05"},
      {0xB0E2, "01 09 05 00 52 00 c1"},
      {0xB0E3, "01 09 05 00 52 00 c2"},
      {0xB0EC, "01 09 05 00 07 49"},
      {0xB0ED, "01 09 05 00 07 48"},
      {0x713A, "00 20 00 00 00 08 02"},
      {0x412F, "01 00 18 00"},
      {0x512F, "80 1b 18 06 1b"},
  };
  Bytes log;
  for (int count = 0; count < 20'000; ++count) {
    Bytes payload(random() % 160);
    // Many small numbers, so that lengths and identities are often valid.
    for (std::uint8_t& byte : payload) byte = static_cast<std::uint8_t>(random() % 4 == 0 ? random() : random() & 1);
    const std::uint16_t code = codes[random() % codes.size()];
    const auto known = heads.find(code);
    const Bytes head = known == heads.end() ? Bytes{static_cast<std::uint8_t>(random() % 32)} : bytesOf(known->second);
    std::copy_n(head.begin(), std::min(head.size(), payload.size()), payload.begin());
    append(log, frameOf(recordOf(code, random() % 100'000 * 5, payload)));
  }
  const ScratchFile file("random.log", log);
  auto stream = openDiagStream(file.path());
  ASSERT_TRUE(stream) << stream.reason();
  std::size_t events = 0;
  while (const auto event = (*stream)->next()) {
    recordOf(*event);
    ++events;
  }
  EXPECT_GT(events, 500U);
}

}  // namespace
}  // namespace vespscope::test
