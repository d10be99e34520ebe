// Queries for the SIM card files: answered at once, after a search, or rejected.
#include "CoreTesting.h"

namespace vespscope::test {
namespace {

class SimCardFileQueries : public CoreTesting {};

TEST_F(SimCardFileQueries, TheSimCardFilesGoToTheClientThatAskedAlone) {
  control->simCardFiles = MetricEvent{simCardFiles, 0, {0x08, 0x01}, 5ms};
  const auto asking = listener(rrcStateOnly);
  const auto other = listener(rrcStateOnly);
  EXPECT_EQ(ask(asking, rhox::kCommandQueryMetric, queryRequest()).status, 0);
  const auto answer = core->take(asking);
  ASSERT_TRUE(answer.has_value());
  EXPECT_EQ(answer->sequence, 1U);
  EXPECT_EQ(answer->event->metricID, 3932179);
  EXPECT_EQ(answer->event->payload, (Bytes{0x08, 0x01}));
  EXPECT_FALSE(core->take(asking).has_value());
  EXPECT_THAT(taken(other), IsEmpty());
}

TEST_F(SimCardFileQueries, EveryQueryIsAnsweredAlsoTheSameAgain) {
  control->simCardFiles = MetricEvent{simCardFiles, 0, {0x08, 0x01}, 5ms};
  const auto peer = listener(rrcStateOnly);
  EXPECT_EQ(ask(peer, rhox::kCommandQueryMetric, queryRequest()).status, 0);
  EXPECT_EQ(ask(peer, rhox::kCommandQueryMetric, queryRequest()).status, 0);
  EXPECT_THAT(taken(peer), ElementsAre(simCardFiles, simCardFiles));
}

TEST_F(SimCardFileQueries, AQueryWhoseAnswerIsStillSearchedForIsAcceptedAndTheFilesFollow) {
  control->searches = true;
  const auto asking = listener(rrcStateOnly);
  const auto leaving = addPeer();
  ask(leaving, rhox::kCommandAddConfiguration, addRequest(rrcStateOnly));
  core->setEvents(leaving, true);
  EXPECT_EQ(ask(asking, rhox::kCommandQueryMetric, queryRequest()).status, 0);
  EXPECT_EQ(ask(leaving, rhox::kCommandQueryMetric, queryRequest()).status, 0);
  EXPECT_FALSE(core->take(asking).has_value());
  core->removePeer(leaving);
  ASSERT_EQ(control->waiting.size(), 2U);
  for (const auto& found : control->waiting) found(MetricEvent{simCardFiles, 0, {0x08, 0x01}, 5ms});
  EXPECT_THAT(taken(asking), ElementsAre(simCardFiles));
}

TEST_F(SimCardFileQueries, FilesThatAreFoundForAnotherApplicationAreNotDelivered) {
  control->searches = true;
  const auto peer = listener(rrcStateOnly);
  EXPECT_EQ(ask(peer, rhox::kCommandQueryMetric, queryRequest()).status, 0);
  EXPECT_EQ(ask(peer, rhox::kCommandStatus, applicationRequest(7)).status, 0);
  control->waiting.at(0)(MetricEvent{simCardFiles, 0, {0x08, 0x01}, 5ms});
  EXPECT_THAT(taken(peer), IsEmpty());
}

TEST_F(SimCardFileQueries, QueriesThatWaitForASearchAreLimited) {
  control->searches = true;
  const auto peer = listener(rrcStateOnly);
  for (int query = 0; query < 64; ++query) EXPECT_EQ(ask(peer, rhox::kCommandQueryMetric, queryRequest()).status, 0);
  const Reply reply = ask(peer, rhox::kCommandQueryMetric, queryRequest());
  EXPECT_EQ(reply.status, static_cast<std::int32_t>(manager::CommandStatus::tooManyQueries));
  EXPECT_EQ(reply.message, "too many pending SIM card file queries: 64");
  ASSERT_EQ(control->waiting.size(), 64U);
  for (const auto& found : control->waiting) found(MetricEvent{simCardFiles, 0, {0x08, 0x01}, 5ms});
  EXPECT_EQ(taken(peer).size(), 64U);
  EXPECT_EQ(ask(peer, rhox::kCommandQueryMetric, queryRequest()).status, 0);
}

TEST_F(SimCardFileQueries, ASearchThatFindsNothingIsLogged) {
  const LoggedLines lines;
  control->searches = true;
  const auto peer = listener(rrcStateOnly);
  EXPECT_EQ(ask(peer, rhox::kCommandQueryMetric, queryRequest()).status, 0);
  control->waiting.at(0)(std::nullopt);
  EXPECT_THAT(taken(peer), IsEmpty());
  EXPECT_THAT(lines.all(), ElementsAre("the source has no SIM card files: scripted"));
}

TEST_F(SimCardFileQueries, QueriesThatCannotBeAnsweredAreRefusedWithAMessage) {
  const auto peer = listener(rrcStateOnly);
  Reply reply = ask(peer, rhox::kCommandQueryMetric, queryRequest());
  EXPECT_EQ(reply.status, static_cast<std::int32_t>(manager::CommandStatus::noSimCardFiles));
  EXPECT_EQ(reply.message, "the source has no SIM card files: scripted");

  control->simCardFiles = MetricEvent{simCardFiles, 0, {}, 0ms};
  Dictionary otherProfile = queryRequest();
  otherProfile.set(rhox::kKeyProfileID, integer(1));
  reply = ask(peer, rhox::kCommandQueryMetric, otherProfile);
  EXPECT_EQ(reply.status, static_cast<std::int32_t>(manager::CommandStatus::noSimCardFiles));
  EXPECT_EQ(reply.message, "the source has no SIM card files: profile 1");

  Dictionary otherTrigger = queryRequest();
  otherTrigger.set(rhox::kKeyTriggerID, integer(0x7F0014));
  reply = ask(peer, rhox::kCommandQueryMetric, otherTrigger);
  EXPECT_EQ(reply.status, static_cast<std::int32_t>(manager::CommandStatus::unknownTrigger));
  EXPECT_EQ(reply.message, "nothing answers this trigger: 8323092");

  core->setEvents(peer, false);
  reply = ask(peer, rhox::kCommandQueryMetric, queryRequest());
  EXPECT_EQ(reply.status, static_cast<std::int32_t>(manager::CommandStatus::deliveryOff));
  EXPECT_EQ(reply.message, "delivery of events is off, so the answer cannot be delivered");
  core->setEvents(peer, true);
  EXPECT_THAT(taken(peer), IsEmpty());
}

}  // namespace
}  // namespace vespscope::test
