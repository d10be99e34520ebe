// Frames of a log: escapes, checksums, bounds.
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Bytes.h"
#include "sources/diag/FrameReader.h"

namespace vespscope::test {
namespace {

using namespace sources::diag;
using testing::ElementsAre;
using testing::IsEmpty;

std::vector<Bytes> framesOf(FrameReader& reader, const Bytes& stream, std::size_t pieceLength) {
  std::vector<Bytes> frames;
  for (std::size_t start = 0; start < stream.size(); start += pieceLength) {
    reader.feed(std::span(stream).subspan(start, std::min(pieceLength, stream.size() - start)));
    while (const auto frame = reader.next()) frames.emplace_back(frame->begin(), frame->end());
  }
  reader.finish();
  return frames;
}

std::vector<Bytes> framesOf(FrameReader& reader, std::string_view dump) {
  return framesOf(reader, bytesOf(dump), 1U << 20);
}

TEST(Crc16X25, TheCheckValueIs906E) {
  const std::string text = "123456789";
  EXPECT_EQ(crc16X25(Bytes(text.begin(), text.end())), 0x906E);
  EXPECT_EQ(crc16X25({}), 0x0000);
}

TEST(FrameReader, AFrameLosesItsChecksumAndItsEnd) {
  FrameReader reader;
  EXPECT_THAT(framesOf(reader, "41 f5 a3 7e"), ElementsAre(bytesOf("41")));
  EXPECT_EQ(reader.counters(), (FrameCounters{.good = 1}));
}

TEST(FrameReader, EscapedBytesAreRestored) {
  FrameReader reader;
  EXPECT_THAT(framesOf(reader, "10 00 0e 00 0e 00 c2 b0 00 00 21 24 29 ca d3 00 7d 5e 7d 5d f1 28 7e"),
              ElementsAre(bytesOf("10 00 0e 00 0e 00 c2 b0 00 00 21 24 29 ca d3 00 7e 7d")));
}

TEST(FrameReader, AFrameMayComeInPiecesOfAnyLength) {
  const Bytes stream = bytesOf("41 f5 a3 7e 7d 5e 81 6a 7e 41 f5 a3 7e");
  for (std::size_t pieceLength = 1; pieceLength <= stream.size(); ++pieceLength) {
    FrameReader reader;
    EXPECT_THAT(framesOf(reader, stream, pieceLength), ElementsAre(bytesOf("41"), bytesOf("7e"), bytesOf("41")))
        << pieceLength;
  }
}

TEST(FrameReader, AFrameWithABadChecksumIsDroppedAndCounted) {
  FrameReader reader;
  EXPECT_THAT(framesOf(reader, "41 f5 a4 7e 41 f5 a3 7e"), ElementsAre(bytesOf("41")));
  EXPECT_EQ(reader.counters(), (FrameCounters{.good = 1, .badChecksum = 1}));
}

TEST(FrameReader, AStreamThatBeginsInTheMiddleOfAFrameLosesThatFrameOnly) {
  FrameReader reader;
  EXPECT_THAT(framesOf(reader, "ca d3 00 7d 5e 7d 5d f1 28 7e 41 f5 a3 7e"), ElementsAre(bytesOf("41")));
  EXPECT_EQ(reader.counters(), (FrameCounters{.good = 1, .badChecksum = 1}));
}

TEST(FrameReader, EndsInARowHoldNoFrame) {
  FrameReader reader;
  EXPECT_THAT(framesOf(reader, "7e 7e 41 f5 a3 7e 7e"), ElementsAre(bytesOf("41")));
  EXPECT_EQ(reader.counters(), (FrameCounters{.good = 1}));
}

TEST(FrameReader, AFrameShorterThanAChecksumAndOneByteIsBad) {
  FrameReader reader;
  EXPECT_THAT(framesOf(reader, "41 7e 00 00 7e"), IsEmpty());
  EXPECT_EQ(reader.counters(), (FrameCounters{.badChecksum = 2}));
}

TEST(FrameReader, AnEscapeBeforeTheEndAbortsTheFrame) {
  FrameReader reader;
  EXPECT_THAT(framesOf(reader, "41 f5 a3 7d 7e 41 f5 a3 7e"), ElementsAre(bytesOf("41")));
  EXPECT_EQ(reader.counters(), (FrameCounters{.good = 1, .aborted = 1}));
}

TEST(FrameReader, AFrameWithoutItsEndIsCountedWhenTheStreamEnds) {
  FrameReader reader;
  EXPECT_THAT(framesOf(reader, "41 f5 a3 7e 41 f5 a3"), ElementsAre(bytesOf("41")));
  EXPECT_EQ(reader.counters(), (FrameCounters{.good = 1, .truncated = 1}));
}

TEST(FrameReader, AnEndlessFrameTakesNoMoreMemoryThanTheLongest) {
  FrameReader reader;
  Bytes stream(FrameReader::maximumFrameLength + 1, 0x55);
  append(stream, bytesOf("7e 41 f5 a3 7e"));
  EXPECT_THAT(framesOf(reader, stream, 4096), ElementsAre(bytesOf("41")));
  EXPECT_EQ(reader.counters(), (FrameCounters{.good = 1, .oversized = 1}));
}

TEST(FrameReader, TheLongestFrameIsRead) {
  FrameReader reader;
  const Bytes content(FrameReader::maximumFrameLength - 2, 0x7E);
  EXPECT_THAT(framesOf(reader, frameOf(content), 4096), ElementsAre(content));
}

}  // namespace
}  // namespace vespscope::test
