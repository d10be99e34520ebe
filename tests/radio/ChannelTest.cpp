// Channel numbers: the tables of numbers compared with the tables of frequency ranges from other clauses, and
// overlapping bands.
#include <algorithm>
#include <array>
#include <cmath>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "radio/Channel.h"

namespace vespscope::test {
namespace {

using radio::Arfcn;
using radio::Direction;
using radio::Earfcn;
using radio::Eutra;
using radio::GsmBand;
using radio::Uarfcn;
using radio::Utra;
using testing::ElementsAre;

// Frequencies of a band in MHz; zeros for a missing direction.
struct Range {
  std::uint32_t band;
  double uplinkLow, uplinkHigh;
  double downlinkLow, downlinkHigh;
};

// 3GPP TS 36.101 table 5.5-1, E-UTRA operating bands: frequencies only.
constexpr std::array<Range, 73> eutraBands = {{
    {1, 1920, 1980, 2110, 2170},
    {2, 1850, 1910, 1930, 1990},
    {3, 1710, 1785, 1805, 1880},
    {4, 1710, 1755, 2110, 2155},
    {5, 824, 849, 869, 894},
    {6, 830, 840, 875, 885},
    {7, 2500, 2570, 2620, 2690},
    {8, 880, 915, 925, 960},
    {9, 1749.9, 1784.9, 1844.9, 1879.9},
    {10, 1710, 1770, 2110, 2170},
    {11, 1427.9, 1447.9, 1475.9, 1495.9},
    {12, 699, 716, 729, 746},
    {13, 777, 787, 746, 756},
    {14, 788, 798, 758, 768},
    {17, 704, 716, 734, 746},
    {18, 815, 830, 860, 875},
    {19, 830, 845, 875, 890},
    {20, 832, 862, 791, 821},
    {21, 1447.9, 1462.9, 1495.9, 1510.9},
    {22, 3410, 3490, 3510, 3590},
    {23, 2000, 2020, 2180, 2200},
    {24, 1626.5, 1660.5, 1525, 1559},
    {25, 1850, 1915, 1930, 1995},
    {26, 814, 849, 859, 894},
    {27, 807, 824, 852, 869},
    {28, 703, 748, 758, 803},
    {29, 0, 0, 717, 728},
    {30, 2305, 2315, 2350, 2360},
    {31, 452.5, 457.5, 462.5, 467.5},
    {32, 0, 0, 1452, 1496},
    {33, 1900, 1920, 1900, 1920},
    {34, 2010, 2025, 2010, 2025},
    {35, 1850, 1910, 1850, 1910},
    {36, 1930, 1990, 1930, 1990},
    {37, 1910, 1930, 1910, 1930},
    {38, 2570, 2620, 2570, 2620},
    {39, 1880, 1920, 1880, 1920},
    {40, 2300, 2400, 2300, 2400},
    {41, 2496, 2690, 2496, 2690},
    {42, 3400, 3600, 3400, 3600},
    {43, 3600, 3800, 3600, 3800},
    {44, 703, 803, 703, 803},
    {45, 1447, 1467, 1447, 1467},
    {46, 5150, 5925, 5150, 5925},
    {47, 5855, 5925, 5855, 5925},
    {48, 3550, 3700, 3550, 3700},
    {49, 3550, 3700, 3550, 3700},
    {50, 1432, 1517, 1432, 1517},
    {51, 1427, 1432, 1427, 1432},
    {52, 3300, 3400, 3300, 3400},
    {53, 2483.5, 2495, 2483.5, 2495},
    {54, 1670, 1675, 1670, 1675},
    {65, 1920, 2010, 2110, 2200},
    {66, 1710, 1780, 2110, 2200},
    {67, 0, 0, 738, 758},
    {68, 698, 728, 753, 783},
    {69, 0, 0, 2570, 2620},
    {70, 1695, 1710, 1995, 2020},
    {71, 663, 698, 617, 652},
    {72, 451, 456, 461, 466},
    {73, 450, 455, 460, 465},
    {74, 1427, 1470, 1475, 1518},
    {75, 0, 0, 1432, 1517},
    {76, 0, 0, 1427, 1432},
    {85, 698, 716, 728, 746},
    {87, 410, 415, 420, 425},
    {88, 412, 417, 422, 427},
    {103, 787, 788, 757, 758},
    {106, 896, 901, 935, 940},
    {107, 0, 0, 612, 652},
    {108, 0, 0, 470, 698},
    {111, 1800, 1810, 1820, 1830},
    {0, 0, 0, 0, 0},  // end of the table
}};

// 3GPP TS 25.101 table 5.0, UTRA FDD frequency bands; a carrier's centre is 2.4 MHz or more inside.
constexpr std::array<Range, 21> utraBands = {{
    {1, 1920, 1980, 2110, 2170},
    {2, 1850, 1910, 1930, 1990},
    {3, 1710, 1785, 1805, 1880},
    {4, 1710, 1755, 2110, 2155},
    {5, 824, 849, 869, 894},
    {6, 830, 840, 875, 885},
    {7, 2500, 2570, 2620, 2690},
    {8, 880, 915, 925, 960},
    {9, 1749.9, 1784.9, 1844.9, 1879.9},
    {10, 1710, 1770, 2110, 2170},
    {11, 1427.9, 1447.9, 1475.9, 1495.9},
    {12, 699, 716, 729, 746},
    {13, 777, 787, 746, 756},
    {14, 788, 798, 758, 768},
    {19, 830, 845, 875, 890},
    {20, 832, 862, 791, 821},
    {21, 1447.9, 1462.9, 1495.9, 1510.9},
    {22, 3410, 3490, 3510, 3590},
    {25, 1850, 1915, 1930, 1995},
    {26, 814, 849, 859, 894},
    {32, 0, 0, 1452, 1496},
}};

std::uint32_t kilohertz(double megahertz) { return static_cast<std::uint32_t>(std::lround(megahertz * 1000)); }

template <class Blocks>
std::vector<radio::ChannelBlock> blocksOf(const Blocks& all, std::uint32_t band, Direction direction) {
  std::vector<radio::ChannelBlock> found;
  for (const radio::ChannelBlock& block : all) {
    if (block.band == band && (block.direction == direction || block.direction == Direction::both)) {
      found.push_back(block);
    }
  }
  return found;
}

TEST(Channel, CoversExactlyTheFrequenciesOfEachLteBand) {
  const auto expectRange = [](std::uint32_t band, Direction direction, double low, double high) {
    const auto blocks = blocksOf(Eutra::blocks(), band, direction);
    if (high == 0) {
      EXPECT_TRUE(blocks.empty()) << band;
      return;
    }
    ASSERT_EQ(blocks.size(), 1U) << band;
    EXPECT_EQ(blocks[0].kilohertz, kilohertz(low)) << band;
    EXPECT_EQ(blocks[0].kilohertz + (blocks[0].last - blocks[0].first + 1) * 100, kilohertz(high)) << band;
  };
  std::size_t known = 0;
  for (const Range& range : eutraBands) {
    if (range.band == 0) break;
    ++known;
    expectRange(range.band, Direction::downlink, range.downlinkLow, range.downlinkHigh);
    expectRange(range.band, Direction::uplink, range.uplinkLow, range.uplinkHigh);
  }
  // The table contains no other band.
  std::size_t downlinks = 0;
  for (const radio::ChannelBlock& block : Eutra::blocks()) downlinks += block.direction != Direction::uplink ? 1 : 0;
  EXPECT_EQ(downlinks, known);
}

TEST(Channel, GivesEachLteNumberToOneBand) {
  for (const radio::ChannelBlock& block : Eutra::blocks()) {
    for (const std::uint32_t number : {block.first, (block.first + block.last) / 2, block.last}) {
      EXPECT_EQ(Earfcn::allWithNumber(number, block.direction).size(), 1U) << number;
      EXPECT_EQ(Earfcn::fromNumber(number, block.direction)->band(), block.band) << number;
    }
  }
}

TEST(Channel, KeepsUmtsCarriersInsideTheirBands) {
  for (const Range& range : utraBands) {
    for (const auto& block : blocksOf(Utra::blocks(), range.band, Direction::downlink)) {
      EXPECT_GE(block.kilohertz, kilohertz(range.downlinkLow) + 2400) << range.band;
      const std::uint32_t last = block.kilohertz + (block.last - block.first) * 200;
      EXPECT_LE(last, kilohertz(range.downlinkHigh) - 2400) << range.band;
    }
    for (const auto& block : blocksOf(Utra::blocks(), range.band, Direction::uplink)) {
      EXPECT_GE(block.kilohertz, kilohertz(range.uplinkLow) + 2400) << range.band;
      const std::uint32_t last = block.kilohertz + (block.last - block.first) * 200;
      EXPECT_LE(last, kilohertz(range.uplinkHigh) - 2400) << range.band;
    }
    // The general channels begin and end at the outermost positions of a carrier of 5 MHz.
    const auto general = blocksOf(Utra::blocks(), range.band, Direction::downlink);
    ASSERT_FALSE(general.empty()) << range.band;
    EXPECT_LE(general[0].kilohertz, kilohertz(range.downlinkLow) + 2600) << range.band;
    EXPECT_GE(general[0].kilohertz + (general[0].last - general[0].first) * 200, kilohertz(range.downlinkHigh) - 2600)
        << range.band;
  }
}

TEST(Channel, PairsUmtsCarriersAtTheBandsDistance) {
  for (const radio::ChannelBlock& block : Utra::blocks()) {
    if (block.direction != Direction::downlink || block.band == 32) continue;
    const auto* range = std::find_if(utraBands.begin(), utraBands.end(),
                                     [&](const Range& candidate) { return candidate.band == block.band; });
    ASSERT_NE(range, utraBands.end());
    for (std::uint32_t number = block.first; number <= block.last; number += block.step) {
      const auto channel = Uarfcn::fromNumber(number, Direction::downlink, block.band);
      ASSERT_TRUE(channel);
      const auto uplink = channel->paired();
      ASSERT_TRUE(uplink) << number;
      EXPECT_NEAR(channel->megahertz() - uplink->megahertz(), range->downlinkLow - range->uplinkLow, 1e-9) << number;
      EXPECT_EQ(uplink->paired(), channel);
    }
  }
}

// Additional channels are 100 kHz off the 200 kHz raster of the general ones, every 5 MHz or at a band's edges.
TEST(Channel, HasTheAdditionalUmtsChannels) {
  EXPECT_EQ(Uarfcn::fromNumber(412, Direction::downlink)->kilohertz(), 1'932'500U);
  EXPECT_EQ(Uarfcn::fromNumber(1887, Direction::downlink)->band(), 4U);
  EXPECT_EQ(Uarfcn::fromNumber(2912, Direction::downlink)->kilohertz(), 2'687'500U);
  EXPECT_EQ(Uarfcn::fromNumber(3992, Direction::downlink)->kilohertz(), 743'500U);
  EXPECT_EQ(Uarfcn::fromNumber(6087, Direction::downlink)->kilohertz(), 891'500U);
  EXPECT_FALSE(Uarfcn::fromNumber(413, Direction::downlink));
  for (const radio::ChannelBlock& block : Utra::blocks()) {
    if (block.step != 1) {
      EXPECT_EQ(block.kilohertz % 1000, 500U) << block.band << ' ' << block.first;
    }
  }
}

TEST(Channel, ConvertsAFrequencyBackToItsNumber) {
  for (const auto& [number, direction] :
       {std::pair{5780U, Direction::downlink}, std::pair{20850U, Direction::uplink},
        std::pair{38750U, Direction::downlink}, std::pair{66536U, Direction::downlink}}) {
    const auto channel = Earfcn::fromNumber(number, direction);
    ASSERT_TRUE(channel);
    EXPECT_THAT(Earfcn::allAtFrequency(channel->kilohertz(), direction), testing::Contains(*channel));
  }
  EXPECT_EQ(Earfcn::fromNumber(5780, Direction::downlink)->megahertz(), 739.0);
  EXPECT_EQ(Earfcn::fromNumber(5780, Direction::downlink)->paired()->megahertz(), 709.0);
}

TEST(Channel, NamesEveryBandAtAFrequency) {
  std::vector<std::uint32_t> bands;
  for (const Earfcn& channel : Earfcn::allAtFrequency(2'140'000, Direction::downlink)) bands.push_back(channel.band());
  EXPECT_THAT(bands, ElementsAre(1U, 4U, 10U, 65U, 66U));
  EXPECT_TRUE(Earfcn::allAtFrequency(2'140'050, Direction::downlink).empty());
}

TEST(Channel, LeavesTheChoiceBetweenOverlappingBandsToTheCaller) {
  EXPECT_EQ(Arfcn::allWithNumber(700, Direction::downlink).size(), 2U);
  EXPECT_FALSE(Arfcn::fromNumber(700, Direction::downlink));
  EXPECT_EQ(Arfcn::fromNumber(700, Direction::downlink, GsmBand::dcs1800)->megahertz(), 1842.8);
  EXPECT_EQ(Arfcn::fromNumber(700, Direction::downlink, GsmBand::pcs1900)->megahertz(), 1967.8);
  EXPECT_EQ(Arfcn::fromNumber(850, Direction::uplink)->band(), GsmBand::dcs1800);
  EXPECT_EQ(Uarfcn::allWithNumber(4400, Direction::downlink).size(), 2U);
  EXPECT_FALSE(Uarfcn::fromNumber(4400, Direction::downlink));
  EXPECT_EQ(Uarfcn::fromNumber(4400, Direction::downlink, 6)->band(), 6U);
  EXPECT_FALSE(Uarfcn::fromNumber(4400, Direction::downlink, 1));
}

TEST(Channel, KnowsTheGsmFrequencies) {
  EXPECT_EQ(Arfcn::fromNumber(62, Direction::downlink, GsmBand::primary900)->kilohertz(), 947'400U);
  EXPECT_EQ(Arfcn::fromNumber(62, Direction::uplink, GsmBand::primary900)->kilohertz(), 902'400U);
  EXPECT_EQ(Arfcn::fromNumber(975, Direction::downlink, GsmBand::extended900)->kilohertz(), 925'200U);
  EXPECT_EQ(Arfcn::fromNumber(955, Direction::downlink, GsmBand::railways900)->kilohertz(), 921'200U);
  EXPECT_EQ(Arfcn::fromNumber(940, Direction::downlink, GsmBand::extendedRailways900)->kilohertz(), 918'200U);
  EXPECT_EQ(Arfcn::fromNumber(128, Direction::downlink)->kilohertz(), 869'200U);
  EXPECT_EQ(Arfcn::fromNumber(251, Direction::downlink)->kilohertz(), 893'800U);
  EXPECT_EQ(Arfcn::fromNumber(810, Direction::downlink, GsmBand::pcs1900)->kilohertz(), 1'989'800U);
  EXPECT_EQ(Arfcn::fromNumber(885, Direction::downlink)->kilohertz(), 1'879'800U);
  EXPECT_EQ(Arfcn::fromNumber(293, Direction::downlink)->kilohertz(), 467'400U);
  EXPECT_EQ(Arfcn::fromNumber(885, Direction::downlink)->paired()->kilohertz(), 1'784'800U);
}

TEST(Channel, IsNothingBetweenTheBands) {
  for (const std::uint32_t number : {4950U, 5400U, 7400U, 10360U, 23780U, 65535U, 0xFFFFFFFFU}) {
    EXPECT_FALSE(Earfcn::fromNumber(number, Direction::downlink)) << number;
  }
  EXPECT_FALSE(Arfcn::fromNumber(1024, Direction::downlink));
  EXPECT_FALSE(Earfcn::fromNumber(9700, Direction::downlink)->paired());   // a band for the downlink only
  EXPECT_FALSE(Earfcn::fromNumber(67300, Direction::downlink)->paired());  // beyond the narrower uplink
  const auto shared = Earfcn::fromNumber(38750, Direction::uplink);
  ASSERT_TRUE(shared);
  EXPECT_EQ(shared->paired(), shared);
}

}  // namespace
}  // namespace vespscope::test
