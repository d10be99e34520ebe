// Sources made from a user's words.
#include <chrono>
#include <fstream>
#include <set>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "sources/MakeSource.h"
#include "support/SimCardFilesOf.h"
#include "support/TemporaryFolder.h"
#include "support/WrittenLog.h"

namespace vespscope::test {
namespace {

using namespace sources;
using namespace std::chrono_literals;
using testing::HasSubstr;

TEST(MakeSource, OfAScenarioGivesASimulatedOneWithASimCard) {
  const auto source = makeSource("scenario:seed=5");
  ASSERT_TRUE(source.ok()) << source.reason();
  EXPECT_THAT((*source)->label(), HasSubstr("5"));
  EXPECT_EQ((*source)->kind(), SourceKind::simulated);
  EXPECT_TRUE(simCardFilesOf(**source).has_value());
}

TEST(MakeSource, AScenarioThatStartsLaterStillPlaysThePresentTime) {
  const auto stream = makeStream(*SourceSpec::parse("scenario,start=60"));
  ASSERT_TRUE(stream.ok());
  const auto now = std::chrono::system_clock::now().time_since_epoch();
  const auto first = (*stream)->next();
  ASSERT_TRUE(first.has_value());
  EXPECT_GT(now - first->time, 50s);
  EXPECT_LT(now - first->time, 70s);
}

TEST(MakeSource, OfAFileThatIsNotThereNamesTheFile) {
  EXPECT_THAT(makeSource("replay:/no/such.pcap").reason(), HasSubstr("/no/such.pcap"));
  EXPECT_THAT(makeSource("diag:/no/such.mi2log,loop").reason(), HasSubstr("/no/such.mi2log"));
}

TEST(MakeSource, OfAFileOfAnotherKindIsRefused) {
  const TemporaryFolder folder;
  const std::string file = folder.write("notes.txt", "Dear diary, today the modem said nothing at all.");
  EXPECT_THAT(makeSource("replay:" + file).reason(), HasSubstr(file));
  EXPECT_THAT(makeSource("diag:" + file).reason(), HasSubstr(file));
}

TEST(MakeSource, OfALiveModemGivesALiveOneThatHasNotAskedYet) {
  const auto source = makeSource("modemmanager");
  ASSERT_TRUE(source.ok()) << source.reason();
  EXPECT_EQ((*source)->kind(), SourceKind::live);
  EXPECT_EQ((*source)->label(), "ModemManager, not asked yet");
  EXPECT_EQ(simCardFilesOf(**source), std::nullopt);
}

TEST(MakeSource, OfALogPortGivesALiveOneEvenWhileThePortIsAbsent) {
  for (const char* port : {"/dev/no-such-modem", "tcp:127.0.0.1:1"}) {
    auto source = makeSource(std::string("diag:") + port);
    ASSERT_TRUE(source) << source.reason();
    EXPECT_EQ((*source)->kind(), SourceKind::live);
    EXPECT_EQ((*source)->label(), std::string(port) + ": not opened yet");
  }
  EXPECT_EQ(makeSource("diag:tcp:modem:5000").reason(),
            "\"tcp:modem:5000\": a TCP port is tcp:ADDRESS:PORT, both numbers, such as tcp:127.0.0.1:5000");
}

TEST(MakeSource, NamesTheSimCardToShowFirstAndAStreamHoldsThatAlone) {
  const TemporaryFolder folder;
  const Bytes bytes = writtenLogOfTwoSims();
  const std::string log = "diag:" + folder.write("two.mi2log", std::string(bytes.begin(), bytes.end()));
  EXPECT_EQ((*makeSource(log))->simCard(), std::nullopt) << "no card has data bearers";
  EXPECT_EQ((*makeSource(log + ",sim=2"))->simCard(), 2);
  EXPECT_EQ((*makeSource("diag:/dev/no-such-modem,sim=1"))->simCard(), 1);
  EXPECT_EQ((*makeSource("scenario"))->simCard(), std::nullopt);
  const auto cardsIn = [](const std::string& words) {
    const auto stream = makeStream(*SourceSpec::parse(words));
    std::set<std::int32_t> cards;
    while (const auto event = (*stream)->next()) cards.insert(event->profileID);
    return cards;
  };
  EXPECT_EQ(cardsIn(log), (std::set<std::int32_t>{1, 2}));
  EXPECT_EQ(cardsIn(log + ",sim=2"), (std::set<std::int32_t>{2}));
}

TEST(MakeSource, ALiveModemIsNoStreamToPullFrom) {
  EXPECT_THAT(makeStream(*SourceSpec::parse("diag:/dev/ttyUSB0")).reason(), HasSubstr("live modem"));
  EXPECT_THAT(makeStream(*SourceSpec::parse("modemmanager")).reason(), HasSubstr("live modem"));
}

TEST(MakeSource, OfWordsThatMeanNothingIsRefused) {
  EXPECT_THAT(makeSource("radio").reason(), HasSubstr("a source is scenario"));
}

}  // namespace
}  // namespace vespscope::test
