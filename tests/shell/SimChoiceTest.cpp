// The choice of one SIM card among several: which one is shown, and what comes with a switch.
#include <chrono>
#include <memory>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "messages/mobility/KCellularActivatedBearerContexts.h"
#include "registry/MetricRows.h"
#include "shell/SimChoice.h"

namespace vespscope::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

constexpr std::int32_t rrcState = metricIdentifier("K_LTE_RRC_STATE");
constexpr std::int32_t servingCell = metricIdentifier("K_LTE_SCELL_INFO");

SimChoice::Event eventOf(std::int32_t card, std::int32_t metric = rrcState, Bytes payload = {}) {
  return std::make_shared<const Record>(
      Record{{"kKeyMetricID", metric}, {"kKeyPayload", std::move(payload)}, {"kKeyProfileID", card}});
}

SimChoice::Event bearersOf(std::int32_t card, int count = 1) {
  KCellularActivatedBearerContexts message;
  for (int index = 0; index < count; ++index) message.addBearerContexts(std::make_shared<BearerContext>());
  return eventOf(card, metricIdentifier("K_CELLULAR_ACTIVE_BEARER"), message.encoded());
}

class SimChoiceTest : public testing::Test {
 protected:
  SimChoice choiceOf(std::optional<std::int32_t> wanted = std::nullopt,
                     std::function<std::optional<std::int32_t>()> preferred = {}) {
    return SimChoice({[this] { passed_.emplace_back("forget"); },
                      [this](const SimChoice::Event& event) { passed_.push_back(nameOf(*event)); }},
                     wanted, std::move(preferred));
  }
  static void give(SimChoice& choice, const std::vector<SimChoice::Event>& events) {
    for (const SimChoice::Event& event : events) choice.take(event, {});
  }

  std::vector<std::string> passed_;  // "2 K_LTE_RRC_STATE"

 private:
  static std::string nameOf(const Record& event) {
    std::string metric = "unregistered";
    for (const MetricRow& row : metricRows) {
      if (row.identifier() == event.find("kKeyMetricID")->asInteger()) metric = row.identifierName;
    }
    return std::to_string(*event.find("kKeyProfileID")->asInteger()) + " " + metric;
  }
};

TEST_F(SimChoiceTest, ShowsTheFirstCardWhileNoneHasBearers) {
  SimChoice choice = choiceOf();
  give(choice, {eventOf(2), eventOf(1), bearersOf(1, 0), eventOf(2)});
  EXPECT_THAT(passed_, ElementsAre("2 K_LTE_RRC_STATE", "2 K_LTE_RRC_STATE"));
  EXPECT_EQ(choice.shown(), 2);
  EXPECT_THAT(choice.seen(), ElementsAre(1, 2));
}

TEST_F(SimChoiceTest, ChangesOnceToTheFirstCardWithBearers) {
  SimChoice choice = choiceOf();
  give(choice, {eventOf(2), eventOf(1, servingCell), eventOf(2), bearersOf(1), bearersOf(2), eventOf(2), eventOf(1)});
  EXPECT_THAT(passed_, ElementsAre("2 K_LTE_RRC_STATE", "2 K_LTE_RRC_STATE", "forget", "1 K_LTE_SCELL_INFO",
                                   "1 K_CELLULAR_ACTIVE_BEARER", "1 K_LTE_RRC_STATE"));
  EXPECT_EQ(choice.shown(), 1);
}

TEST_F(SimChoiceTest, StaysWithTheFirstCardWhenThatHasBearersFirst) {
  SimChoice choice = choiceOf();
  give(choice, {eventOf(1), bearersOf(1), bearersOf(2)});
  EXPECT_EQ(choice.shown(), 1);
}

TEST_F(SimChoiceTest, ShowsTheWantedCardWhateverHasBearers) {
  SimChoice choice = choiceOf(2, [] { return std::optional(1); });
  give(choice, {eventOf(1), bearersOf(1), eventOf(2)});
  EXPECT_THAT(passed_, ElementsAre("2 K_LTE_RRC_STATE"));
}

TEST_F(SimChoiceTest, ShowsTheCardThatTheSourcePrefers) {
  SimChoice choice = choiceOf(std::nullopt, [] { return std::optional(2); });
  give(choice, {eventOf(1), bearersOf(1), eventOf(2)});
  EXPECT_THAT(passed_, ElementsAre("2 K_LTE_RRC_STATE"));
}

TEST_F(SimChoiceTest, PassesEventsOfNoCard) {
  SimChoice choice = choiceOf(2);
  give(choice, {eventOf(0), eventOf(1), eventOf(0, 4711)});
  EXPECT_THAT(passed_, ElementsAre("0 K_LTE_RRC_STATE", "0 unregistered"));
  EXPECT_THAT(choice.seen(), ElementsAre(1));
}

TEST_F(SimChoiceTest, PassesTheLatestEventsOfTheOtherCardInTheirOrderAfterASwitch) {
  SimChoice choice = choiceOf();
  give(choice, {eventOf(1), eventOf(2), eventOf(2, servingCell), eventOf(0, metricIdentifier("K_SIM_FILE_INFO")),
                eventOf(2), eventOf(1)});
  passed_.clear();
  choice.showNext();
  EXPECT_THAT(passed_, ElementsAre("forget", "2 K_LTE_SCELL_INFO", "0 K_SIM_FILE_INFO", "2 K_LTE_RRC_STATE"));
  give(choice, {bearersOf(1), eventOf(2)});
  EXPECT_EQ(passed_.back(), "2 K_LTE_RRC_STATE") << "the user's choice stays";
  passed_.clear();
  choice.showNext();
  EXPECT_THAT(passed_, ElementsAre("forget", "0 K_SIM_FILE_INFO", "1 K_LTE_RRC_STATE", "1 K_CELLULAR_ACTIVE_BEARER"));
}

TEST_F(SimChoiceTest, StaysWhereItIsWithoutAnotherCard) {
  SimChoice none = choiceOf();
  none.showNext();
  give(none, {eventOf(0)});
  none.showNext();
  SimChoice one = choiceOf();
  give(one, {eventOf(1)});
  one.showNext();
  EXPECT_EQ(one.shown(), 1);
  EXPECT_THAT(passed_, ElementsAre("0 K_LTE_RRC_STATE", "1 K_LTE_RRC_STATE"));
}

TEST_F(SimChoiceTest, SwitchesFromAWantedCardThatNeverCame) {
  SimChoice choice = choiceOf(3);
  give(choice, {eventOf(1), eventOf(2)});
  EXPECT_THAT(passed_, IsEmpty());
  choice.showNext();
  EXPECT_EQ(choice.shown(), 1);
  EXPECT_THAT(passed_, ElementsAre("forget", "1 K_LTE_RRC_STATE"));
}

TEST_F(SimChoiceTest, KeepsFourCardsAndDropsMore) {
  SimChoice choice = choiceOf();
  for (std::int32_t card = 1; card <= 100; ++card) give(choice, {eventOf(card)});
  EXPECT_THAT(choice.seen(), ElementsAre(1, 2, 3, 4));
  EXPECT_THAT(passed_, ElementsAre("1 K_LTE_RRC_STATE"));
}

TEST_F(SimChoiceTest, KnowsWhenTheShownCardReportedLast) {
  using Time = SimChoice::Clock::time_point;
  const auto at = [](int seconds) { return Time(std::chrono::seconds(seconds)); };
  SimChoice choice = choiceOf();
  choice.take(eventOf(1), at(1));
  choice.take(eventOf(2), at(2));
  choice.take(eventOf(1), at(3));
  EXPECT_EQ(choice.arrivalOf(rrcState), at(3));
  EXPECT_EQ(choice.arrivalOf(servingCell), std::nullopt);
  EXPECT_EQ(choice.arrivalOf(4711), std::nullopt);
  choice.showNext();
  EXPECT_EQ(choice.arrivalOf(rrcState), at(2));
}

}  // namespace
}  // namespace vespscope::test
