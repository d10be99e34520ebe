// The events that each of the manager's clients gets, and their order.
#include "CoreTesting.h"

namespace vespscope::test {
namespace {

class Distribution : public CoreTesting {};

TEST_F(Distribution, DeliversWhatTheConfigurationNamesAndNothingElse) {
  const auto peer = listener(rrcStateOnly);
  control->deliver(rrcState, {0x10, 1});
  control->deliver(txPower, {0x10, 1});
  EXPECT_EQ(wakes, 2);  // delivery on, and one event
  EXPECT_THAT(taken(peer), ElementsAre(rrcState));
}

TEST_F(Distribution, AfterClearingThereIsSilence) {
  const auto peer = listener(everyChange);
  control->deliver(rrcState, {0x10, 1});
  EXPECT_EQ(ask(peer, rhox::kCommandClearConfiguration, applicationRequest()).status, 0);
  control->deliver(rrcState, {0x10, 2});
  control->deliver(txPower, {0x10, 2});
  EXPECT_THAT(taken(peer), IsEmpty());
}

TEST_F(Distribution, TwoApplicationsHaveTheirOwnConfigurations) {
  const auto viewer = listener(everyChange, 2);
  const auto recorder = listener(rrcStateOnly, 3);
  control->deliver(rrcState, {0x10, 1});
  control->deliver(txPower, {0x10, 1});
  EXPECT_THAT(taken(viewer), ElementsAre(rrcState, txPower));
  EXPECT_THAT(taken(recorder), ElementsAre(rrcState));
  EXPECT_EQ(ask(recorder, rhox::kCommandClearConfiguration, applicationRequest(3)).status, 0);
  control->deliver(rrcState, {0x10, 2});
  EXPECT_THAT(taken(viewer), ElementsAre(rrcState));
  EXPECT_THAT(taken(recorder), IsEmpty());
}

TEST_F(Distribution, ClientsOfOneApplicationShareItsConfiguration) {
  const auto first = listener(everyChange);
  const auto second = addPeer();
  core->setEvents(second, true);
  control->deliver(rrcState, {0x10, 1});
  EXPECT_THAT(taken(second), IsEmpty());  // it has not named an application
  EXPECT_EQ(ask(second, rhox::kCommandStatus, applicationRequest()).status, 0);
  EXPECT_THAT(taken(second), ElementsAre(rrcState));
  add(first, rrcStateOnly);
  control->deliver(txPower, {0x10, 1});
  control->deliver(rrcState, {0x10, 2});
  EXPECT_THAT(taken(first), ElementsAre(rrcState, rrcState));
  EXPECT_THAT(taken(second), ElementsAre(rrcState));
}

TEST_F(Distribution, AClientThatJoinsSeesTheCurrentValuesInTheOrderOfTheirTimes) {
  listener(everyChange);
  control->deliver(txPower, {0x10, 1}, 20ms);
  control->deliver(rrcState, {0x10, 1}, 10ms);
  control->deliver(txPower, {0x10, 2}, 30ms);
  const auto late = addPeer();
  ask(late, rhox::kCommandStatus, applicationRequest());
  core->setEvents(late, true);
  const auto first = core->take(late);
  const auto second = core->take(late);
  ASSERT_TRUE(first && second);
  EXPECT_EQ(first->event->metricID, rrcState);
  EXPECT_EQ(second->event->payload, (Bytes{0x10, 2}));
  EXPECT_FALSE(core->take(late).has_value());
}

TEST_F(Distribution, TurningDeliveryOffAndOnNeitherRepeatsNorLosesEvents) {
  const auto peer = listener(everyChange);
  control->deliver(rrcState, {0x10, 1});
  EXPECT_THAT(taken(peer), ElementsAre(rrcState));
  control->deliver(txPower, {0x10, 1});
  core->setEvents(peer, false);
  EXPECT_THAT(taken(peer), IsEmpty());
  control->deliver(rrcState, {0x10, 2});
  core->setEvents(peer, true);
  EXPECT_THAT(taken(peer), ElementsAre(txPower, rrcState));
}

TEST_F(Distribution, AClientThatDoesNotListenGetsNothing) {
  const auto peer = addPeer();
  add(peer, everyChange);
  listener(everyChange);
  control->deliver(rrcState, {0x10, 1});
  EXPECT_FALSE(core->take(peer).has_value());
}

TEST_F(Distribution, WhatWaitsForItsPeriodIsCollectedWhenThatEnds) {
  const auto peer = listener("[metrics]\nK_LTE_TX_POWER = { period_ms = 1000 }\n");
  EXPECT_EQ(core->collectDue(manager::ManagerCore::Clock::now()), std::nullopt);
  control->deliver(txPower, {0x10, 1}, 0ms);
  EXPECT_THAT(taken(peer), ElementsAre(txPower));
  const int before = wakes;
  control->deliver(txPower, {0x10, 2}, 100ms);
  EXPECT_EQ(wakes, before + 1);  // a wake-up time exists now
  control->deliver(txPower, {0x10, 3}, 200ms);
  const auto now = manager::ManagerCore::Clock::now();
  const auto due = core->collectDue(now);
  ASSERT_TRUE(due.has_value());
  EXPECT_GT(*due, now);
  EXPECT_LE(*due, now + 900ms);
  EXPECT_THAT(taken(peer), IsEmpty());
  EXPECT_EQ(core->collectDue(*due), std::nullopt);
  const auto last = core->take(peer);
  ASSERT_TRUE(last.has_value());
  EXPECT_EQ(last->event->payload, (Bytes{0x10, 3}));
}

TEST_F(Distribution, AClientThatIsGoneIsForgotten) {
  const auto peer = listener(everyChange);
  core->removePeer(peer);
  control->deliver(rrcState, {0x10, 1});
  EXPECT_EQ(core->collectDue(manager::ManagerCore::Clock::now()), std::nullopt);
}

TEST_F(Distribution, DeliversMetricsOfProfilesWithoutNumberAndRemembersSomeOfThem) {
  const auto peer = listener(rrcStateOnly);
  for (std::int32_t profile = 0; profile < 10'000; ++profile) {
    control->deliver(rrcState, {0x10, 1}, std::chrono::milliseconds(profile), profile);
    EXPECT_EQ(taken(peer).size(), 1U);
  }
  // A client that joins later gets the stored values.
  const auto late = listener(rrcStateOnly);
  EXPECT_EQ(taken(late).size(), 4096U);
}

}  // namespace
}  // namespace vespscope::test
