// Frames of a log: escapes, checksums, bounds.
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Bytes.h"
#include "sources/diag/FrameReader.h"
#include "sources/diag/LogCommands.h"

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

TEST(FrameReaderChecksum, TheCheckValueIs906E) {
  const std::string text = "123456789";
  EXPECT_EQ(crc16X25(Bytes(text.begin(), text.end())), 0x906E);
  EXPECT_EQ(crc16X25({}), 0x0000);
}

// Bit by bit, as the polynomial is defined.
unsigned remainderOf(const Bytes& bytes) {
  unsigned crc = 0xFFFF;
  for (const std::uint8_t byte : bytes) {
    crc ^= byte;
    for (int bit = 0; bit < 8; ++bit) crc = (crc & 1U) != 0 ? crc >> 1U ^ 0x8408U : crc >> 1U;
  }
  return ~crc & 0xFFFFU;
}

TEST(FrameReaderChecksum, OfEveryLengthIsTheRemainderBitByBit) {
  Bytes bytes;
  for (unsigned length = 0; length < 64; ++length) {
    EXPECT_EQ(crc16X25(bytes), remainderOf(bytes)) << length;
    bytes.push_back(static_cast<std::uint8_t>(length * 37 + 11));
  }
}

TEST(FrameReader, BytesOfEveryValueAreReadInPiecesOfAnyLength) {
  std::vector<Bytes> contents;
  Bytes stream;
  for (std::size_t length = 1; length < 40; ++length) {
    Bytes content;
    for (std::size_t i = 0; i < length; ++i) content.push_back(static_cast<std::uint8_t>(0x6C + i * length));
    const Bytes frame = frameWith(content);
    stream.insert(stream.end(), frame.begin(), frame.end());
    contents.push_back(content);
  }
  for (const std::size_t pieceLength :
       {std::size_t{1}, std::size_t{7}, std::size_t{8}, std::size_t{9}, stream.size()}) {
    FrameReader reader;
    EXPECT_EQ(framesOf(reader, stream, pieceLength), contents) << pieceLength;
  }
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
