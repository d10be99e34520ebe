// The text rendering of values, and texts made printable.
#include <cmath>
#include <cstdint>
#include <limits>
#include <string>

#include <gtest/gtest.h>

#include "values/Text.h"

namespace vespscope::test {
namespace {

TEST(Text, IntegersAreDecimalDigits) {
  EXPECT_EQ(toText(Value(-116)), "-116");
  EXPECT_EQ(toText(Value(4294967295U)), "4294967295");
  EXPECT_EQ(toText(Value(std::numeric_limits<std::int64_t>::min())), "-9223372036854775808");
  EXPECT_EQ(toText(Value(std::numeric_limits<std::uint64_t>::max())), "18446744073709551615");
}

TEST(Text, IntegersOfEveryLengthAreTheirDigits) {
  for (std::uint64_t power = 1; power <= 1'000'000'000'000; power *= 10) {
    for (const std::uint64_t number : {power - 1, power, power + 1, 2 * power + 7, 9 * power, 12'345'678'901 % power}) {
      EXPECT_EQ(toText(Value(number)), std::to_string(number));
      EXPECT_EQ(toText(Value(static_cast<std::int64_t>(number))), std::to_string(number));
      EXPECT_EQ(toText(Value(-static_cast<std::int64_t>(number))), std::to_string(-static_cast<std::int64_t>(number)));
    }
  }
  for (std::uint32_t number = 0; number < 100'000; ++number) ASSERT_EQ(toText(Value(number)), std::to_string(number));
}

TEST(Text, BooleansAreOneAndZero) {
  EXPECT_EQ(toText(Value(true)), "1");
  EXPECT_EQ(toText(Value(false)), "0");
}

TEST(Text, FloatingPointIsTheShortestTextThatReadsBack) {
  EXPECT_EQ(toText(Value(-24.5F)), "-24.5");
  EXPECT_EQ(toText(Value(20.0F)), "20.0");
  EXPECT_EQ(toText(Value(1.4F)), "1.4");
  EXPECT_EQ(toText(Value(-10.43F)), "-10.43");
  EXPECT_EQ(toText(Value(0.1)), "0.1");
  EXPECT_EQ(toText(Value(100000.0)), "100000.0");
  EXPECT_EQ(toText(Value(0.0)), "0.0");
  EXPECT_EQ(toText(Value(-0.0)), "-0.0");
  EXPECT_EQ(toText(Value(1e300)), "1e+300");
  EXPECT_EQ(toText(Value(1.5e-7)), "1.5e-07");
}

TEST(Text, NumbersThatAreNoneHaveNames) {
  EXPECT_EQ(toText(Value(std::nan(""))), "nan");
  EXPECT_EQ(toText(Value(std::numeric_limits<float>::infinity())), "inf");
  EXPECT_EQ(toText(Value(-std::numeric_limits<double>::infinity())), "-inf");
}

TEST(Text, BytesAreHexadecimalPairsInAngleBrackets) {
  EXPECT_EQ(toText(Value(Bytes{0x13, 0x00, 0x14})), "<13 00 14>");
  EXPECT_EQ(toText(Value(Bytes{0xFF})), "<ff>");
  EXPECT_EQ(toText(Value(Bytes{})), "<>");
}

TEST(Text, RecordsAndListsNest) {
  const Record record{{"timestamp", "t"}, {"list", List{1, Record{{"a", "b"}}, List{}}}, {"empty", Record{}}};
  EXPECT_EQ(toText(record), "[timestamp: t, list: [1, [a: b], []], empty: []]");
  EXPECT_EQ(toText(Value(record)), toText(record));
}

TEST(Text, NullHasAName) { EXPECT_EQ(toText(Value()), "null"); }

TEST(Text, IsAlwaysOneLine) {
  EXPECT_EQ(toText(Value("internet\nmnc\r\t")), "internet␊mnc␍␉");
  EXPECT_EQ(toText(Record{{Key(std::string("a\nb")), 1}}), "[a␊b: 1]");
}

TEST(TextPrintable, KeepsValidUtf8) { EXPECT_EQ(printable("Grüße, 移动, 📶"), "Grüße, 移动, 📶"); }

TEST(TextPrintable, ShowsEveryInvalidByteAsTheReplacementCharacter) {
  EXPECT_EQ(printable("a\xFF"
                      "b"),
            "a\uFFFDb");
  EXPECT_EQ(printable("\xC3"), "\uFFFD");
  EXPECT_EQ(printable("\xC0\x80"), "\uFFFD\uFFFD");
  EXPECT_EQ(printable("\xED\xA0\x80"), "\uFFFD\uFFFD\uFFFD");
  EXPECT_EQ(printable("\xF4\x90\x80\x80"), "\uFFFD\uFFFD\uFFFD\uFFFD");
  EXPECT_EQ(printable("\xE2\x82"), "\uFFFD\uFFFD");
}

TEST(TextPrintable, ShowsControlCharactersByTheirPictures) {
  EXPECT_EQ(printable(std::string_view("\0\x1B[2J\x7F", 6)), "␀␛[2J␡");
}

TEST(TextPrintable, FindsAControlCharacterAtAnyPosition) {
  for (const char control : {'\x1B', '\x7F', '\0', '\x1F'}) {
    const std::string picture = printable(std::string(1, control));
    for (std::size_t size = 1; size < 40; ++size) {
      const std::string plain(size, 'x');
      EXPECT_EQ(printable(plain), plain);
      EXPECT_TRUE(isPlain(plain));
      for (std::size_t position = 0; position < size; ++position) {
        std::string text = plain;
        text[position] = control;
        const std::string expected = plain.substr(0, position) + picture + plain.substr(position + 1);
        ASSERT_EQ(printable(text), expected) << size << " characters, at " << position;
        ASSERT_FALSE(isPlain(text));
        ASSERT_EQ(toText(Record{{text, 1}}), "[" + expected + ": 1]");
      }
    }
  }
}

TEST(Text, GrowsAsLongAsTheValueIs) {
  const std::string megabyte(std::size_t{1} << 20, 'x');
  EXPECT_EQ(toText(Record{{"apn", megabyte}, {"id", 5}}), "[apn: " + megabyte + ", id: 5]");
  std::string line = "Received ";
  appendText(line, Record{{"id", 5}});
  EXPECT_EQ(line, "Received [id: 5]");
  EXPECT_EQ(toText(Value(Bytes{})), "<>");
  EXPECT_EQ(toText(Value(Bytes(5000, 0xA5))).size(), 3 * 5000 + 1U);
}

TEST(TextPrintable, DisarmsWhatBreaksOrReordersALine) {
  EXPECT_EQ(printable("\u0085"), "\uFFFD");      // next line
  EXPECT_EQ(printable("\u009B2J"), "\uFFFD2J");  // control sequence introducer
  EXPECT_EQ(printable("\u2028"), "\uFFFD");      // line separator
  EXPECT_EQ(printable("\u202E"), "\uFFFD");      // right-to-left override
  EXPECT_EQ(printable("\u2067"), "\uFFFD");      // right-to-left isolate
  EXPECT_EQ(printable("\u00A0\u2027\u202F\u2065"), "\u00A0\u2027\u202F\u2065");
}

}  // namespace
}  // namespace vespscope::test
