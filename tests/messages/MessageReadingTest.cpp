// How messages read payloads that are unusual, foreign, damaged or hostile.
#include <span>

#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/gsm/KCellularGsmCsRfMeasurement.h"
#include "messages/gsm/KCellularGsmIdleConfig.h"
#include "messages/lte/KCellularEmmContext.h"
#include "messages/lte/KCellularLteRrcState.h"
#include "messages/lte/KCellularLteRsrpRsrqSinr.h"
#include "messages/lte/KCellularLteScellInfo.h"
#include "messages/lte/KCellularLteServingCellMeasurement.h"
#include "messages/mobility/BearerContext.h"
#include "messages/mobility/ElementaryFile.h"
#include "messages/mobility/KCellularMmContext.h"
#include "messages/mobility/KCellularSimCardFiles.h"

namespace vespscope::test {
namespace {

// Reads `digits` into a message, which keeps the state that the reader leaves.
template <class Message>
struct Reading {
  explicit Reading(std::string_view digits) : bytes(hex(digits)), reader(bytes), success(message.readFrom(reader)) {}
  Bytes bytes;
  WireReader reader;
  Message message;
  bool success;
};

TEST(MessageReading, AnEmptyPayloadIsAnEmptyMessage) {
  const Reading<KCellularLteRrcState> reading("");
  EXPECT_TRUE(reading.success);
  EXPECT_EQ(textOf(reading.message), "[]");
}

TEST(MessageReading, BytesAfterTheEndAreIgnoredEvenIfTheyEqualTheNextKey) {
  const Bytes bytes = hex("08 05 20 07");
  for (const std::size_t size : {0U, 2U}) {
    WireReader reader(std::span<const std::uint8_t>(bytes).first(size));
    KCellularLteRrcState message;
    EXPECT_TRUE(message.readFrom(reader));
    EXPECT_EQ(reader.position(), size);
    EXPECT_EQ(textOf(message), size == 0 ? "[]" : "[timestamp: 5]");
  }
  const Bytes longKey = hex("80 01 03");  // field 16
  for (const std::size_t size : {1U, 2U}) {
    WireReader reader(std::span<const std::uint8_t>(longKey).first(size));
    KCellularGsmIdleConfig message;
    EXPECT_FALSE(message.readFrom(reader)) << size;
  }
}

TEST(MessageReading, AKeyOfTwoBytesIsTakenByBoth) {
  EXPECT_EQ(textOf(*readFrom<KCellularGsmIdleConfig>("80 01 03")), "[cbq: 3]");
  EXPECT_EQ(textOf(*readFrom<KCellularGsmIdleConfig>("80 01 03 80 01 04 88 01 05")), "[cbq: 4, cba: 5]");
  // Another wire type does not match the key, as with keys of one byte.
  EXPECT_EQ(textOf(*readFrom<KCellularGsmIdleConfig>("81 01 05 88 01 06")), "[cbq: 5, cba: 6]");
  EXPECT_EQ(textOf(*readFrom<KCellularLteRrcState>("21 05 08 06")), "[timestamp: 6, prev_state_dur_ms: 5]");
  // Twice the unknown field 0, whose value is the second byte of that key.
  EXPECT_EQ(textOf(*readFrom<KCellularGsmIdleConfig>("00 01 00 01")), "[]");
}

TEST(MessageReading, AKeyOfWireTypeFourEndsTheReadWithSuccess) {
  const Reading<KCellularLteRrcState> reading("08 05 14 10 01");
  EXPECT_TRUE(reading.success);
  EXPECT_EQ(textOf(reading.message), "[timestamp: 5]");
  EXPECT_EQ(reading.reader.position(), 3U);
}

TEST(MessageReading, AKeyOfWireTypeFourEndsANestedMessageButNotTheOuterOne) {
  const Reading<KCellularEmmContext> reading("32 05 08 01 0c 10 02 10 03");
  EXPECT_TRUE(reading.success);
  EXPECT_EQ(textOf(reading.message), "[reg_status: KREG_STATUS_NO_SERVICE, guti: [mmegi: 1]]");
}

TEST(MessageReading, AVarintOfMoreThanTenBytesYieldsZeroForItsField) {
  const Reading<KCellularLteRrcState> reading("08 81 81 81 81 81 81 81 81 81 81 20 07");
  EXPECT_TRUE(reading.success);
  EXPECT_TRUE(reading.message.hasTimestamp());
  EXPECT_EQ(textOf(reading.message), "[timestamp: 0, prev_state_dur_ms: 7]");
}

TEST(MessageReading, AKeyOfMoreThanTenBytesIsFieldZeroAndSkipped) {
  const Reading<KCellularLteRrcState> reading("81 81 81 81 81 81 81 81 81 81 07 20 08");
  EXPECT_TRUE(reading.success);
  EXPECT_EQ(textOf(reading.message), "[prev_state_dur_ms: 8]");
}

TEST(MessageReading, FieldNumber65537IsReadAsFieldOne) {
  const Reading<KCellularLteRrcState> reading("88 80 20 2a");
  EXPECT_TRUE(reading.success);
  EXPECT_EQ(textOf(reading.message), "[timestamp: 42]");
}

TEST(MessageReading, TheLastOfSeveralValuesWins) {
  EXPECT_EQ(textOf(*readFrom<KCellularLteRrcState>("08 01 08 02")), "[timestamp: 2]");
}

TEST(MessageReading, AnEmbeddedMessageReplacesTheOneBefore) {
  EXPECT_EQ(textOf(*readFrom<KCellularEmmContext>("32 02 08 01 32 02 10 02")), "[guti: [mmec: 2]]");
}

TEST(MessageReading, NumbersTakeTheLow32BitsOfTheirVarint) {
  EXPECT_EQ(textOf(*readFrom<KCellularLteRrcState>("20 85 80 80 80 10")), "[prev_state_dur_ms: 5]");
  EXPECT_EQ(readFrom<KCellularLteRrcState>("10 ff ff ff ff 0f")->state(), -1);
  EXPECT_EQ(readFrom<KCellularLteRrcState>("10 ff ff ff ff ff ff ff ff ff 01")->state(), -1);
}

TEST(MessageReading, ATimestampTakesAll64Bits) {
  EXPECT_EQ(textOf(*readFrom<KCellularLteRrcState>("08 ff ff ff ff ff ff ff ff ff 01")),
            "[timestamp: 18446744073709551615]");
}

TEST(MessageReading, AFlagIsSetByAnyBitOfItsVarint) {
  EXPECT_TRUE(readFrom<KCellularLteServingCellMeasurement>("10 80 80 80 80 80 01")->isConnectedMode());
  const auto cleared = readFrom<KCellularLteServingCellMeasurement>("10 00");
  EXPECT_TRUE(cleared->hasIsConnectedMode());
  EXPECT_FALSE(cleared->isConnectedMode());
}

TEST(MessageReading, AKnownFieldIsReadByItsKindWhateverItsWireType) {
  EXPECT_EQ(textOf(*readFrom<KCellularLteRrcState>("0a 05 10 02")),
            "[timestamp: 5, state: KLTE_RRC_STATE_ATMPT_CONNECTION]")
      << "a length-delimited timestamp";
  EXPECT_EQ(textOf(*readFrom<ElementaryFile>("10 02 ca fe 08 07")), "[ef_id: 7, content: <ca fe>]")
      << "a varint where bytes are known";
  EXPECT_EQ(textOf(*readFrom<KCellularEmmContext>("35 02 08 01")), "[guti: [mmegi: 1]]")
      << "a fixed 32-bit value where a message is known";
}

TEST(MessageReading, ARepeatedNumberComesPackedOrSingle) {
  EXPECT_EQ(textOf(*readFrom<KCellularGsmCsRfMeasurement>("2a 02 01 02 28 03 2d 04 2a 00")),
            "[cs_tx_pwr: [-1, 1, -2, 2]]");
}

TEST(MessageReading, APackedFieldEndsAtItsLength) {
  const Reading<KCellularGsmCsRfMeasurement> reading("2a 02 01 82 03");
  EXPECT_FALSE(reading.success) << "the second number reaches past the field";
}

TEST(MessageReading, UnknownFieldsOfEveryWireTypeAreSkippedSilently) {
  // Fields 0, 99 (varint, fixed64, delimited, group, fixed32) and the gap 6 between known numbers.
  EXPECT_EQ(textOf(*readFrom<KCellularLteRrcState>("00 01 98 06 ff 01 99 06 01 02 03 04 05 06 07 08 9a 06 02 aa bb "
                                                   "9b 06 08 01 9c 06 9d 06 01 02 03 04 20 09")),
            "[prev_state_dur_ms: 9]");
  EXPECT_EQ(textOf(*readFrom<KCellularLteRsrpRsrqSinr>("10 01 20 02 30 03")), "[last_x_seconds: 3]");
}

TEST(MessageReading, AnUnknownFieldThatCannotBeSkippedFailsAtOnce) {
  for (const char* payload : {"9e 06 01", "9f 06 01", "9b 06 08 01", "9a 06 7f 00"}) {
    const Reading<KCellularLteRrcState> reading(std::string("08 05 ") + payload);
    EXPECT_FALSE(reading.success) << payload;
    EXPECT_EQ(textOf(reading.message), "[timestamp: 5]") << "fields already set stay set";
  }
}

TEST(MessageReading, ATruncatedNumberIsPresentAndZero) {
  const Reading<KCellularLteRrcState> reading("20 05 08 ff");
  EXPECT_FALSE(reading.success);
  EXPECT_TRUE(reading.message.hasTimestamp());
  EXPECT_EQ(reading.message.timestamp(), 0U);
  EXPECT_EQ(reading.message.prevStateDurMs(), 5U);
}

TEST(MessageReading, ATruncatedKeyFails) { EXPECT_FALSE(Reading<KCellularLteRrcState>("08 05 88").success); }

TEST(MessageReading, TruncatedBytesAreAbsent) {
  const Reading<ElementaryFile> reading("08 01 12 05 ca fe");
  EXPECT_FALSE(reading.success);
  EXPECT_FALSE(reading.message.hasContent());
}

TEST(MessageReading, ANestedMessageCannotReadBeyondItsLength) {
  const Reading<KCellularEmmContext> reading("32 03 08 01 10 02 10 03");
  EXPECT_FALSE(reading.success);
  EXPECT_EQ(reading.message.guti()->mmec(), 0U) << "the byte behind the nested message is not its own";
}

TEST(MessageReading, AFailureOfAListsElementEndsTheOuterRead) {
  // The second of three elements has an unknown field of wire type 6, which does not exist.
  const Reading<KCellularSimCardFiles> reading("12 02 08 01 12 02 9e 06 12 02 08 03");
  EXPECT_FALSE(reading.success);
  EXPECT_EQ(reading.message.efListsCount(), 2U);
}

TEST(MessageReading, AFailureOfANestedMessageEndsTheOuterRead) {
  const Reading<KCellularEmmContext> reading("08 01 32 02 9e 06 10 03");
  EXPECT_FALSE(reading.success);
  EXPECT_FALSE(reading.message.hasRegStatus());
}

TEST(MessageReading, ANestedMessageThatReachesPastTheEndIsNotMade) {
  const Reading<KCellularSimCardFiles> reading("12 7f 08 01");
  EXPECT_FALSE(reading.success);
  EXPECT_EQ(reading.message.efListsCount(), 0U);
}

TEST(MessageReading, ZeroLengthValuesArePresentAndEmpty) {
  EXPECT_EQ(textOf(*readFrom<BearerContext>("1a 00 2a 00")), "[apn: , pdp_addr: <>]");
  EXPECT_EQ(textOf(*readFrom<KCellularEmmContext>("2a 00 32 00")), "[tai_list: [[]], guti: []]");
}

TEST(MessageReading, TextIsTakenAsItsBytes) {
  EXPECT_EQ(*readFrom<BearerContext>("1a 02 ff 00")->apn(), std::string("\xFF\0", 2));
}

TEST(MessageReading, MillionsOfTinyElementsAreReadInProportion) {
  // Two bytes of payload per element, the worst case for a payload.
  constexpr std::size_t count = 200000;
  Bytes payload;
  for (std::size_t index = 0; index < count; ++index) payload.insert(payload.end(), {0x12, 0x00});
  bool decoded = false;
  EXPECT_EQ(KCellularSimCardFiles::initWithData(payload, &decoded)->efListsCount(), count);
  EXPECT_TRUE(decoded);
}

TEST(MessageReadingInitWithData, GivesTheDecodedMessage) {
  const Bytes payload = hex("10 03");
  bool decoded = false;
  EXPECT_EQ(textOf(*KCellularLteRrcState::initWithData(payload, &decoded)), "[state: KLTE_RRC_STATE_CONNECTED]");
  EXPECT_TRUE(decoded);
}

TEST(MessageReadingInitWithData, GivesAnEmptyMessageForWhatCannotBeDecoded) {
  const Bytes payload = hex("10 03 08 ff");
  bool decoded = true;
  const auto message = KCellularLteRrcState::initWithData(payload, &decoded);
  EXPECT_FALSE(decoded);
  EXPECT_TRUE(message->encoded().empty());
  EXPECT_EQ(message->timestamp(), 0U);
  EXPECT_FALSE(message->hasTimestamp());
  EXPECT_TRUE(KCellularLteRrcState::initWithData(payload)->encoded().empty()) << "the caller need not ask";
}

}  // namespace
}  // namespace vespscope::test
