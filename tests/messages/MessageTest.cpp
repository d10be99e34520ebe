// Presence, getters, text, equality, hash, copy and merge of messages.
#include <memory>
#include <regex>

#include <gtest/gtest.h>

#include "messages/Message.h"
#include "messages/MessageClasses.h"
#include "messages/MessageTesting.h"
#include "messages/gsm/GsmNcellMeas.h"
#include "messages/gsm/KCellularGsmCsRfMeasurement.h"
#include "messages/gsm/KCellularGsmScellInfo.h"
#include "messages/lte/EgwErrcNbrGeranMeas.h"
#include "messages/lte/Guti.h"
#include "messages/lte/KCellularEmmContext.h"
#include "messages/lte/KCellularLteRrcState.h"
#include "messages/lte/KCellularLteServingCellMeasurement.h"
#include "messages/mobility/BearerContext.h"
#include "messages/mobility/KCellularMmContext.h"
#include "messages/umts/GsmCellMeasResult.h"
#include "messages/umts/KCellularWcdmaTxPower.h"

namespace vespscope::test {
namespace {

std::shared_ptr<Guti> guti(std::uint32_t mmec) {
  auto result = std::make_shared<Guti>();
  result->setMmec(mmec);
  return result;
}

std::shared_ptr<RxInfo> rxInfo(std::int32_t rssi) {
  auto result = std::make_shared<RxInfo>();
  result->setRssi(rssi);
  return result;
}

TEST(MessagePresence, ANumberKeepsItsValueWhenItsPresenceIsTakenAway) {
  KCellularLteRrcState message;
  message.setTimestamp(1700000000000);
  message.setHasTimestamp(false);
  EXPECT_EQ(message.timestamp(), 1700000000000U);
  EXPECT_FALSE(message.hasTimestamp());
  EXPECT_TRUE(message.encoded().empty());
  message.setHasTimestamp(true);
  EXPECT_EQ(textOf(message), "[timestamp: 1700000000000]");
}

TEST(MessagePresence, AnEnumerationReadsAsItsFirstValueWithoutPresence) {
  KCellularLteRrcState message;
  message.setState(3);
  message.setHasState(false);
  EXPECT_EQ(message.state(), 0);
  message.setHasState(true);
  EXPECT_EQ(message.state(), 3) << "the stored number is kept";
}

TEST(MessagePresence, TheTwoEnumerationsThatStartAtOneReadAsOne) {
  KCellularMmContext context;
  EXPECT_EQ(context.updateStatus(), 1);
  context.setUpdateStatus(3);
  context.setHasUpdateStatus(false);
  EXPECT_EQ(context.updateStatus(), 1);
  EXPECT_EQ(KCellularGsmScellInfo().state(), 1);
  EXPECT_EQ(KCellularGsmScellInfo().gsmBand(), 0);
}

TEST(MessagePresence, AnEnumerationSetToPresentWithoutAValueHoldsZero) {
  KCellularMmContext context;
  context.setHasUpdateStatus(true);
  EXPECT_EQ(context.updateStatus(), 0);
  EXPECT_EQ(textOf(context), "[update_status: (unknown: 0)]");
}

TEST(MessagePresence, NumbersThatWereNeverSetReadZero) {
  const KCellularMmContext context;
  EXPECT_EQ(context.timestamp(), 0U);
  EXPECT_EQ(context.tmsi(), 0U);
  EXPECT_FALSE(context.isCombinedProc());
}

TEST(MessagePresence, AZeroThatWasSetIsPresentAndWritten) {
  KCellularMmContext context;
  context.setTmsi(0);
  context.setIsCombinedProc(false);
  EXPECT_EQ(context.encoded(), hex("28 00 48 00"));
  EXPECT_EQ(textOf(context), "[tmsi: 0, is_combined_proc: 0]");
}

TEST(MessagePresence, AMessageObjectIsPresentUnlessNull) {
  KCellularEmmContext context;
  EXPECT_EQ(context.guti(), nullptr);
  context.setGuti(guti(1));
  EXPECT_TRUE(context.hasGuti());
  context.setGuti(nullptr);
  EXPECT_FALSE(context.hasGuti());
}

TEST(MessageEnumerationNames, AreFoundThroughTheirScope) {
  EXPECT_EQ(KCellularMmContext::UpdateStatus::nameOf(2), "STATUS_NOT_UPDATED");
  EXPECT_EQ(KCellularMmContext::UpdateStatus::nameOf(0), std::nullopt);
  KCellularMmContext context;
  context.setUpdateStatus(KCellularMmContext::UpdateStatus::STATUS_ROAMING_NOT_ALLOWED);
  EXPECT_EQ(context.updateStatus(), 3);
}

TEST(MessageDescription, IsClassIdentityAndDictionary) {
  KCellularLteRrcState message;
  message.setState(3);
  message.setPrevStateDurMs(40);
  EXPECT_TRUE(std::regex_match(message.description(),
                               std::regex(R"(<KCellularLteRrcState: 0x[0-9a-f]+> \[state: KLTE_RRC_STATE_CONNECTED, )"
                                          R"(prev_state_dur_ms: 40\])")))
      << message.description();
  EXPECT_EQ(message.messageClass(), "KCellularLteRrcState");
}

TEST(MessageDictionary, NumbersKeepTheirWidthAndSign) {
  EXPECT_TRUE(std::holds_alternative<std::uint64_t>(
      readFrom<KCellularLteRrcState>("08 01")->dictionaryRepresentation().at(0).value.data()));
  EXPECT_TRUE(std::holds_alternative<std::uint32_t>(
      readFrom<KCellularLteRrcState>("20 01")->dictionaryRepresentation().at(0).value.data()));
  EXPECT_TRUE(std::holds_alternative<std::int32_t>(rxInfo(1)->dictionaryRepresentation().at(0).value.data()));
  const Record list = readFrom<KCellularGsmCsRfMeasurement>("28 01")->dictionaryRepresentation();
  EXPECT_TRUE(std::holds_alternative<std::int32_t>(list.at(0).value.asList()->at(0).data()));
}

TEST(MessageDictionary, AnEnumerationIsATextAlways) {
  for (const char* digits : {"10 00", "10 63", "10 ff ff ff ff ff ff ff ff ff 01"}) {
    EXPECT_NE(readFrom<KCellularLteRrcState>(digits)->dictionaryRepresentation().find("state")->asText(), nullptr);
  }
  EXPECT_EQ(textOf(*readFrom<KCellularLteRrcState>("10 63")), "[state: (unknown: 99)]");
  EXPECT_EQ(textOf(*readFrom<KCellularLteRrcState>("10 ff ff ff ff ff ff ff ff ff 01")), "[state: (unknown: -1)]");
}

TEST(Message, WithNothingSetHasAnEmptyDictionaryAndHashZero) {
  for (const MessageClass& messageClass : messageClasses()) {
    const auto message = messageClass.make();
    EXPECT_EQ(message->messageClass(), messageClass.name);
    EXPECT_TRUE(message->dictionaryRepresentation().empty());
    EXPECT_TRUE(message->encoded().empty());
    EXPECT_EQ(message->hash(), 0U);
  }
}

TEST(Message, AnIndexBeyondARepeatedMessageRaisesTheRangeException) {
  KCellularLteServingCellMeasurement message;
  message.addRxInfo(rxInfo(-50));
  EXPECT_EQ(message.rxInfoAtIndex(0)->rssi(), -50);
  EXPECT_THROW(static_cast<void>(message.rxInfoAtIndex(1)), RangeException);
  try {
    static_cast<void>(message.rxInfoAtIndex(1));
  } catch (const std::out_of_range& error) {
    EXPECT_STREQ(error.what(), "idx (1) is out of range (1)");
  }
}

TEST(Message, ReplacingNumbersFromTheirOwnBufferIsSafe) {
  KCellularGsmCsRfMeasurement message;
  for (std::int32_t value = 0; value < 10; ++value) message.addCsTxPwr(value);
  message.setCsTxPwrs(message.csTxPwrs().data() + 7, 3);
  EXPECT_EQ(message.dictionaryRepresentation().at(0).value, Value(List{7, 8, 9}));
  message.setCsTxPwrs(nullptr, 0);
  EXPECT_EQ(message.csTxPwrsCount(), 0U);
}

TEST(MessageDeathTest, AnAbsentElementStopsTheProcess) {
  KCellularLteServingCellMeasurement message;
  EXPECT_DEATH(message.addRxInfo(nullptr), "an absent message was added to a repeated field");
}

TEST(MessageDeathTest, MergingOrCopyingBetweenClassesStopsTheProcess) {
  KCellularLteRrcState state;
  Guti other;
  WireMessage& message = state;
  EXPECT_DEATH(message.mergeFrom(static_cast<const WireMessage&>(other)), "KCellularLteRrcState .* Guti");
  EXPECT_DEATH(message.copyTo(static_cast<WireMessage&>(other)), "KCellularLteRrcState .* Guti");
}

TEST(MessageEquality, NeedsExactlyTheSameClass) {
  EgwErrcNbrGeranMeas lte;
  GsmCellMeasResult umts;
  lte.setArfcn(20);
  umts.setArfcn(20);
  EXPECT_EQ(lte.encoded(), umts.encoded());
  EXPECT_EQ(lte.hash(), umts.hash());
  EXPECT_FALSE(lte.isEqual(umts));
  EXPECT_FALSE(umts.isEqual(lte));
  EXPECT_FALSE(EgwErrcNbrGeranMeas().isEqual(GsmCellMeasResult()));
}

TEST(MessageEquality, AListThatWasEmptiedDiffersFromOneThatNeverWas) {
  KCellularLteServingCellMeasurement emptied;
  emptied.addRxInfo(rxInfo(1));
  emptied.clearRxInfos();
  KCellularLteServingCellMeasurement untouched;
  EXPECT_EQ(emptied.encoded(), untouched.encoded());
  EXPECT_FALSE(emptied == untouched);
  EXPECT_FALSE(untouched == emptied);
  KCellularLteServingCellMeasurement alsoEmptied;
  alsoEmptied.addRxInfo(rxInfo(2));
  alsoEmptied.clearRxInfos();
  EXPECT_TRUE(emptied == alsoEmptied);
}

TEST(MessageEquality, ClearingAListThatNeverWasDoesNotMakeIt) {
  KCellularLteServingCellMeasurement cleared;
  cleared.clearRxInfos();
  EXPECT_TRUE(cleared == KCellularLteServingCellMeasurement());
}

TEST(MessageEquality, AListOfNumbersThatWasEmptiedIsAsIfItNeverWas) {
  KCellularGsmCsRfMeasurement emptied;
  emptied.addCsTxPwr(1);
  emptied.clearCsTxPwrs();
  EXPECT_TRUE(emptied == KCellularGsmCsRfMeasurement());
}

TEST(MessageEquality, PresenceCountsAndHiddenValuesDoNot) {
  KCellularLteRrcState zero;
  zero.setTimestamp(0);
  KCellularLteRrcState hidden;
  hidden.setTimestamp(5);
  hidden.setHasTimestamp(false);
  EXPECT_FALSE(zero == KCellularLteRrcState());
  EXPECT_TRUE(hidden == KCellularLteRrcState());
}

TEST(MessageEquality, GoesThroughEveryKindOfField) {
  const char* const first = "08 01 1a 01 61 20 02 2a 01 07";
  EXPECT_TRUE(*readFrom<BearerContext>("1a 01 61 2a 01 07") == *readFrom<BearerContext>("2a 01 07 1a 01 61"));
  EXPECT_FALSE(*readFrom<BearerContext>("1a 01 61") == *readFrom<BearerContext>("1a 01 62"));
  EXPECT_FALSE(*readFrom<BearerContext>("2a 00") == *readFrom<BearerContext>(""));
  EXPECT_FALSE(*readFrom<BearerContext>("") == *readFrom<BearerContext>("2a 00"));
  EXPECT_FALSE(*readFrom<KCellularEmmContext>("32 02 08 01") == *readFrom<KCellularEmmContext>("32 02 08 02"));
  EXPECT_FALSE(*readFrom<KCellularEmmContext>("32 00") == *readFrom<KCellularEmmContext>(""));
  EXPECT_FALSE(*readFrom<KCellularGsmCsRfMeasurement>("28 01") ==
               *readFrom<KCellularGsmCsRfMeasurement>("28 01 28 01"));
  EXPECT_FALSE(*readFrom<KCellularLteServingCellMeasurement>("1a 02 08 01") ==
               *readFrom<KCellularLteServingCellMeasurement>("1a 02 08 01 1a 02 08 01"));
  EXPECT_TRUE(*readFrom<BearerContext>(first) == *readFrom<BearerContext>(first));
}

TEST(MessageHash, OfAPresentNumberIsTheNumberTimesTheMultiplier) {
  EXPECT_EQ(readFrom<KCellularLteRrcState>("08 01")->hash(), 2654435761U);
  EXPECT_EQ(readFrom<KCellularLteRrcState>("08 02")->hash(), 5308871522U);
  EXPECT_EQ(rxInfo(-1)->hash(), 18446744071055115855U) << "sign-extended: 2^64 - 2654435761";
  EXPECT_EQ(readFrom<KCellularLteRrcState>("20 ff ff ff ff 0f")->hash(), 11400714780173436495U)
      << "4294967295 is not extended";
  EXPECT_EQ(readFrom<KCellularLteServingCellMeasurement>("10 01")->hash(), 2654435761U);
  EXPECT_EQ(readFrom<KCellularLteServingCellMeasurement>("10 00")->hash(), 0U);
}

TEST(MessageHash, IsTheXorOverTheFields) {
  EXPECT_EQ(readFrom<KCellularLteRrcState>("08 01 20 02")->hash(), 2654435761U ^ 5308871522U);
  EXPECT_EQ(readFrom<KCellularLteRrcState>("08 03 20 03")->hash(), 0U) << "equal values cancel";
  EXPECT_EQ(readFrom<KCellularEmmContext>("32 02 08 01")->hash(), 2654435761U) << "an embedded message's own hash";
}

TEST(MessageHash, OfAHiddenValueIsZero) {
  KCellularLteRrcState message;
  message.setTimestamp(5);
  message.setHasTimestamp(false);
  EXPECT_EQ(message.hash(), 0U);
}

TEST(MessageHash, DependsOnTheContentOfBytesTextsAndLists) {
  EXPECT_EQ(readFrom<BearerContext>("1a 01 61")->hash(), readFrom<BearerContext>("1a 01 61")->hash());
  EXPECT_NE(readFrom<BearerContext>("1a 01 61")->hash(), readFrom<BearerContext>("1a 01 62")->hash());
  EXPECT_NE(readFrom<BearerContext>("2a 01 61")->hash(), readFrom<BearerContext>("2a 02 61 00")->hash());
  EXPECT_NE(readFrom<KCellularGsmCsRfMeasurement>("28 01 28 02")->hash(),
            readFrom<KCellularGsmCsRfMeasurement>("28 02 28 01")->hash());
  EXPECT_NE(readFrom<KCellularLteServingCellMeasurement>("1a 02 08 01 1a 02 08 02")->hash(),
            readFrom<KCellularLteServingCellMeasurement>("1a 02 08 02 1a 02 08 01")->hash());
}

// A message with every kind of object field.
std::shared_ptr<KCellularEmmContext> sample() {
  return readFrom<KCellularEmmContext>("08 07 10 02 2a 05 0a 03 13 00 14 2a 02 10 09 32 02 10 01");
}

TEST(MessageCopyWithZone, IsEqualAndSharesNothing) {
  const auto original = sample();
  const auto copy = original->copyWithZone();
  EXPECT_TRUE(*copy == *original);
  EXPECT_EQ(copy->encoded(), original->encoded());
  EXPECT_NE(copy->guti(), original->guti());
  EXPECT_NE(copy->taiListAtIndex(0), original->taiListAtIndex(0));
  EXPECT_NE(copy->taiListAtIndex(0)->encodedPlmn(), original->taiListAtIndex(0)->encodedPlmn());
  copy->guti()->setMmec(99);
  copy->taiListAtIndex(1)->setTac(99);
  EXPECT_EQ(original->guti()->mmec(), 1U);
  EXPECT_EQ(original->taiListAtIndex(1)->tac(), 9U);
}

TEST(MessageCopyWithZone, LeavesHiddenValuesAndEmptiedListsBehind) {
  KCellularLteServingCellMeasurement original;
  original.setTimestamp(5);
  original.setHasTimestamp(false);
  original.addRxInfo(rxInfo(1));
  original.clearRxInfos();
  const auto copy = original.copyWithZone();
  EXPECT_EQ(copy->timestamp(), 0U);
  EXPECT_TRUE(*copy == KCellularLteServingCellMeasurement());
  EXPECT_FALSE(*copy == original);
}

TEST(MessageCopyTo, SharesTheSameObjects) {
  const auto original = sample();
  KCellularEmmContext target;
  original->copyTo(target);
  EXPECT_TRUE(target == *original);
  EXPECT_EQ(target.guti(), original->guti());
  EXPECT_EQ(target.taiListAtIndex(0), original->taiListAtIndex(0));
  const auto bearer = readFrom<BearerContext>("1a 01 61 2a 01 07");
  BearerContext other;
  bearer->copyTo(other);
  EXPECT_EQ(other.apn(), bearer->apn());
  EXPECT_EQ(other.pdpAddr(), bearer->pdpAddr());
}

TEST(MessageCopyTo, ReplacesListsOnlyWhenTheSourceHasElements) {
  KCellularLteServingCellMeasurement target;
  target.setIsConnectedMode(true);
  target.addRxInfo(rxInfo(1));
  target.addRxInfo(rxInfo(2));
  KCellularLteServingCellMeasurement().copyTo(target);
  EXPECT_EQ(textOf(target), "[is_connected_mode: 1, rx_info: [[rssi: 1], [rssi: 2]]]")
      << "absent fields change nothing";
  KCellularLteServingCellMeasurement source;
  source.addRxInfo(rxInfo(3));
  source.copyTo(target);
  EXPECT_EQ(textOf(target), "[is_connected_mode: 1, rx_info: [[rssi: 3]]]");
}

TEST(MessageCopyTo, ReplacesNumbersListsOnlyWhenTheSourceHasSome) {
  const auto target = readFrom<KCellularGsmCsRfMeasurement>("28 02 28 04");
  KCellularGsmCsRfMeasurement().copyTo(*target);
  EXPECT_EQ(textOf(*target), "[cs_tx_pwr: [1, 2]]");
  readFrom<KCellularGsmCsRfMeasurement>("28 06")->copyTo(*target);
  EXPECT_EQ(textOf(*target), "[cs_tx_pwr: [3]]");
}

TEST(MessageCopyTo, IntoItselfChangesNothing) {
  const auto message = sample();
  const Bytes before = message->encoded();
  message->copyTo(*message);
  EXPECT_EQ(message->encoded(), before);
}

TEST(MessageMergeFrom, PresentNumbersBytesAndTextsReplace) {
  const auto target = readFrom<BearerContext>("08 01 10 02 1a 01 61 2a 01 07");
  target->mergeFrom(*readFrom<BearerContext>("10 05 1a 01 62"));
  EXPECT_EQ(textOf(*target), "[cid: 1, nsapi: 5, apn: b, pdp_addr: <07>]");
}

TEST(MessageMergeFrom, AnEmbeddedMessageIsMergedIntoThePresentOne) {
  const auto target = readFrom<KCellularEmmContext>("32 02 08 01");
  const auto present = target->guti();
  const auto source = readFrom<KCellularEmmContext>("32 02 10 02");
  target->mergeFrom(*source);
  EXPECT_EQ(target->guti(), present);
  EXPECT_EQ(textOf(*target), "[guti: [mmegi: 1, mmec: 2]]");
  EXPECT_EQ(textOf(*source), "[guti: [mmec: 2]]");
}

TEST(MessageMergeFrom, AnEmbeddedMessageThatIsAbsentBecomesTheSameObject) {
  KCellularEmmContext target;
  const auto source = readFrom<KCellularEmmContext>("32 02 10 02");
  target.mergeFrom(*source);
  EXPECT_EQ(target.guti(), source->guti());
}

TEST(MessageMergeFrom, ListsGrow) {
  const auto target = readFrom<KCellularLteServingCellMeasurement>("1a 02 08 02");
  const auto source = readFrom<KCellularLteServingCellMeasurement>("1a 02 08 04");
  target->mergeFrom(*source);
  EXPECT_EQ(textOf(*target), "[rx_info: [[rssi: 1], [rssi: 2]]]");
  EXPECT_EQ(target->rxInfoAtIndex(1), source->rxInfoAtIndex(0)) << "the same objects";
  const auto numbers = readFrom<KCellularGsmCsRfMeasurement>("28 02");
  numbers->mergeFrom(*readFrom<KCellularGsmCsRfMeasurement>("28 04 28 06"));
  EXPECT_EQ(textOf(*numbers), "[cs_tx_pwr: [1, 2, 3]]");
}

TEST(MessageMergeFrom, ItselfDoublesTheListsAndEnds) {
  const auto message = readFrom<KCellularGsmCsRfMeasurement>("08 05 28 02 28 04");
  message->mergeFrom(*message);
  EXPECT_EQ(textOf(*message), "[timestamp: 5, cs_tx_pwr: [1, 2, 1, 2]]");
}

}  // namespace
}  // namespace vespscope::test
