// The events of a stream that are due to one client.
#include <chrono>
#include <memory>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "manager/Configuration.h"
#include "manager/DeliveryFilter.h"
#include "manager/DeliveryQueue.h"
#include "manager/Payload.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::IsEmpty;

constexpr std::int32_t rrcState = 3952132;     // on change
constexpr std::int32_t txPower = 3986178;      // every second
constexpr std::int32_t measurement = 3986177;  // every 300 ms
constexpr std::int32_t failure = 3952165;      // every event
constexpr std::int32_t unnamed = 3952152;

using manager::Configuration;
using manager::SharedEvent;

class DeliveryFilter : public testing::Test {
 protected:
  DeliveryFilter() { filter.setConfiguration(configuration("[metrics]\n" + rules)); }

  static std::shared_ptr<const Configuration> configuration(const std::string& toml) {
    return std::make_shared<const Configuration>(*Configuration::parse(toml));
  }

  static SharedEvent event(std::int32_t metric, std::chrono::milliseconds time, Bytes payload = {0x10, 0x01},
                           std::int32_t profile = 0) {
    return std::make_shared<const MetricEvent>(MetricEvent{metric, profile, std::move(payload), time});
  }

  // The times, in ms, of the events due after offering one; the clock is at the event's own time.
  std::vector<std::int64_t> offer(const SharedEvent& offered) {
    std::vector<SharedEvent> due;
    filter.offer(offered, start + offered->time, due);
    return timesOf(due);
  }
  std::vector<std::int64_t> collect(std::chrono::milliseconds time) {
    std::vector<SharedEvent> due;
    filter.collect(start + time, due);
    return timesOf(due);
  }
  static std::vector<std::int64_t> timesOf(const std::vector<SharedEvent>& events) {
    std::vector<std::int64_t> times;
    for (const SharedEvent& event : events) times.push_back(event->time / 1ms);
    return times;
  }

  const std::string rules =
      "K_LTE_RRC_STATE = { on = \"change\" }\nK_LTE_TX_POWER = { period_ms = 1000 }\n"
      "K_LTE_SCELL_MEAS = { period_ms = 300 }\nK_LTE_RLF = { on = \"event\" }\n";
  manager::DeliveryFilter::Clock::time_point start{};
  manager::DeliveryFilter filter;
};

TEST_F(DeliveryFilter, WithoutAConfigurationNothingPasses) {
  filter.setConfiguration(nullptr);
  EXPECT_THAT(offer(event(rrcState, 0ms)), IsEmpty());
  EXPECT_THAT(offer(event(txPower, 0ms)), IsEmpty());
}

TEST_F(DeliveryFilter, AMetricThatIsNotNamedDoesNotPass) { EXPECT_THAT(offer(event(unnamed, 0ms)), IsEmpty()); }

TEST_F(DeliveryFilter, OnChangeAnEqualPayloadPassesOnce) {
  EXPECT_THAT(offer(event(rrcState, 0ms, {0x08, 0x01, 0x10, 0x02})), ElementsAre(0));
  EXPECT_THAT(offer(event(rrcState, 10ms, {0x08, 0x09, 0x10, 0x02})), IsEmpty());  // another timestamp
  EXPECT_THAT(offer(event(rrcState, 20ms, {0x08, 0x09, 0x10, 0x03})), ElementsAre(20));
  EXPECT_THAT(offer(event(rrcState, 30ms, {0x08, 0x0A, 0x10, 0x02})), ElementsAre(30));
}

TEST_F(DeliveryFilter, OnEventEachPassesAlsoTheSameAgainAtTheSameTime) {
  EXPECT_THAT(offer(event(failure, 5ms)), ElementsAre(5));
  EXPECT_THAT(offer(event(failure, 5ms)), ElementsAre(5));
  EXPECT_THAT(offer(event(failure, 0ms)), ElementsAre(0));
  const SharedEvent once = event(failure, 9ms);
  EXPECT_THAT(offer(once), ElementsAre(9));
  EXPECT_THAT(offer(once), IsEmpty());  // the same event object that was delivered
}

TEST_F(DeliveryFilter, TheProfilesOfAMetricAreApart) {
  EXPECT_THAT(offer(event(rrcState, 0ms, {0x10, 0x02}, 0)), ElementsAre(0));
  EXPECT_THAT(offer(event(rrcState, 1ms, {0x10, 0x02}, 1)), ElementsAre(1));
  EXPECT_THAT(offer(event(txPower, 2ms, {0x10, 0x02}, 0)), ElementsAre(2));
  EXPECT_THAT(offer(event(txPower, 3ms, {0x10, 0x02}, 1)), ElementsAre(3));
}

TEST_F(DeliveryFilter, WithinAPeriodTheNewestWaitsAndPassesWhenALaterEventComes) {
  EXPECT_THAT(offer(event(txPower, 0ms)), ElementsAre(0));
  EXPECT_THAT(offer(event(txPower, 400ms)), IsEmpty());
  EXPECT_THAT(offer(event(txPower, 900ms)), IsEmpty());
  EXPECT_THAT(offer(event(txPower, 1500ms)), ElementsAre(900));
  EXPECT_THAT(offer(event(txPower, 1999ms)), IsEmpty());
  EXPECT_THAT(offer(event(txPower, 2000ms)), ElementsAre(1999));
  EXPECT_THAT(collect(3000ms), ElementsAre(2000));
}

TEST_F(DeliveryFilter, AnEventOfAnotherMetricEndsThePeriodToo) {
  EXPECT_THAT(offer(event(txPower, 0ms)), ElementsAre(0));
  EXPECT_THAT(offer(event(txPower, 400ms)), IsEmpty());
  EXPECT_THAT(offer(event(unnamed, 999ms)), IsEmpty());
  EXPECT_THAT(offer(event(unnamed, 1000ms)), ElementsAre(400));
}

TEST_F(DeliveryFilter, WhatWaitsPassesInTheOrderInWhichItsPeriodsEnd) {
  EXPECT_THAT(offer(event(txPower, 0ms)), ElementsAre(0));
  EXPECT_THAT(offer(event(txPower, 10ms)), IsEmpty());
  EXPECT_THAT(offer(event(measurement, 20ms)), ElementsAre(20));
  EXPECT_THAT(offer(event(measurement, 30ms)), IsEmpty());
  EXPECT_THAT(offer(event(unnamed, 5000ms)), ElementsAre(30, 10));
}

TEST_F(DeliveryFilter, TheLastValueIsNeverLost) {
  EXPECT_THAT(offer(event(txPower, 0ms)), ElementsAre(0));
  EXPECT_EQ(filter.nextDue(), std::nullopt);
  EXPECT_THAT(offer(event(txPower, 300ms)), IsEmpty());
  ASSERT_TRUE(filter.nextDue().has_value());
  EXPECT_EQ(*filter.nextDue(), start + 1000ms);
  EXPECT_THAT(collect(999ms), IsEmpty());
  EXPECT_THAT(collect(1000ms), ElementsAre(300));
  EXPECT_EQ(filter.nextDue(), std::nullopt);
  EXPECT_THAT(collect(5000ms), IsEmpty());
}

TEST_F(DeliveryFilter, APeriodLongPastBeginsAgainWithTheNextEvent) {
  EXPECT_THAT(offer(event(txPower, 0ms)), ElementsAre(0));
  EXPECT_THAT(offer(event(txPower, 7300ms)), ElementsAre(7300));
  EXPECT_THAT(offer(event(txPower, 8200ms)), IsEmpty());
  EXPECT_THAT(offer(event(txPower, 8300ms)), ElementsAre(8200));
}

TEST_F(DeliveryFilter, ALittleBackwardsStaysWithinThePeriodAndFarBackwardsBeginsAnother) {
  EXPECT_THAT(offer(event(txPower, 100'000ms)), ElementsAre(100'000));
  EXPECT_THAT(offer(event(txPower, 99'990ms)), IsEmpty());
  EXPECT_THAT(offer(event(txPower, 50'000ms)), ElementsAre(99'990, 50'000));
  EXPECT_THAT(offer(event(txPower, 50'500ms)), IsEmpty());
}

TEST_F(DeliveryFilter, AnEventThatWasDeliveredIsNotDeliveredAgain) {
  const SharedEvent change = event(rrcState, 0ms);
  const SharedEvent periodic = event(txPower, 0ms);
  EXPECT_THAT(offer(change), ElementsAre(0));
  EXPECT_THAT(offer(periodic), ElementsAre(0));
  filter.setConfiguration(configuration("[metrics]\n" + rules));
  EXPECT_THAT(offer(change), IsEmpty());
  EXPECT_THAT(offer(periodic), IsEmpty());
  EXPECT_THAT(collect(10'000ms), IsEmpty());
}

TEST_F(DeliveryFilter, ClearingForgetsWhatWaitsAndWhatWas) {
  const SharedEvent first = event(txPower, 0ms);
  EXPECT_THAT(offer(first), ElementsAre(0));
  EXPECT_THAT(offer(event(txPower, 10ms)), IsEmpty());
  filter.setConfiguration(nullptr);
  EXPECT_THAT(collect(10'000ms), IsEmpty());
  filter.setConfiguration(configuration("[metrics]\n" + rules));
  EXPECT_THAT(offer(first), ElementsAre(0));
}

}  // namespace
}  // namespace vespscope::test
