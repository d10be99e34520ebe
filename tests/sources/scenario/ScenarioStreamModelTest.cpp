// The parts of the drive's model: logarithms, random numbers, map, propagation, vehicle, clock.
#include <cmath>
#include <set>

#include <gtest/gtest.h>

#include "sources/scenario/Clock.h"
#include "sources/scenario/Decibel.h"
#include "sources/scenario/Propagation.h"
#include "sources/scenario/RadioMap.h"
#include "sources/scenario/Random.h"
#include "sources/scenario/Vehicle.h"

namespace vespscope::test {
namespace {

using namespace sources::scenario;
using namespace std::chrono_literals;

TEST(ScenarioStreamModelDecibel, AgreesWithTheMathematicalFunctions) {
  for (double value = 1e-14; value < 1e12; value *= 3.7) {
    EXPECT_NEAR(decibels(value), 10 * std::log10(value), 1e-9) << value;
  }
  for (double value = -160; value < 80; value += 0.37) {
    EXPECT_NEAR(ratioOf(value) / std::pow(10, value / 10), 1, 1e-9) << value;
  }
  for (double degrees = 0; degrees <= 180; degrees += 1.7) {
    EXPECT_NEAR(arcCosine(std::cos(degrees * 3.14159265358979 / 180)), degrees, 0.01) << degrees;
  }
}

TEST(ScenarioStreamModelDecibel, RoundsHalvesAwayFromZero) {
  EXPECT_EQ(rounded(2.5), 3);
  EXPECT_EQ(rounded(-2.5), -3);
  EXPECT_EQ(rounded(2.4), 2);
  EXPECT_EQ(rounded(-2.4), -2);
}

TEST(ScenarioStreamModelRandom, GivesTheSequenceOfItsGenerator) {
  // The first numbers of SplitMix64 for seed 1234567, as published with the generator.
  Random random(1234567);
  EXPECT_EQ(random.next(), 6457827717110365317U);
  EXPECT_EQ(random.next(), 3203168211198807973U);
  EXPECT_EQ(random.next(), 9817491932198370423U);
}

TEST(ScenarioStreamModelRandom, NormalNumbersHaveTheirMeanAndDeviationAndNoFarTails) {
  Random random(9);
  double sum = 0;
  double squares = 0;
  constexpr int count = 50000;
  for (int i = 0; i < count; ++i) {
    const double value = random.normal();
    ASSERT_LT(std::fabs(value), 3.5);
    sum += value;
    squares += value * value;
  }
  EXPECT_NEAR(sum / count, 0, 0.02);
  EXPECT_NEAR(squares / count, 1, 0.02);
}

TEST(ScenarioStreamModelRandom, NumbersBetweenTwoEndsReachBoth) {
  Random random(4);
  std::set<std::int64_t> seen;
  for (int i = 0; i < 200; ++i) seen.insert(random.between(-1, 2));
  EXPECT_EQ(seen, (std::set<std::int64_t>{-1, 0, 1, 2}));
}

TEST(ScenarioStreamModelRandom, SmoothNoiseIsContinuousAndRepeatsAfterItsPeriod) {
  for (double position = 0; position < 400; position += 0.5) {
    EXPECT_LT(std::fabs(smoothNoise(5, position + 0.5, 50, 8) - smoothNoise(5, position, 50, 8)), 0.15) << position;
    EXPECT_NEAR(smoothNoise(5, position, 50, 8), smoothNoise(5, position + 400, 50, 8), 1e-9);
  }
}

TEST(ScenarioStreamModelClock, AConditionMustLastWithoutABreak) {
  Lasting lasting;
  EXPECT_FALSE(lasting.holds(true, 0ms, 100ms));
  EXPECT_FALSE(lasting.holds(true, 90ms, 100ms));
  EXPECT_FALSE(lasting.holds(false, 95ms, 100ms));
  EXPECT_FALSE(lasting.holds(true, 100ms, 100ms));
  EXPECT_TRUE(lasting.holds(true, 200ms, 100ms));
}

TEST(ScenarioStreamModelClock, ATimerExpiresOnce) {
  Timer timer;
  timer.start(50ms, 20ms);
  EXPECT_FALSE(timer.expired(60ms));
  EXPECT_TRUE(timer.expired(70ms));
  EXPECT_FALSE(timer.expired(80ms));
}

// Channel numbers, bands and bandwidths compared with the formulas of 3GPP TS 36.101 5.7.3 and TS 25.101 5.4.3.
TEST(ScenarioStreamModelLayers, ChannelNumbersFitTheirFrequenciesAndBands) {
  EXPECT_DOUBLE_EQ(1805 + 0.1 * (layers[lte1800].downlink - 1200), layers[lte1800].megahertz);
  EXPECT_DOUBLE_EQ(2620 + 0.1 * (layers[lte2600].downlink - 2750), layers[lte2600].megahertz);
  EXPECT_DOUBLE_EQ(791 + 0.1 * (layers[lte800].downlink - 6150), layers[lte800].megahertz);
  EXPECT_DOUBLE_EQ(layers[umts2100].downlink / 5.0, layers[umts2100].megahertz);
  EXPECT_DOUBLE_EQ(340 + layers[umts900].downlink / 5.0, layers[umts900].megahertz);
  EXPECT_EQ(layers[lte1800].band, 3U);
  EXPECT_EQ(layers[lte2600].band, 7U);
  EXPECT_EQ(layers[lte800].band, 20U);
  EXPECT_EQ(layers[umts2100].band, 1U);
  EXPECT_EQ(layers[umts900].band, 8U);
  for (const LayerIndex layer : lteLayers) {
    EXPECT_EQ(layers[layer].uplink, layers[layer].downlink + 18000);
    EXPECT_EQ(layers[layer].resourceBlocks, 5 * layers[layer].bandwidthMhz);
    EXPECT_EQ(layers[layer].bandwidthCode, layers[layer].bandwidthMhz == 20 ? 5U : 3U);
  }
}

TEST(ScenarioStreamModelRadioMap, TheCellsOfASiteTakeThePrimarySequencesInTurnAndNoNeighbourRepeatsAnIdentity) {
  const RadioMap map(1);
  std::set<std::uint32_t> physical;
  std::set<std::uint32_t> global;
  std::set<std::uint32_t> scrambling;
  for (std::uint16_t site = 0; site < map.siteCount(); ++site) {
    for (std::uint8_t sector = 0; sector < sectorsPerSite; ++sector) {
      EXPECT_EQ(map.physicalCellId({lte1800, sector, site}) % 3, sector);
      EXPECT_TRUE(physical.insert(map.physicalCellId({lte1800, sector, site})).second);
      EXPECT_TRUE(scrambling.insert(map.scramblingCode({umts2100, sector, site})).second);
      for (const LayerIndex layer : lteLayers) {
        EXPECT_TRUE(global.insert(map.eutranCellId({layer, sector, site})).second);
        EXPECT_EQ(map.eutranCellId({layer, sector, site}) >> 8U, map.eutranCellId({lte1800, 0, site}) >> 8U);
      }
    }
  }
}

TEST(ScenarioStreamModelRadioMap, TheRingIsMeasuredTheShorterWay) {
  EXPECT_DOUBLE_EQ(alongFrom(100, 250), 150);
  EXPECT_DOUBLE_EQ(alongFrom(roadLength - 10, 20), 30);
  EXPECT_DOUBLE_EQ(alongFrom(20, roadLength - 10), -30);
}

TEST(ScenarioStreamModelPropagation, RsrqIsTheShareOfRsrpInRssiTimesTheResourceBlocks) {
  const RadioMap map(2);
  Propagation propagation(map, 2);
  Random random(1);
  for (double along = 0; along < roadLength; along += 311) {
    propagation.moveTo(map.roadAt(along));
    for (const LayerIndex layer : lteLayers) {
      for (const LteLevel& level : propagation.lte(layer, 5s, random)) {
        const double blocks = ratioOf(level.rsrq - level.rsrp + level.rssi);
        ASSERT_NEAR(blocks, layers[layer].resourceBlocks, 1e-6);
        ASSERT_LT(level.rsrq, -2.9) << "a cell cannot be more than all that is received";
      }
    }
    for (const UmtsLevel& level : propagation.umts(umts900, 5s, random)) {
      ASSERT_NEAR(level.ecno, level.rscp - level.rssi, 1e-9);
      ASSERT_LT(level.ecno, 0);
    }
  }
}

TEST(ScenarioStreamModelPropagation, ACellFadesWithDistanceAndWithFrequency) {
  const RadioMap map(1);
  Propagation propagation(map, 1);
  Random random(1);
  constexpr std::uint16_t site = 49;  // in a town
  ASSERT_TRUE(map.hosts(site, lte1800));
  const auto strongest = [&](LayerIndex layer, double away) {
    double sum = 0;
    for (int i = -3; i <= 3; ++i) {  // over a stretch, which averages shadowing
      propagation.moveTo({map.site(site).along + away + 40 * i, 0});
      double best = -200;
      for (const LteLevel& level : propagation.lte(layer, 0s, random)) {
        if (level.cell.site == site) best = std::max(best, level.rsrp);
      }
      sum += best / 7;
    }
    return sum;
  };
  EXPECT_GT(strongest(lte1800, 300), strongest(lte1800, 1800) + 15);
  EXPECT_GT(strongest(lte800, 600), strongest(lte1800, 600) + 4);
}

TEST(ScenarioStreamModelVehicle, KeepsToPossibleSpeedsAndAccelerationsAndStopsNowAndThen) {
  Vehicle vehicle(3);
  double before = 0;
  int standing = 0;
  for (Time now = frame; now < 30min; now += frame) {
    vehicle.tick(now);
    ASSERT_GE(vehicle.speed(), 0);
    ASSERT_LE(vehicle.speed(), 22);
    if (vehicle.speed() > 0) {
      ASSERT_LT(std::fabs(vehicle.speed() - before), 0.04) << "4 m/s^2";
    }
    if (now < 2min) {
      ASSERT_GT(vehicle.speed(), 0) << "a free road at first";
    }
    standing += vehicle.speed() == 0 ? 1 : 0;
    before = vehicle.speed();
  }
  EXPECT_GT(standing, 1000) << "ten seconds";
}

}  // namespace
}  // namespace vespscope::test
